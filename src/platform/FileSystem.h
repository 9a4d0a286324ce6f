#pragma once

#include <QString>

// True when anything, file or folder, matches the path. The last element may hold the
// wildcards '*' and '?', which are honoured.
bool FileExist(const QString& path);

// The absolute path of the program `name` found on PATH, or the empty text.
QString findProgramOnPath(const QString& name);

// The absolute path of an existing file or folder, or the empty text when the path does
// not exist. (Linux has no short names; this is what the emulator is given.)
QString GetShortPath(const QString& path);
