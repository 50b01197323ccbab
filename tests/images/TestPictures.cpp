#include "TestPictures.h"

#include "testutil/TestFiles.h"

#include <QTest>
#include <QtEndian>

namespace zorbin::test {

QString testPicture(const QString &name)
{
    return QStringLiteral(ZORBIN_TEST_PICTURES "/") + name;
}

QByteArray testPictureBytes(const QString &name)
{
    const QByteArray bytes = readFile(testPicture(name));
    if (bytes.isEmpty())
        qFatal("The test picture %s is missing: build the target image-test-pictures.", qPrintable(name));
    return bytes;
}

QByteArray topDownBitmap(const QByteArray &bottomUp)
{
    const auto *header = reinterpret_cast<const uchar *>(bottomUp.constData());
    const auto pixelsAt = qFromLittleEndian<quint32>(header + 10);
    const auto width = qFromLittleEndian<qint32>(header + 18);
    const auto height = qFromLittleEndian<qint32>(header + 22);
    const auto bitsPerPixel = qFromLittleEndian<quint16>(header + 28);
    const qsizetype rowBytes = ((width * bitsPerPixel + 31) / 32) * 4;
    QByteArray topDown = bottomUp.left(pixelsAt);
    for (qint32 row = height - 1; row >= 0; --row)
        topDown += bottomUp.mid(pixelsAt + row * rowBytes, rowBytes);
    qToLittleEndian<qint32>(-height, topDown.data() + 22);
    return topDown;
}

} // namespace zorbin::test
