#include "TestPictures.h"
#include "output/ImageDimensions.h"
#include "testutil/TestMain.h"

#include <QBuffer>
#include <QTest>
#include <QtEndian>

using namespace zorbin;
using namespace zorbin::test;

Q_DECLARE_METATYPE(ImageInfo)

namespace {

// A top-down copy of a bottom-up 24-bit BMP: the rows in the opposite order and the height
// stored negative, as top-down pictures are written.
QByteArray topDownBitmap(const QByteArray &bottomUp)
{
    const auto *header = reinterpret_cast<const uchar *>(bottomUp.constData());
    const auto pixelsAt = qFromLittleEndian<quint32>(header + 10);
    const auto width = qFromLittleEndian<qint32>(header + 18);
    const auto height = qFromLittleEndian<qint32>(header + 22);
    const qsizetype rowBytes = ((width * qFromLittleEndian<quint16>(header + 28) + 31) / 32) * 4;
    QByteArray topDown = bottomUp.left(pixelsAt);
    for (qint32 row = height - 1; row >= 0; --row)
        topDown += bottomUp.mid(pixelsAt + row * rowBytes, rowBytes);
    qToLittleEndian<qint32>(-height, topDown.data() + 22);
    return topDown;
}

ImageInfo infoOf(const QByteArray &bytes)
{
    QByteArray data = bytes;
    QBuffer buffer(&data);
    buffer.open(QIODevice::ReadOnly);
    return GetImageInfo(buffer);
}

// A JPEG stream from its start marker up to a frame header of the given marker (height 300,
// width 200), with one segment of each kind in `before` (marker, length) in front of it; the
// segments' data looks like a frame header, so a walk that does not jump over them is caught.
QByteArray jpegWithFrame(uchar frameMarker, const QList<QPair<uchar, int>> &before = {})
{
    QByteArray data("\xFF\xD8", 2);
    for (const auto &[marker, length] : before) {
        data += '\xFF';
        data += static_cast<char>(marker);
        data += static_cast<char>(length >> 8);
        data += static_cast<char>(length & 0xFF);
        data += QByteArray(length - 2, '\x11');
    }
    data += '\xFF';
    data += static_cast<char>(frameMarker);
    data += QByteArray::fromHex("0011 08 012C 00C8 03"); // length, precision, height, width, components
    data += QByteArray(9, '\x01');
    return data + QByteArray::fromHex("FFD9");
}

} // namespace

// The header readers on pictures that ImageMagick made, and on damaged and foreign data.
class ImageHeaderTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void readsPicturesMadeByImageMagick_data()
    {
        QTest::addColumn<QString>("file");
        QTest::addColumn<ImageInfo>("expected");
        const auto row = [](const char *file, std::uint8_t kind, int width, int height) {
            QTest::newRow(file) << QString::fromLatin1(file) << ImageInfo{kind, width, height};
        };
        row("png-type0.png", ImageInfo::PNG, 100, 80);
        row("png-type2.png", ImageInfo::PNG, 240, 90);
        row("png-type3.png", ImageInfo::PNG, 200, 300);
        row("png-type4.png", ImageInfo::PNG, 240, 180);
        row("png-type6.png", ImageInfo::PNG, 640, 480);
        row("picture.gif", ImageInfo::GIF, 16, 17);
        row("bottom-up.bmp", ImageInfo::BMP, 800, 600);
        row("core-header.bmp", ImageInfo::BMP, 120, 90);
        row("baseline-exif.jpg", ImageInfo::JPEG, 640, 480);
        row("progressive-exif.jpg", ImageInfo::JPEG, 200, 300);
        // A comment segment of 40,002 bytes: its length does not fit a signed 16-bit number.
        row("long-comment.jpg", ImageInfo::JPEG, 240, 90);
        // Sides beyond 32767 pixels are read whole in every format.
        row("wide.png", ImageInfo::PNG, 40000, 8);
        row("wide.gif", ImageInfo::GIF, 40000, 8);
        row("wide.bmp", ImageInfo::BMP, 40000, 8);
        row("wide.jpg", ImageInfo::JPEG, 40000, 8);
        row("tall.png", ImageInfo::PNG, 8, 70000);
    }
    void readsPicturesMadeByImageMagick()
    {
        QFETCH(QString, file);
        QFETCH(ImageInfo, expected);
        QCOMPARE(GetImageInfo(testPicture(file)), expected);
        QCOMPARE(infoOf(testPictureBytes(file)), expected);
    }

    void readsData_data()
    {
        QTest::addColumn<QByteArray>("data");
        QTest::addColumn<ImageInfo>("expected");
        const ImageInfo none;
        const ImageInfo jpeg{ImageInfo::JPEG, 200, 300};
        const QByteArray bmp = testPictureBytes(u"bottom-up.bmp"_qs);
        QTest::newRow("top-down bitmap, height positive")
            << topDownBitmap(bmp) << ImageInfo{ImageInfo::BMP, 800, 600};
        QByteArray png = testPictureBytes(u"png-type2.png"_qs);
        png[25] = 5;
        QTest::newRow("PNG of colour type 5") << png << none;
        QTest::newRow("... with a JPEG in it") << png + jpegWithFrame(0xC0) << jpeg;
        for (int marker = 0xC0; marker <= 0xCF; ++marker) {
            // Every frame header ends the walk; C4, C8 and CC are other segments.
            const QList<QPair<uchar, int>> segments{{0xE0, 16}, {0xE1, 34}, {0xDB, 67}};
            if (marker != 0xC4 && marker != 0xC8 && marker != 0xCC)
                QTest::addRow("frame %X", marker)
                    << jpegWithFrame(static_cast<uchar>(marker), segments) << jpeg;
        }
        QTest::newRow("Huffman tables C4") << jpegWithFrame(0xC0, {{0xC4, 30}}) << jpeg;
        QTest::newRow("reserved C8") << jpegWithFrame(0xC0, {{0xC8, 6}}) << jpeg;
        QTest::newRow("arithmetic conditioning CC") << jpegWithFrame(0xC0, {{0xCC, 4}}) << jpeg;
        QTest::newRow("a segment of 65535 bytes") << jpegWithFrame(0xC0, {{0xE2, 65535}}) << jpeg;
        // The JPEG start behind a wrapper: the search reads blocks of 4096 bytes, up to its limit.
        const QByteArray exif = testPictureBytes(u"baseline-exif.jpg"_qs);
        for (const qsizetype wrapper : {qsizetype(128), qsizetype(4093), qsizetype(4094), qsizetype(4095),
                                        qsizetype(JpegSearchLimit - 1), qsizetype(JpegSearchLimit)}) {
            QTest::addRow("behind %lld bytes", static_cast<long long>(wrapper))
                << QByteArray(wrapper, '\0') + exif
                << (wrapper < JpegSearchLimit ? ImageInfo{ImageInfo::JPEG, 640, 480} : none);
        }
        QTest::newRow("empty") << QByteArray() << none;
        QTest::newRow("text") << QByteArray("Hello, this is not a picture at all.\n") << none;
        QTest::newRow("PNG signature only") << QByteArray("\x89PNG\r\n\x1A\n", 8) << none;
        QTest::newRow("GIF signature only") << QByteArray("GIF89a") << none;
        QTest::newRow("JPEG start only") << QByteArray("\xFF\xD8\xFF", 3) << none;
        QTest::newRow("JPEG frame header cut short") << jpegWithFrame(0xC0).left(8) << none;
        QTest::newRow("JPEG segment beyond the end") << jpegWithFrame(0xC0, {{0xE1, 200}}).left(40) << none;
        QTest::newRow("BMP with the lowest height")
            << QByteArray::fromHex("424D 00000000 00000000 36000000 28000000 01000000 00000080") << none;
        QTest::newRow("PNG wider than 2^31-1")
            << QByteArray::fromHex("89504E470D0A1A0A 0000000D49484452 80000000 00000001 0802000000") << none;
        QTest::newRow("PNG 2^31-1 wide")
            << QByteArray::fromHex("89504E470D0A1A0A 0000000D49484452 7FFFFFFF 00000001 0802000000")
            << ImageInfo{ImageInfo::PNG, 2147483647, 1};
        // Each kind cut just before the last header byte the reader needs, and just after it.
        const std::tuple<const char *, QByteArray, qsizetype, ImageInfo> ends[] = {
            {"PNG", testPictureBytes(u"png-type2.png"_qs), 26, {ImageInfo::PNG, 240, 90}},
            {"GIF", testPictureBytes(u"picture.gif"_qs), 10, {ImageInfo::GIF, 16, 17}},
            {"BMP", bmp, 26, {ImageInfo::BMP, 800, 600}},
            {"JPEG", exif, exif.indexOf("\xFF\xC0") + 9, {ImageInfo::JPEG, 640, 480}},
        };
        for (const auto &[kind, bytes, end, info] : ends) {
            QTest::addRow("%s cut short", kind) << bytes.left(end - 1) << none;
            QTest::addRow("%s ending with its header", kind) << bytes.left(end) << info;
        }
    }
    void readsData()
    {
        QFETCH(QByteArray, data);
        QFETCH(ImageInfo, expected);
        QCOMPARE(infoOf(data), expected);
    }
};

ZORBIN_TEST_CLASS(ImageHeaderTest)
#include "ImageHeaderTest.moc"
