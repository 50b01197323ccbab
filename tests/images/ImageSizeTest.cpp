#include "TestPictures.h"
#include "output/ImageDimensions.h"
#include "testutil/FaultyFileSystem.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"

#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

// Fitting pictures into the largest picture box, and the size attributes of the pages.
class ImageSizeTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void fitsIntoTheBox_data()
    {
        QTest::addColumn<int>("width");
        QTest::addColumn<int>("height");
        QTest::addColumn<QSize>("fitted");
        QTest::newRow("within the box keeps its size") << 100 << 80 << QSize(100, 80);
        QTest::newRow("exactly the box") << 120 << 90 << QSize(120, 90);
        QTest::newRow("width bound") << 240 << 90 << QSize(120, 45);
        QTest::newRow("height bound") << 200 << 300 << QSize(60, 90);
        QTest::newRow("a tie goes to the height") << 240 << 180 << QSize(120, 90);
        QTest::newRow("a half rounds to even") << 240 << 3 << QSize(120, 2);      // 1.5 -> 2
        QTest::newRow("a half rounds down to even") << 240 << 5 << QSize(120, 2); // 2.5 -> 2
        QTest::newRow("wide keeps one pixel") << 40000 << 8 << QSize(120, 1);
        QTest::newRow("tall keeps one pixel") << 8 << 70000 << QSize(1, 90);
        QTest::newRow("largest sides") << 2147483647 << 2147483647 << QSize(90, 90);
    }
    void fitsIntoTheBox()
    {
        QFETCH(int, width);
        QFETCH(int, height);
        QFETCH(QSize, fitted);
        QCOMPARE(fittedImageSize({ImageInfo::PNG, width, height}, 120, 90), std::optional<QSize>(fitted));
    }

    void noSizeWithoutAPictureOrABox_data()
    {
        QTest::addColumn<ImageInfo>("info");
        QTest::addColumn<int>("maxWidth");
        QTest::addColumn<int>("maxHeight");
        QTest::newRow("not recognised") << ImageInfo{} << 120 << 90;
        QTest::newRow("not recognised with a size") << ImageInfo{ImageInfo::Unknown, 10, 10} << 120 << 90;
        QTest::newRow("no width") << ImageInfo{ImageInfo::GIF, 0, 10} << 120 << 90;
        QTest::newRow("no height") << ImageInfo{ImageInfo::JPEG, 10, 0} << 120 << 90;
        QTest::newRow("box without width") << ImageInfo{ImageInfo::PNG, 10, 10} << 0 << 90;
        QTest::newRow("box without height") << ImageInfo{ImageInfo::PNG, 10, 10} << 120 << -1;
    }
    void noSizeWithoutAPictureOrABox()
    {
        QFETCH(ImageInfo, info);
        QFETCH(int, maxWidth);
        QFETCH(int, maxHeight);
        QCOMPARE(fittedImageSize(info, maxWidth, maxHeight), std::nullopt);
    }

    void attributesOfPictureFiles_data()
    {
        QTest::addColumn<QString>("file");
        QTest::addColumn<QString>("attributes");
        QTest::newRow("100x80") << testPicture(QStringLiteral("png-type0.png")) << u" width=100 height=80"_qs;
        QTest::newRow("240x90") << testPicture(QStringLiteral("png-type2.png")) << u" width=120 height=45"_qs;
        QTest::newRow("200x300") << testPicture(QStringLiteral("progressive-exif.jpg"))
                                 << u" width=60 height=90"_qs;
        QTest::newRow("240x180") << testPicture(QStringLiteral("png-type4.png"))
                                 << u" width=120 height=90"_qs;
        QTest::newRow("40000x8") << testPicture(QStringLiteral("wide.bmp")) << u" width=120 height=1"_qs;
        QTest::newRow("not a picture") << testPicture(QStringLiteral("long-comment.txt")) << QString();
        QTest::newRow("missing") << testPicture(QStringLiteral("missing.png")) << QString();
        QTest::newRow("the no-picture mark") << u"?"_qs << QString();
        QTest::newRow("empty reference") << QString() << QString();
    }
    void attributesOfPictureFiles()
    {
        QFETCH(QString, file);
        QFETCH(QString, attributes);
        QCOMPARE(ImageSizeAttr(file, 120, 90), attributes);
        ImageSizes sizes(localFileSystem());
        QCOMPARE(sizes.sizeAttr(file, 120, 90), attributes);
    }

    void noAttributesWithoutABox()
    {
        const QString picture = testPicture(QStringLiteral("png-type2.png"));
        QCOMPARE(ImageSizeAttr(picture, 0, 90), QString());
        QCOMPARE(ImageSizeAttr(picture, 120, 0), QString());
    }

    void wildcardsAreNotPatterns()
    {
        QTemporaryDir folder;
        writeFile(folder.filePath(QStringLiteral("a.png")),
                  testPictureBytes(QStringLiteral("png-type0.png")));
        QCOMPARE(ImageSizeAttr(folder.filePath(QStringLiteral("?.png")), 120, 90), QString());
        QCOMPARE(ImageSizeAttr(folder.filePath(QStringLiteral("*.png")), 120, 90), QString());
        QCOMPARE(ImageSizeAttr(folder.filePath(QStringLiteral("a.png")), 120, 90),
                 u" width=100 height=80"_qs);
    }

    void eachHeaderIsReadOncePerRun()
    {
        FaultyFileSystem files;
        ImageSizes sizes(files);
        const QString shared = testPicture(QStringLiteral("png-type2.png"));
        const QString other = testPicture(QStringLiteral("picture.gif"));
        const QString missing = testPicture(QStringLiteral("missing.png"));
        for (int item = 0; item < 1000; ++item) {
            QCOMPARE(sizes.sizeAttr(shared, 120, 90), u" width=120 height=45"_qs);
            QCOMPARE(sizes.sizeAttr(other, 120, 90), u" width=16 height=17"_qs);
            QCOMPARE(sizes.sizeAttr(missing, 120, 90), QString());
        }
        // Another box is fitted from the header already read.
        QCOMPARE(sizes.sizeAttr(shared, 60, 90), u" width=60 height=22"_qs); // 22.5 to even
        QCOMPARE(sizes.headersRead(), 2);
        QCOMPARE(sizes.info(shared), (ImageInfo{ImageInfo::PNG, 240, 90}));
    }
};

ZORBIN_TEST_CLASS(ImageSizeTest)
#include "ImageSizeTest.moc"
