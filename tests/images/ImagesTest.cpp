// The pictures of a catalog: the header readers on ImageMagick's pictures (made at build time) and
// on damaged data, the fitting into the picture box, the copying into the images folder.
#include "output/CopiedPictures.h"
#include "output/ImageCollection.h"
#include "output/ImageDimensions.h"
#include "platform/ForwardingFileSystem.h"
#include "testutil/DamagedWorkDatabase.h"
#include "testutil/FaultyFileSystem.h"
#include "testutil/OutputContext.h"
#include "testutil/TestFiles.h"
#include "testutil/WorkDatabaseFixture.h"
#include "workdb/SqliteEngine.h"

#include <QBuffer>
#include <QDir>
#include <QFileInfo>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

Q_DECLARE_METATYPE(ImageInfo)

namespace {

QString testPicture(const QString &name)
{
    return QStringLiteral(ZORBIN_TEST_PICTURES "/") + name;
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
        data += QByteArray("\xFF") + char(marker) + char(length >> 8) + char(length & 0xFF) +
                QByteArray(length - 2, '\x11');
    }
    // Length, precision, height, width, components; the components; the end marker.
    return data + '\xFF' + char(frameMarker) + QByteArray::fromHex("0011 08 012C 00C8 03") +
           QByteArray(9, '\x01') + QByteArray::fromHex("FFD9");
}

// The real file system, failing the paths of `inner.failingPaths` and naming the copies it
// makes, in order.
class CountingFileSystem final : public ForwardingFileSystem
{
public:
    CountingFileSystem() : ForwardingFileSystem(static_cast<FileSystem &>(inner)) {}

    Status copyFile(const QString &from, const QString &to) override
    {
        copies << QFileInfo(to).fileName();
        return ForwardingFileSystem::copyFile(from, to);
    }

    QStringList copies;
    FaultyFileSystem inner;
};

// A catalog run's surroundings: a pictures folder, an empty images folder and a working
// database whose items show the picture and the key, sorted by key.
struct Catalog
{
    Catalog()
    {
        QDir(root.path()).mkpath(u"pictures"_qs);
        QDir(root.path()).mkpath(u"images"_qs);
        output.settings.lines[0].field = 0;
        output.settings.lines[1].field = 2;
        output.settings.sortKey = SortKey::ItemKey;
        output.settings.sortDirection = SortDirection::Ascending;
    }

    QString picture(const QString &name) const { return root.filePath(u"pictures/"_qs + name); }
    QString images() const { return root.filePath(u"images"_qs); }
    QString database() const { return root.filePath(u"zorbindb.tmp"_qs); }
    QStringList imageFiles() const
    {
        QStringList names = QDir(images()).entryList(QDir::Files, QDir::Name);
        names.removeAll(CopiedPictures::RecordName);
        return names;
    }
    QStringList recorded() const { return CopiedPictures::read(files, images()); }

    // Picture files "p01.jpg" to `count` in the pictures folder, each holding its own name.
    QStringList pictures(int count) const
    {
        QStringList references;
        for (int i = 1; i <= count; ++i) {
            const QString name = u"p%1.jpg"_qs.arg(i, 2, 10, QLatin1Char('0'));
            writeFile(picture(name), name.toLatin1());
            references << picture(name);
        }
        return references;
    }

    // Items "A01", "A02", ... showing the given references (a null text: null); the items at
    // the places `leftOut` are not in the catalog.
    void makeItems(const QStringList &references, const QList<int> &leftOut = {})
    {
        WorkRows rows;
        for (qsizetype i = 0; i < references.size(); ++i) {
            rows.items << WorkItem{.key = u"A%1"_qs.arg(i + 1, 2, 10, QLatin1Char('0')),
                                   .picture = references.at(i).isNull() ? QVariant() : references.at(i),
                                   .include = !leftOut.contains(i)};
        }
        QVERIFY(makeWorkDatabase(database(), rows).isOk());
    }

    Status collect() { return CollectCatImages(output.context, images(), database()); }

    QTemporaryDir root;
    CountingFileSystem files;
    OutputContext output{files};
};

} // namespace

class ImagesTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase() { QVERIFY(setUpSqliteEngine()); } // as the programs do

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
        QCOMPARE(infoOf(readFile(testPicture(file))), expected);
    }

    void readsData_data()
    {
        QTest::addColumn<QByteArray>("data");
        QTest::addColumn<ImageInfo>("expected");
        const ImageInfo none;
        const ImageInfo jpeg{ImageInfo::JPEG, 200, 300};
        const QByteArray bmp = readFile(testPicture(u"bottom-up.bmp"_qs));
        // A top-down bitmap stores its height negative.
        QTest::newRow("top-down bitmap")
            << QByteArray::fromHex("424D 00000000 00000000 36000000 28000000 20030000 A8FDFFFF")
            << ImageInfo{ImageInfo::BMP, 800, 600};
        QByteArray png = readFile(testPicture(u"png-type2.png"_qs));
        QTest::newRow("PNG signature without its first byte") << QByteArray("x") + png.mid(1) << none;
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
        const QByteArray exif = readFile(testPicture(u"baseline-exif.jpg"_qs));
        for (const qsizetype wrapper : {qsizetype(128), qsizetype(4093), qsizetype(4094), qsizetype(4095),
                                        qsizetype(JpegSearchLimit - 1), qsizetype(JpegSearchLimit)}) {
            QTest::addRow("behind %lld bytes", static_cast<long long>(wrapper))
                << QByteArray(wrapper, '\0') + exif
                << (wrapper < JpegSearchLimit ? ImageInfo{ImageInfo::JPEG, 640, 480} : none);
        }
        QTest::newRow("empty") << QByteArray() << none;
        QTest::newRow("text") << QByteArray("Hello, this is not a picture at all.\n") << none;
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
            {"PNG", readFile(testPicture(u"png-type2.png"_qs)), 26, {ImageInfo::PNG, 240, 90}},
            {"GIF", readFile(testPicture(u"picture.gif"_qs)), 10, {ImageInfo::GIF, 16, 17}},
            {"BMP", bmp, 26, {ImageInfo::BMP, 800, 600}},
            {"core BMP", readFile(testPicture(u"core-header.bmp"_qs)), 22, {ImageInfo::BMP, 120, 90}},
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

    void fitsIntoTheBox_data()
    {
        QTest::addColumn<ImageInfo>("info");
        QTest::addColumn<QSize>("box");
        QTest::addColumn<QSize>("fitted"); // invalid: no size
        const auto png = [](int width, int height) { return ImageInfo{ImageInfo::PNG, width, height}; };
        const QSize box(120, 90);
        QTest::newRow("within the box keeps its size") << png(100, 80) << box << QSize(100, 80);
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

    // The logo, then each picture once, in catalog order; references are looked up literally,
    // and those that name no file are no fault.
    void copiesTheCatalogsPictures()
    {
        Catalog catalog;
        const QStringList p = catalog.pictures(4);
        const QByteArray large = QByteArray(100 * 1024, 'p') + "end"; // more than one block of the copy
        writeFile(p[3], large);
        writeFile(catalog.picture(u"?"_qs)); // a file named as the no-picture mark
        writeFile(catalog.picture(u"logo.png"_qs), "logo");
        catalog.output.settings.logo = catalog.picture(u"logo.png"_qs);
        catalog.makeItems({p[3], p[0], p[2], p[0], catalog.picture(u"missing.jpg"_qs), u"?"_qs, QString(),
                           u""_qs, catalog.picture(u"p?1.jpg"_qs), catalog.picture(u"*.jpg"_qs),
                           catalog.root.path(), catalog.picture(u"P02.JPG"_qs)},
                          {2});
        catalog.output.settings.sortDirection = SortDirection::Descending;
        const QString previous = QDir::currentPath();
        QDir::setCurrent(catalog.picture(QString())); // where a relative "?" would be looked up
        const Status status = catalog.collect();
        QDir::setCurrent(previous);
        QVERIFY2(status.isOk(), qPrintable(status.description()));
        // "P02.JPG" is found as "p02.jpg" and copied under the name the pages give it.
        const QStringList copied{u"logo.png"_qs, u"P02.JPG"_qs, u"p01.jpg"_qs, u"p04.jpg"_qs};
        QCOMPARE(catalog.files.copies, copied);
        QCOMPARE(catalog.recorded(), copied);
        QCOMPARE(readFile(catalog.images() + u"/p04.jpg"_qs), large);
        QCOMPARE(readFile(catalog.images() + u"/P02.JPG"_qs), QByteArray("p02.jpg"));
        // 11 items: after items 5 and 10, 5/11 and 10/11 of the frame of 1000, then back to 0.
        QCOMPARE(catalog.output.user.widths, (QList<int>{0, 455, 909, 0}));
        QCOMPARE(catalog.output.user.yields, 2);
    }

    void aStopKeepsTheCopiesMadeSoFar()
    {
        Catalog catalog;
        catalog.makeItems(catalog.pictures(12));
        catalog.output.settings.logo = catalog.picture(u"no-logo.png"_qs); // a missing logo is no fault
        catalog.output.user.onYield = [&catalog] { catalog.output.state.StopRequested = true; };
        QVERIFY(catalog.collect().isOk());
        QCOMPARE(catalog.imageFiles(),
                 (QStringList{u"p01.jpg"_qs, u"p02.jpg"_qs, u"p03.jpg"_qs, u"p04.jpg"_qs, u"p05.jpg"_qs}));
        QCOMPARE(catalog.recorded(), catalog.imageFiles());
        // The bar stays where the stop found it.
        QCOMPARE(catalog.output.user.widths, (QList<int>{0, 417}));
    }

    void aFailedCopyKeepsTheCopiesMadeSoFar()
    {
        Catalog catalog;
        catalog.makeItems(catalog.pictures(6));
        catalog.files.inner.failingPaths << catalog.images() + u"/p04.jpg"_qs;
        const Status status = catalog.collect();
        QVERIFY(!status.isOk());
        QVERIFY2(status.description().contains(u"p04.jpg"_qs), qPrintable(status.description()));
        QCOMPARE(catalog.imageFiles(), (QStringList{u"p01.jpg"_qs, u"p02.jpg"_qs, u"p03.jpg"_qs}));
        QCOMPARE(catalog.recorded(), catalog.imageFiles());
    }

    void aPictureInTheImagesFolderIsNoCopy()
    {
        Catalog catalog;
        const QString own = catalog.images() + u"/own.jpg"_qs;
        writeFile(own, "own");
        catalog.makeItems({own});
        QVERIFY(catalog.collect().isOk());
        // Not recorded, so the next run does not delete the user's own picture.
        QVERIFY(catalog.recorded().isEmpty());
        QVERIFY(CopiedPictures::removeAll(catalog.files, catalog.images()).isOk());
        QCOMPARE(readFile(own), QByteArray("own"));
    }

    void anUnreadableWorkingDatabaseIsAFault()
    {
        Catalog catalog;
        QVERIFY(!catalog.collect().isOk()); // none at all
        // The engine fails reading the last item: not the end of the catalog's pictures.
        catalog.makeItems(catalog.pictures(3));
        QVERIFY(breakReadingAt(catalog.database(), u"A03"_qs).isOk());
        catalog.output.settings.lines[2].field = 4;
        const Status status = catalog.collect();
        QVERIFY(!status.isOk());
        QVERIFY2(status.description().contains(u"overflow"_qs), qPrintable(status.description()));
    }
};

QTEST_GUILESS_MAIN(ImagesTest)
#include "ImagesTest.moc"
