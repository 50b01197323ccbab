#pragma once

#include <QBuffer>
#include <QImage>
#include <QPainter>

namespace zorbin::test {

inline QByteArray encoded(const QImage &image, const char *format)
{
    QBuffer buffer;
    buffer.open(QIODevice::WriteOnly);
    image.save(&buffer, format);
    return buffer.data();
}

// Left half red, right half blue, so that a turn shows where the halves went.
inline QByteArray halves(QSize size, const char *format = "JPEG")
{
    QImage image(size, QImage::Format_RGB32);
    image.fill(Qt::blue);
    QPainter(&image).fillRect(0, 0, size.width() / 2, size.height(), Qt::red);
    return encoded(image, format);
}

// A JPEG of halves whose EXIF orientation (6) says that it is shown turned a quarter clockwise,
// as a telephone camera stores a picture taken upright.
inline QByteArray turned(QSize size)
{
    const QByteArray exif("Exif\0\0II*\0\x08\0\0\0\x01\0\x12\x01\x03\0\x01\0\0\0\x06\0\0\0\0\0\0\0", 32);
    const QByteArray jpeg = halves(size);
    return jpeg.left(2) + QByteArray("\xFF\xE1\0", 3) + char(exif.size() + 2) + exif + jpeg.mid(2);
}

} // namespace zorbin::test
