#include "ui/PictureFile.h"

#include <QFileInfo>
#include <QImageReader>

QImage loadPictureFile(const QString& file) {
    if (file.isEmpty() || !QFileInfo(file).isFile())
        return QImage();
    QImageReader reader(file);
    reader.setAutoTransform(true); // a photo turned by its camera shows upright
    // Pictures behind a list or a bar are of modest size; a huge one is refused rather
    // than allowed to take the memory of a hundred thousand rows.
    constexpr int kMaxSide = 8192;
    const QSize size = reader.size();
    if (!size.isValid() || size.width() > kMaxSide || size.height() > kMaxSide)
        return QImage();
    return reader.read();
}
