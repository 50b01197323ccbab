#pragma once

#include <QByteArray>
#include <QString>

namespace zorbin::test {

// The folder of the pictures that ImageMagick made for these tests at build time.
QString testPicture(const QString &name);
// The bytes of a test picture; fails the test when it cannot be read.
QByteArray testPictureBytes(const QString &name);

// A top-down copy of a bottom-up 24-bit BMP: the rows in the opposite order and the height
// stored negative, as top-down pictures are written.
QByteArray topDownBitmap(const QByteArray &bottomUp);

} // namespace zorbin::test
