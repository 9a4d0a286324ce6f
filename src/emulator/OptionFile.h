#pragma once

#include "emulator/ConfigRecord.h"

#include <QString>

// Option sets on disk: one ConfigRecord per .lum file.

// The path a save writes to: unless its last four characters are ".lum" in any case,
// ".lum" is appended ("name" -> "name.lum", "NAME.LUM" stays, "x.lum.bak" ->
// "x.lum.bak.lum").
QString withLumExtension(const QString& path);

// Writes the record as the whole file. The bytes go to a temporary file in the same
// folder that is renamed into place, so a failure leaves any older file as it was and no
// half-written one. False when the file could not be written.
bool writeOptionFile(const QString& path, const ConfigRecord& record);

// Reads and checks an option set. A path that is not a regular file or cannot be read is
// Unreadable; a file shorter than a record is Short; bytes after the record are ignored.
ConfigDecode readOptionFile(const QString& path, const ConfigLimits& limits);
