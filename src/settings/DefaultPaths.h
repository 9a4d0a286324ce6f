#pragma once

#include <QString>

// The rules of the Default Paths page that need no window: which folders are the same, and
// how the emulator's path is completed.

// True when both paths name one folder: their cleaned absolute forms are equal.
bool sameFolder(const QString& a, const QString& b);

// True when a dropped item's name marks an archive: longer than four characters and
// ending in ".rar" in any letter case.
bool isArchiveName(const QString& item);

// The emulator's file name on this platform.
QString z26FileName();

// The path of the emulator that `path` names: a folder gets the emulator's file name
// appended; a path that already ends in a separator and that name (any letter case) is
// kept as it is.
QString completeZ26Path(const QString& path);

// What the emulator box shows for the stored path: the trimmed text, completed as above
// once it is at least as long as the separator and the file name.
QString z26PathForDisplay(const QString& stored);
