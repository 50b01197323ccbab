// Thumbnails: their sizes, orientation and background, and the cache that spares a second run
// any decoding.
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"
#include "web/ThumbnailImages.h"
#include "web/ThumbnailStore.h"

#include <QBuffer>
#include <QDir>
#include <QFile>
#include <QImage>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;

namespace {

const QSize Box(120, 90);

QByteArray encoded(const QImage &image, const char *format)
{
    QByteArray bytes;
    QBuffer buffer(&bytes);
    buffer.open(QIODevice::WriteOnly);
    image.save(&buffer, format);
    return bytes;
}

// Left half red, right half blue, so that a turn shows where the halves went.
QImage halves(QSize size)
{
    QImage image(size, QImage::Format_RGB32);
    image.fill(Qt::blue);
    for (int y = 0; y < size.height(); ++y) {
        for (int x = 0; x < size.width() / 2; ++x)
            image.setPixel(x, y, qRgb(255, 0, 0));
    }
    return image;
}

// A JPEG whose EXIF orientation (6) says that it is shown turned a quarter clockwise.
QByteArray turnedJpeg(const QImage &image)
{
    const QByteArray exif("Exif\0\0II*\0\x08\0\0\0\x01\0\x12\x01\x03\0\x01\0\0\0\x06\0\0\0\0\0\0\0", 32);
    const QByteArray segment = QByteArray("\xFF\xE1\0", 3) + char(exif.size() + 2) + exif;
    const QByteArray jpeg = encoded(image, "JPEG");
    return jpeg.left(2) + segment + jpeg.mid(2);
}

bool isRed(QRgb pixel)
{
    return qRed(pixel) > 200 && qBlue(pixel) < 60;
}

} // namespace

class ThumbnailTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void sizes_data()
    {
        QTest::addColumn<QSize>("picture");
        QTest::addColumn<QByteArray>("format");
        QTest::addColumn<QSize>("single");
        QTest::addColumn<QSize>("twice"); // empty: no 2x thumbnail
        QTest::newRow("camera picture") << QSize(1600, 1200) << QByteArray("JPEG") << Box << Box * 2;
        QTest::newRow("tall") << QSize(400, 1200) << QByteArray("JPEG") << QSize(30, 90) << QSize(60, 180);
        QTest::newRow("between the box and twice")
            << QSize(200, 100) << QByteArray("PNG") << QSize(120, 60) << QSize(200, 100);
        QTest::newRow("within the box") << QSize(100, 50) << QByteArray("PNG") << QSize(100, 50) << QSize();
    }
    void sizes()
    {
        QFETCH(QSize, picture);
        QFETCH(QByteArray, format);
        QFETCH(QSize, single);
        QFETCH(QSize, twice);
        const auto made = makeThumbnailImages(encoded(halves(picture), format.constData()), Box);
        QVERIFY(made);
        QCOMPARE(made->single.size(), single);
        QCOMPARE(made->twice.isNull() ? QSize() : made->twice.size(), twice);
    }

    void exifOrientationTurnsThePicture()
    {
        const auto made = makeThumbnailImages(turnedJpeg(halves(QSize(600, 400))), Box);
        QVERIFY(made);
        QCOMPARE(made->single.size(), QSize(60, 90));
        // A quarter turn clockwise brings the left half to the top.
        QVERIFY(isRed(made->single.pixel(30, 5)));
        QVERIFY(!isRed(made->single.pixel(30, 85)));
    }

    void transparencyOnWhite()
    {
        QImage clear(QSize(40, 30), QImage::Format_ARGB32);
        clear.fill(Qt::transparent);
        const auto made = makeThumbnailImages(encoded(clear, "PNG"), Box);
        QVERIFY(made);
        QCOMPARE(made->single.pixel(10, 10), qRgb(255, 255, 255));
    }

    // The cache: a second run decodes nothing; a changed picture gets a new name, and the old
    // thumbnails go when nothing uses them; a picture that is not one gets the placeholder.
    void cacheAcrossRuns()
    {
        QTemporaryDir dir;
        const QStringList pictures = {dir.filePath(QStringLiteral("photo.jpg")),
                                      dir.filePath(QStringLiteral("drawing.png")),
                                      dir.filePath(QStringLiteral("broken.jpg"))};
        test::writeFile(pictures[0], encoded(halves(QSize(800, 600)), "JPEG"));
        test::writeFile(pictures[1], encoded(halves(QSize(100, 80)), "PNG"));
        test::writeFile(pictures[2], "not a picture");
        const QString site = dir.path() + QStringLiteral("/");
        int decoded = -1;
        const auto run = [&] {
            auto store = ThumbnailStore::open(site);
            QList<Thumbnail> made;
            for (const QString &picture : pictures) {
                const auto thumbnail = store.value()->thumbnailOf(picture, Box);
                made << (thumbnail ? thumbnail.value() : Thumbnail());
            }
            decoded = store.value()->decoded();
            return store.value()->removeUnused().isOk() && store.value()->saveRecord(false).isOk()
                       ? made
                       : QList<Thumbnail>();
        };
        const QList<Thumbnail> first = run();
        QCOMPARE(decoded, 3);
        QCOMPARE(first[0].size, Box);
        QVERIFY(test::readFile(site + first[0].twiceFile).contains("\xFF\xC2")); // progressive
        QCOMPARE(first[2], (Thumbnail{QStringLiteral("pictures/placeholder.svg"), QString(), Box}));
        QCOMPARE(run(), first);
        QCOMPARE(decoded, 0);

        test::writeFile(pictures[0], encoded(halves(QSize(600, 800)), "JPEG"));
        QFile(pictures[0])
            .setFileTime(QDateTime::currentDateTime().addSecs(5), QFileDevice::FileModificationTime);
        const QList<Thumbnail> changed = run();
        QCOMPARE(decoded, 1);
        QVERIFY(changed[0].file != first[0].file);
        QCOMPARE(changed[0].size, QSize(68, 90));
        QVERIFY(!QFile::exists(site + first[0].file) && !QFile::exists(site + first[0].twiceFile));
        QVERIFY(QFile::exists(site + changed[0].file) && QFile::exists(site + changed[1].file));
    }
};

ZORBIN_TEST_CLASS(ThumbnailTest)
#include "ThumbnailTest.moc"
