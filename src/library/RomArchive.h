#pragma once

#include <QString>
#include <QtGlobal>

// Whether a file is an archive the launch unpacks first: a .zip, .7z or .gz by its name,
// in any case.
bool isRomArchiveName(const QString& path);

// The first file of an archive as extracted, or why there is none.
struct ArchiveResult {
    QString path;  // the extracted file; empty when it failed
    QString error; // one sentence for the user when it failed
};

// No cartridge image comes near this size; a bigger file is not a ROM.
constexpr qint64 kLargestArchivedRom = 16 * 1024 * 1024;

// Extracts the first regular file of a zip or 7z archive, or the single file of a gzip
// file, into an existing folder. The file is named by the entry's base name (a gzip file's
// own name without ".gz"), so nothing lands outside the folder; a file of that name there
// is replaced. A damaged, encrypted or empty archive, or a first file over
// kLargestArchivedRom, extracts nothing.
ArchiveResult extractFirstRom(const QString& archive, const QString& intoFolder);
