#include "TestPictures.h"
#include "output/ImageDimensions.h"
#include "platform/FileSystem.h"
#include "testutil/TestMain.h"

#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

Q_DECLARE_METATYPE(ImageInfo)

// Fitting pictures into the largest picture box, and the size attributes of the pages.
class ImageSizeTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void fitsIntoTheBox_data()
    {
        QTest::addColumn<ImageInfo>("info");
        QTest::addColumn<QSize>("box");
        QTest::addColumn<QSize>("fitted"); // invalid: no size
        const auto png = [](int width, int height) { return ImageInfo{ImageInfo::PNG, width, height}; };
        const QSize box(120, 90);
        QTest::newRow("within the box keeps its size") << png(100, 80) << box << QSize(100, 80);
        QTest::newRow("exactly the box") << png(120, 90) << box << QSize(120, 90);
        QTest::newRow("exactly as wide") << png(120, 45) << box << QSize(120, 45);
        QTest::newRow("exactly as high") << png(7, 90) << box << QSize(7, 90);
        QTest::newRow("width bound") << png(240, 90) << box << QSize(120, 45);
        QTest::newRow("height bound") << png(200, 300) << box << QSize(60, 90);
        QTest::newRow("a tie goes to the height") << png(240, 180) << box << QSize(120, 90);
        QTest::newRow("a half rounds to even") << png(240, 3) << box << QSize(120, 2);      // 1.5 -> 2
        QTest::newRow("a half rounds down to even") << png(240, 5) << box << QSize(120, 2); // 2.5 -> 2
        QTest::newRow("wide keeps one pixel") << png(40000, 8) << box << QSize(120, 1);
        QTest::newRow("tall keeps one pixel") << png(8, 70000) << box << QSize(1, 90);
        QTest::newRow("largest sides") << png(2147483647, 2147483647) << box << QSize(90, 90);
        QTest::newRow("not recognised") << ImageInfo{} << box << QSize();
        QTest::newRow("not recognised with a size")
            << ImageInfo{ImageInfo::Unknown, 10, 10} << box << QSize();
        QTest::newRow("no width") << ImageInfo{ImageInfo::GIF, 0, 10} << box << QSize();
        QTest::newRow("no height") << ImageInfo{ImageInfo::JPEG, 10, 0} << box << QSize();
        QTest::newRow("box without width") << png(10, 10) << QSize(0, 90) << QSize();
        QTest::newRow("box without height") << png(10, 10) << QSize(120, 0) << QSize();
    }
    void fitsIntoTheBox()
    {
        QFETCH(ImageInfo, info);
        QFETCH(QSize, box);
        QFETCH(QSize, fitted);
        QCOMPARE(fittedImageSize(info, box.width(), box.height()).value_or(QSize()), fitted);
    }

    // The attributes of the pages, each header read once in a run however many items show it.
    void sizeAttributesOfPictureFiles()
    {
        ImageSizes sizes(localFileSystem());
        const std::pair<QString, QString> cases[] = {
            {testPicture(u"png-type0.png"_qs), u" width=100 height=80"_qs},
            {testPicture(u"png-type2.png"_qs), u" width=120 height=45"_qs},
            {testPicture(u"progressive-exif.jpg"_qs), u" width=60 height=90"_qs},
            {testPicture(u"wide.bmp"_qs), u" width=120 height=1"_qs},
            {testPicture(u"long-comment.txt"_qs), QString()}, // not a picture
            {testPicture(u"missing.png"_qs), QString()},
            {testPicture(u"png-type?.png"_qs), QString()}, // names, not patterns
            {testPicture(u"*.png"_qs), QString()},
            {u"?"_qs, QString()}, // the no-picture mark
            {QString(), QString()},
        };
        for (int item = 0; item < 100; ++item) {
            for (const auto &[file, attributes] : cases)
                QCOMPARE(sizes.sizeAttr(file, 120, 90), attributes);
        }
        QCOMPARE(sizes.headersRead(), 5);
        // Another box is fitted from the header already read.
        QCOMPARE(sizes.sizeAttr(testPicture(u"png-type2.png"_qs), 60, 90),
                 u" width=60 height=22"_qs); // 22.5 to even
        QCOMPARE(sizes.sizeAttr(testPicture(u"png-type2.png"_qs), 0, 90), QString());
        QCOMPARE(sizes.headersRead(), 5);
    }
};

ZORBIN_TEST_CLASS(ImageSizeTest)
#include "ImageSizeTest.moc"
