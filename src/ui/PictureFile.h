#pragma once

#include <QImage>
#include <QString>

// The picture in an image file, or a null image when the name is empty or the file is not
// a regular file (a pipe could block the reader), unreadable, not a picture or
// unreasonably large.
QImage loadPictureFile(const QString& file);
