#pragma once

#include <QByteArray>
#include <QByteArrayView>
#include <QString>
#include <QStringView>

// File names as the file system holds them: bytes, mostly UTF-8. A name that is not valid
// UTF-8 (an old Latin-1 collection) keeps each stray byte as the code unit 0xDC00 + byte,
// which no valid name produces, so that it converts back to the very same bytes.
QString nameFromFileSystem(QByteArrayView bytes);
QByteArray nameToFileSystem(QStringView name);
// A name as shown to the user: stray bytes read as Latin-1.
QString readableName(QStringView name);

// True when anything, file or folder, matches the path. The last element may hold the
// wildcards '*' and '?', which are honoured.
bool FileExist(const QString& path);

// The absolute path of the program `name` found on PATH, or the empty text.
QString findProgramOnPath(const QString& name);

// The absolute path of an existing file or folder, or the empty text when the path does
// not exist. (Linux has no short names; this is what the emulator is given.)
QString GetShortPath(const QString& path);
