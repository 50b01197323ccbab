// The web catalog: thumbnails and their cache, the item spool, and whole runs of the site writer on
// a small working database: what the pages hold and refer to, what a stop, a failure, no items leave.
#include "testutil/FaultyFileSystem.h"
#include "testutil/OutputContext.h"
#include "testutil/Pictures.h"
#include "testutil/TestFiles.h"
#include "testutil/WorkDatabaseFixture.h"
#include "web/CatalogSite.h"
#include "web/ItemSpool.h"
#include "web/SiteNames.h"
#include "web/ThumbnailImages.h"
#include "web/ThumbnailStore.h"
#include "workdb/SqliteEngine.h"

#include <QDirIterator>
#include <QRegularExpression>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;
using namespace Qt::Literals::StringLiterals;

namespace {

const QSize Box(120, 90);

// Two items a page: the picture, the name, the key and the price, in the order of the keys.
struct SiteRun : test::OutputContext
{
    explicit SiteRun(FileSystem &files = localFileSystem()) : OutputContext(files)
    {
        settings.rows = 1;
        settings.columns = 2;
        for (std::size_t line = 0; const int field : {0, 2, 1, 4})
            settings.lines[line++].field = field;
        settings.priceList1.setCurrentIndex(settings.priceList1.addEntry(u"מחיר"_s, 0));
    }
};

// Every file under the folder by its path inside it, with its bytes; but the thumbnails' cache
// record, which may list its entries in any order.
QMap<QString, QByteArray> contents(const QString &folder)
{
    QMap<QString, QByteArray> files;
    for (QDirIterator it(folder, QDir::Files | QDir::Hidden, QDirIterator::Subdirectories); it.hasNext();) {
        const QString path = it.next();
        files.insert(QDir(folder).relativeFilePath(path), test::readFile(path));
    }
    files.remove(u"pictures/thumbnails.txt"_s);
    return files;
}

} // namespace

class WebTest : public QObject
{
    Q_OBJECT

    QTemporaryDir m_dir;
    QString m_db;

    QString site() const { return m_dir.filePath(u"site"_s); }

    Result<QString> write(SiteRun &run, bool sections = true, const QString &db = {})
    {
        return CreateCatSite(run.context, SiteRequest{site(), db.isEmpty() ? m_db : db, sections});
    }

private Q_SLOTS:
    // Five items in two sort groups and none, with marks in their names, and pictures that
    // exist, are missing, or are not named.
    void initTestCase()
    {
        QVERIFY(setUpSqliteEngine()); // as the programs do
        const QString photo = m_dir.filePath(u"photo.jpg"_s);
        test::writeFile(photo, halves({640, 480}));
        test::WorkRows rows;
        const auto item = [&](const char *key, const QString &name, QVariant sort, QVariant picture) {
            rows.items << test::WorkItem{QLatin1String(key), name, sort, {}, {}, 1234.5, u"ש\"ח"_s, picture};
        };
        item("K1", u"כיסא <b>&\"'"_s, 2, photo);
        item("K2", u"Lamp 😀 灯"_s, 1, m_dir.filePath(u"missing.jpg"_s));
        item("K3", u"שולחן"_s, {}, u"?"_s);
        item("K4", u"ארון"_s, 2, photo);
        item("K5", u"מדף"_s, 1, {});
        rows.other[u"tItemSort"_s] = {{1, u"ריהוט"_s}, {2, QVariant()}};
        m_db = m_dir.filePath(u"work.db"_s);
        const Status made = test::makeWorkDatabase(m_db, rows);
        QVERIFY2(made, qPrintable(made.description()));
    }

    // Fitted into the box and into twice the box, never enlarged, turned upright as its EXIF
    // orientation says, transparent parts on white.
    void thumbnails_data()
    {
        QImage clear(40, 30, QImage::Format_ARGB32);
        clear.fill(Qt::transparent);
        const QRgb red = qRgb(255, 0, 0), blue = qRgb(0, 0, 255), white = qRgb(255, 255, 255);
        QTest::addColumn<QByteArray>("picture");
        QTest::addColumn<QSize>("single");
        QTest::addColumn<QSize>("twice"); // empty: no 2x thumbnail
        QTest::addColumn<QRgb>("corner"); // at the bottom left
        QTest::newRow("camera picture") << halves({1600, 1200}) << Box << Box * 2 << red;
        QTest::newRow("tall") << halves({400, 1200}) << QSize(30, 90) << QSize(60, 180) << red;
        QTest::newRow("between box and twice")
            << halves({200, 100}, "PNG") << QSize(120, 60) << QSize(200, 100) << red;
        QTest::newRow("within the box") << halves({100, 50}, "PNG") << QSize(100, 50) << QSize() << red;
        // A quarter turn clockwise brings the left half to the top, the right to the bottom.
        QTest::newRow("EXIF orientation") << turned({600, 400}) << QSize(60, 90) << QSize(120, 180) << blue;
        QTest::newRow("transparent") << encoded(clear, "PNG") << QSize(40, 30) << QSize() << white;
    }
    void thumbnails()
    {
        QFETCH(QByteArray, picture);
        QFETCH(QSize, single);
        QFETCH(QSize, twice);
        QFETCH(QRgb, corner);
        const auto made = makeThumbnailImages(picture, Box);
        QVERIFY(made);
        QCOMPARE(made->single.size(), single);
        QCOMPARE(made->twice.isNull() ? QSize() : made->twice.size(), twice);
        const QRgb seen = made->single.pixel(2, single.height() - 3); // each channel taken as off or on
        QCOMPARE(qRgb(qRed(seen) / 128 * 255, qGreen(seen) / 128 * 255, qBlue(seen) / 128 * 255), corner);
    }

    // The cache: a second run decodes nothing; a changed picture gets a new name, and the old
    // thumbnails go when nothing uses them; a picture that is not one gets the placeholder.
    void cacheAcrossRuns()
    {
        QTemporaryDir dir;
        const QStringList pictures = {dir.filePath(u"photo.jpg"_s), dir.filePath(u"drawing.png"_s),
                                      dir.filePath(u"broken.jpg"_s)};
        test::writeFile(pictures[0], halves({800, 600}));
        test::writeFile(pictures[1], halves({100, 80}, "PNG"));
        test::writeFile(pictures[2], "not a picture");
        const QString site = dir.path() + u'/';
        int decoded = -1;
        const auto run = [&] {
            auto store = ThumbnailStore::open(site);
            QList<Thumbnail> made;
            for (const QString &picture : pictures) {
                const auto thumbnail = store.value()->thumbnailOf(picture, Box);
                made << (thumbnail ? thumbnail.value() : Thumbnail());
            }
            decoded = store.value()->decoded();
            return store.value()->removeUnused() && store.value()->saveRecord(false) ? made
                                                                                     : QList<Thumbnail>();
        };
        const QList<Thumbnail> first = run();
        QCOMPARE(decoded, 3);
        QCOMPARE(first[0].size, Box);
        QVERIFY(test::readFile(site + first[0].twiceFile).contains("\xFF\xC2")); // progressive
        QCOMPARE(first[2], (Thumbnail{u"pictures/placeholder.svg"_s, QString(), Box}));
        QCOMPARE(run(), first);
        QCOMPARE(decoded, 0);
        // A run that stopped after the first picture keeps the others in the record.
        auto stopped = ThumbnailStore::open(site);
        QVERIFY(stopped.value()->thumbnailOf(pictures[0], Box) && stopped.value()->saveRecord(true));
        QCOMPARE(run(), first);
        QCOMPARE(decoded, 0);

        test::writeFile(pictures[0], halves({600, 800}));
        QFile(pictures[0])
            .setFileTime(QDateTime::currentDateTime().addSecs(5), QFileDevice::FileModificationTime);
        const QList<Thumbnail> changed = run();
        QCOMPARE(decoded, 1);
        QVERIFY(changed[0].file != first[0].file);
        QCOMPARE(changed[0].size, QSize(68, 90));
        QVERIFY(!QFile::exists(site + first[0].file) && !QFile::exists(site + first[0].twiceFile));
        QVERIFY(QFile::exists(site + changed[0].file) && QFile::exists(site + changed[1].file));
    }

    // Enough records in three streams to fill blocks and pass the limit of waiting records,
    // read back two streams alternately, then the third.
    void spoolReadsEachStreamInOrder()
    {
        auto spool = ItemSpool::create(m_dir.filePath(u"test.spool"_s));
        QVERIFY(spool);
        std::array<QList<QByteArray>, 3> streams;
        for (int n = 0; n < 6000; ++n) {
            const std::size_t stream = n % 7 == 0 ? 2 : n % 2;
            streams[stream] << QByteArray(100 + (n * 37) % 3000, char('a' + stream)) + QByteArray::number(n);
            QVERIFY(spool.value()->append(stream, streams[stream].last()));
        }
        QVERIFY(spool.value()->finish());
        QCOMPARE(streams[0].size(), streams[1].size());
        for (qsizetype n = 0; n < streams[0].size() * 2; ++n)
            QCOMPARE(spool.value()->next(std::size_t(n % 2)).value().toByteArray(), streams[n % 2][n / 2]);
        for (const QByteArray &expected : streams[2])
            QCOMPARE(spool.value()->next(2).value().toByteArray(), expected);
        QVERIFY(!spool.value()->next(2));
    }

    // The items by page under sections in sort-code order, those without a group last, or in catalog
    // order; values escaped; the search index; every address in the pages a file of the site.
    void orderAndContent_data()
    {
        QTest::addColumn<bool>("sections");
        QTest::addColumn<QString>("keys"); // by page
        QTest::newRow("by sort group") << true << u"K2 K5 | K1 K4 | K3"_s;
        QTest::newRow("catalog order") << false << u"K1 K2 | K3 K4 | K5"_s;
    }
    void orderAndContent()
    {
        QFETCH(bool, sections);
        QFETCH(QString, keys);
        QDir(site()).removeRecursively();
        SiteRun run;
        const auto first = write(run, sections);
        QVERIFY2(first, qPrintable(first.status().description()));
        QCOMPARE(first.value(), site() + u"/index.html"_s);
        const QMap<QString, QByteArray> files = contents(site());
        const QRegularExpression key(u"<bdi>(K\\d)</bdi>"_s);
        QStringList pages;
        for (long long page = 1; files.contains(site::pageFileName(page)); ++page) {
            QStringList onPage;
            for (const auto &match :
                 key.globalMatch(QString::fromUtf8(files.value(site::pageFileName(page)))))
                onPage << match.captured(1);
            pages << onPage.join(u' ');
        }
        QCOMPARE(pages.join(u" | "_s), keys);
        const QByteArray all = files.values().join();
        QCOMPARE(all.contains("<section"), sections);
        const QByteArray sectionLink = "<li><a href=\"page-2.html#s-2\">קבוצת מיון 2</a>"; // first page only
        QCOMPARE(QList({files.value(u"index.html"_s).count(sectionLink), all.count(sectionLink)}),
                 QList<qsizetype>(2, sections));
        QCOMPARE(files.value(u"page-3.html"_s).contains("id=\"s-none\""), sections);
        QVERIFY(files.value(u"page-3.html"_s).contains("<a href=\"page-2.html\" rel=\"prev\">"));
        QVERIFY(all.contains("<bdi>כיסא &lt;b&gt;&amp;&quot;&#39;</bdi>") && !all.contains("<b>&"));
        QVERIFY(all.contains("Lamp 😀 灯") && all.contains("<bdi>1,234.50</bdi> ש&quot;ח"));
        QCOMPARE(files.value(u"search-index.js"_s).count("[\"K"), 5);
        // Only the picture that exists is decoded; the missing one has the placeholder.
        QCOMPARE(all.count("alt=\"ארון\" src=\"pictures/"), 1);
        QVERIFY(all.contains("alt=\"Lamp 😀 灯\" src=\"pictures/placeholder.svg\""));
        QVERIFY(!all.contains(m_dir.path().toUtf8()) && !all.contains("file:"));
        const QRegularExpression address(u"(?:src|href|srcset)=\"([^\"]*)\""_s);
        for (const auto &match : address.globalMatch(QString::fromUtf8(all))) {
            for (const QString &part : match.captured(1).split(u", "_s)) {
                const QString target = part.section(u' ', 0, 0).section(u'#', 0, 0);
                QVERIFY2(target.isEmpty() || files.contains(target), qPrintable(part));
            }
        }
    }

    // A stop and a failure to write each leave the earlier site as it was.
    void earlierSiteStays_data()
    {
        QTest::addColumn<bool>("stop");
        QTest::newRow("stop while writing pages") << true;
        QTest::newRow("a page cannot be written") << false;
    }
    void earlierSiteStays()
    {
        QFETCH(bool, stop);
        QDir(site()).removeRecursively();
        SiteRun earlier;
        QVERIFY(write(earlier));
        const QMap<QString, QByteArray> before = contents(site());
        test::FaultyFileSystem files;
        SiteRun run(files);
        run.settings.rows = 2; // pages that would differ
        if (stop)
            run.user.onYield = [&run] { run.state.StopRequested = run.user.yields >= 2; };
        else
            files.failingPaths << site() + u"/.zorbin-staging/page-2.html"_s;
        const auto result = write(run, false);
        QCOMPARE(bool(result), stop);
        if (stop)
            QCOMPARE(result.value(), site() + u"/index.html"_s);
        else
            QVERIFY(result.status().description().contains(u"page-2.html"_s));
        QCOMPARE(contents(site()), before);
    }

    // No items: the earlier site's pages go, the shop's own files and the cache record stay.
    void emptyCatalogRemovesTheEarlierSite()
    {
        SiteRun earlier, run;
        QVERIFY(write(earlier));
        const QString empty = m_dir.filePath(u"empty.db"_s);
        QVERIFY(test::makeWorkDatabase(empty));
        test::writeFile(site() + u"/notes.txt"_s, "the shop's own file");
        const auto result = write(run, true, empty);
        QVERIFY2(result, qPrintable(result.status().description()));
        QCOMPARE(result.value(), QString());
        QCOMPARE(contents(site()).keys(), QStringList{u"notes.txt"_s});
        QVERIFY(QFile::exists(site() + u"/pictures/thumbnails.txt"_s));
    }

    // A staging folder left as a link to elsewhere: the link goes, what it leads to stays.
    void stagingLinkLeavesItsTarget()
    {
        const QString elsewhere = m_dir.filePath(u"elsewhere"_s), staging = site() + u"/.zorbin-staging"_s;
        QVERIFY(QDir().mkpath(elsewhere) && QDir().mkpath(site()));
        test::writeFile(elsewhere + u"/keep.txt"_s);
        QFile::remove(staging);
        QVERIFY(QFile::link(elsewhere, staging));
        SiteRun run;
        QVERIFY(write(run));
        QVERIFY(QFile::exists(elsewhere + u"/keep.txt"_s) && !QFileInfo::exists(staging));
    }
};

QTEST_GUILESS_MAIN(WebTest)

#include "WebTest.moc"
