#include "TestPictures.h"
#include "output/ImageDimensions.h"
#include "testutil/TestMain.h"

#include <QBuffer>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

Q_DECLARE_METATYPE(ImageInfo)

namespace {

ImageInfo infoOf(const QByteArray &bytes)
{
    QByteArray data = bytes;
    QBuffer buffer(&data);
    buffer.open(QIODevice::ReadOnly);
    return GetImageInfo(buffer);
}

// A buffer that counts how many bytes the reader took from it.
class CountingBuffer final : public QBuffer
{
public:
    using QBuffer::QBuffer;
    qint64 bytesRead = 0;

protected:
    qint64 readData(char *data, qint64 maxSize) override
    {
        const qint64 read = QBuffer::readData(data, maxSize);
        bytesRead += std::max<qint64>(read, 0);
        return read;
    }
};

// A JPEG stream from its start marker up to a frame header of the given marker, with one
// segment of each kind in `before` (marker, length) in front of it.
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
    // Frame header: length 17, precision 8, height 300, width 200, then components.
    data += '\xFF';
    data += static_cast<char>(frameMarker);
    data += QByteArray::fromHex("0011"
                                "08"
                                "012C"
                                "00C8"
                                "03");
    data += QByteArray(9, '\x01');
    data += QByteArray::fromHex("FFD9");
    return data;
}

ImageInfo jpeg200x300()
{
    return {ImageInfo::JPEG, 200, 300};
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

    void readsATopDownBitmapWithItsHeightPositive()
    {
        const QByteArray topDown = topDownBitmap(testPictureBytes(QStringLiteral("bottom-up.bmp")));
        QCOMPARE(infoOf(topDown), (ImageInfo{ImageInfo::BMP, 800, 600}));
    }

    void refusesAPngOfColourTypeFive()
    {
        QByteArray png = testPictureBytes(QStringLiteral("png-type2.png"));
        png[25] = 5;
        QCOMPARE(infoOf(png), ImageInfo{});
        // ... unless the JPEG start sequence occurs in it: then it is read as a JPEG.
        QCOMPARE(infoOf(png + jpegWithFrame(0xC0)), jpeg200x300());
    }

    void frameHeaderMarkersEndTheWalk_data()
    {
        QTest::addColumn<int>("marker");
        for (int marker = 0xC0; marker <= 0xCF; ++marker) {
            if (marker != 0xC4 && marker != 0xC8 && marker != 0xCC)
                QTest::newRow(qPrintable(QString::number(marker, 16).toUpper())) << marker;
        }
    }
    void frameHeaderMarkersEndTheWalk()
    {
        QFETCH(int, marker);
        const QList<QPair<uchar, int>> segments{{0xE0, 16}, {0xE1, 34}, {0xDB, 67}};
        QCOMPARE(infoOf(jpegWithFrame(static_cast<uchar>(marker), segments)), jpeg200x300());
    }

    void otherSegmentsAreWalkedOver_data()
    {
        QTest::addColumn<int>("marker");
        QTest::addColumn<int>("length");
        QTest::newRow("Huffman tables C4") << 0xC4 << 30;
        QTest::newRow("reserved C8") << 0xC8 << 6;
        QTest::newRow("arithmetic conditioning CC") << 0xCC << 4;
        QTest::newRow("a segment of 65535 bytes") << 0xE2 << 65535;
    }
    void otherSegmentsAreWalkedOver()
    {
        QFETCH(int, marker);
        QFETCH(int, length);
        // The segment's data looks like a frame header; the walk must jump over it.
        QCOMPARE(infoOf(jpegWithFrame(0xC0, {{static_cast<uchar>(marker), length}})), jpeg200x300());
    }

    void findsTheJpegStartBehindAWrapper_data()
    {
        QTest::addColumn<qsizetype>("wrapper");
        QTest::addColumn<bool>("found");
        QTest::newRow("128 bytes") << qsizetype(128) << true;
        // The search reads in blocks of 4096 bytes: a start sequence across two blocks.
        QTest::newRow("across blocks 1") << qsizetype(4093) << true;
        QTest::newRow("across blocks 2") << qsizetype(4094) << true;
        QTest::newRow("across blocks 3") << qsizetype(4095) << true;
        QTest::newRow("last place within the limit") << qsizetype(JpegSearchLimit - 1) << true;
        // Past the search limit the data is not taken for a picture.
        QTest::newRow("beyond the limit") << qsizetype(JpegSearchLimit) << false;
    }
    void findsTheJpegStartBehindAWrapper()
    {
        QFETCH(qsizetype, wrapper);
        QFETCH(bool, found);
        const QByteArray jpeg = testPictureBytes(QStringLiteral("baseline-exif.jpg"));
        const ImageInfo expected = found ? ImageInfo{ImageInfo::JPEG, 640, 480} : ImageInfo{};
        QCOMPARE(infoOf(QByteArray(wrapper, '\0') + jpeg), expected);
    }

    void damagedDataIsNotRecognised_data()
    {
        QTest::addColumn<QByteArray>("data");
        QTest::newRow("empty") << QByteArray();
        QTest::newRow("two bytes") << QByteArray("BM");
        QTest::newRow("text") << QByteArray("Hello, this is not a picture at all.\n");
        QTest::newRow("PNG signature only") << QByteArray("\x89PNG\r\n\x1A\n", 8);
        QTest::newRow("GIF signature only") << QByteArray("GIF89a");
        QTest::newRow("JPEG start only") << QByteArray("\xFF\xD8\xFF", 3);
        QTest::newRow("JPEG frame header cut short") << jpegWithFrame(0xC0).left(8);
        QTest::newRow("JPEG segment beyond the end") << jpegWithFrame(0xC0, {{0xE1, 200}}).left(40);
        QTest::newRow("BMP with the lowest height") << QByteArray::fromHex("424D"
                                                                           "00000000"
                                                                           "00000000"
                                                                           "36000000"
                                                                           "28000000"
                                                                           "01000000"
                                                                           "00000080");
        QTest::newRow("PNG wider than 2^31-1") << QByteArray::fromHex("89504E470D0A1A0A"
                                                                      "0000000D49484452"
                                                                      "80000000"
                                                                      "00000001"
                                                                      "0802000000");
        const QStringList pictures{QStringLiteral("png-type2.png"), QStringLiteral("picture.gif"),
                                   QStringLiteral("bottom-up.bmp"), QStringLiteral("baseline-exif.jpg")};
        for (const QString &picture : pictures) {
            // Cut just before the last header byte the reader needs.
            const QByteArray bytes = testPictureBytes(picture);
            const qsizetype cut = picture.endsWith(QLatin1String(".png"))   ? 25
                                  : picture.endsWith(QLatin1String(".gif")) ? 9
                                  : picture.endsWith(QLatin1String(".bmp")) ? 25
                                                                            : bytes.indexOf("\xFF\xC0") + 8;
            QTest::newRow(qPrintable(picture + QStringLiteral(" cut short"))) << bytes.left(cut);
        }
    }
    void damagedDataIsNotRecognised()
    {
        QFETCH(QByteArray, data);
        QCOMPARE(infoOf(data), ImageInfo{});
    }

    void missingFilesAreNotRecognised()
    {
        QTemporaryDir folder;
        QCOMPARE(GetImageInfo(folder.filePath(QStringLiteral("none.png"))), ImageInfo{});
        QCOMPARE(GetImageInfo(folder.path()), ImageInfo{});
        QCOMPARE(GetImageInfo(QString()), ImageInfo{});
    }

    void readsOnlyTheHeaderBytes_data()
    {
        QTest::addColumn<QByteArray>("data");
        QTest::addColumn<qint64>("mostBytes");
        const QByteArray wideBmp = testPictureBytes(QStringLiteral("wide.bmp"));
        QTest::newRow("a BMP of 960 kB") << wideBmp << qint64(4096);
        QTest::newRow("a JPEG behind a comment of 40 kB")
            << testPictureBytes(QStringLiteral("long-comment.jpg")) << qint64(3 * 4096);
        // A large file of another kind: the JPEG search stops at its limit.
        QTest::newRow("8 MB of zeros") << QByteArray(8 << 20, '\0') << qint64(JpegSearchLimit + 4096);
    }
    void readsOnlyTheHeaderBytes()
    {
        QFETCH(QByteArray, data);
        QFETCH(qint64, mostBytes);
        CountingBuffer buffer(&data);
        buffer.open(QIODevice::ReadOnly);
        GetImageInfo(buffer);
        QVERIFY2(buffer.bytesRead <= mostBytes, qPrintable(QString::number(buffer.bytesRead)));
    }
};

ZORBIN_TEST_CLASS(ImageHeaderTest)
#include "ImageHeaderTest.moc"
