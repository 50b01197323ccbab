// Whole runs of the site writer on a small working database: the order of the items and
// sections, what the pages hold, and what a stop, a failure or an empty catalog leaves.
#include "model/CatalogSettings.h"
#include "model/ConnectionParams.h"
#include "model/RunContext.h"
#include "model/RunState.h"
#include "testutil/FaultyFileSystem.h"
#include "testutil/RecordingUserPort.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"
#include "testutil/WorkDatabaseFixture.h"
#include "web/CatalogSite.h"
#include "web/ItemSpool.h"
#include "web/SiteNames.h"
#include "web/SiteSections.h"

#include <QDirIterator>
#include <QImage>
#include <QRegularExpression>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;

namespace {

// Settings of two items a page: the picture, the name, the key and the price.
struct SiteContext
{
    explicit SiteContext(FileSystem &files = localFileSystem())
        : context{settings, connection, state, user, files}
    {
        settings.rows = 1;
        settings.columns = 2;
        const char *tags[] = {"0", "2", "1", "4"};
        for (std::size_t i = 0; i < std::size(tags); ++i)
            settings.lines[i].field = fieldOfTag(QLatin1String(tags[i]));
        settings.priceList1.addEntry(QStringLiteral("מחיר"), 0);
        settings.priceList1.setCurrentIndex(0);
        settings.sortKey = SortKey::ItemKey;
        settings.sortDirection = SortDirection::Ascending;
    }

    CatalogSettings settings;
    ConnectionParams connection;
    RunState state;
    test::RecordingUserPort user;
    RunContext context;
};

// Every file under the folder, by its path inside it, with its bytes.
QMap<QString, QByteArray> contents(const QString &folder)
{
    QMap<QString, QByteArray> files;
    QDirIterator it(folder, QDir::Files | QDir::Hidden, QDirIterator::Subdirectories);
    while (it.hasNext()) {
        const QString path = it.next();
        files.insert(QDir(folder).relativeFilePath(path), test::readFile(path));
    }
    return files;
}

// The item keys of the site's pages in page order, a page's keys joined by " ", pages by " | ".
QString keysByPage(const QMap<QString, QByteArray> &site)
{
    static const QRegularExpression key(QStringLiteral("<bdi>(K\\d)</bdi>"));
    QStringList pages;
    for (long long page = 1; site.contains(site::pageFileName(page)); ++page) {
        QStringList keys;
        for (auto match = key.globalMatch(QString::fromUtf8(site.value(site::pageFileName(page))));
             match.hasNext();)
            keys << match.next().captured(1);
        pages << keys.join(QLatin1Char(' '));
    }
    return pages.join(QStringLiteral(" | "));
}

} // namespace

class SiteRunTest : public QObject
{
    Q_OBJECT

private:
    QTemporaryDir m_dir;
    QString m_db;

    QString site() const { return m_dir.filePath(QStringLiteral("site")); }

    Result<QString> write(SiteContext &run, bool sections = true, const QString &db = {})
    {
        return CreateCatSite(run.context, SiteRequest{site(), db.isEmpty() ? m_db : db, sections});
    }

private Q_SLOTS:
    void initTestCase()
    {
        const QString photo = m_dir.filePath(QStringLiteral("photo.jpg"));
        QImage image(640, 480, QImage::Format_RGB32);
        image.fill(Qt::darkGreen);
        QVERIFY(image.save(photo));
        test::WorkRows rows;
        const auto item = [&](const char *key, const QString &name, QVariant sort, QVariant picture) {
            test::WorkItem row{QLatin1String(key)};
            row.name = name;
            row.sort = sort;
            row.picture = picture;
            row.price = 1234.5;
            row.coin = QStringLiteral("ש\"ח");
            rows.items << row;
        };
        item("K1", QStringLiteral("כיסא <b>&\"'"), 2, photo);
        item("K2", QStringLiteral("Lamp 😀 灯"), 1, m_dir.filePath(QStringLiteral("missing.jpg")));
        item("K3", QStringLiteral("שולחן"), {}, QStringLiteral("?"));
        item("K4", QStringLiteral("ארון"), 2, photo);
        item("K5", QStringLiteral("מדף"), 1, {});
        rows.other[QStringLiteral("tItemSort")] = {{1, QStringLiteral("ריהוט")}, {2, QVariant()}};
        m_db = m_dir.filePath(QStringLiteral("work.db"));
        const Status made = test::makeWorkDatabase(m_db, rows);
        QVERIFY2(made.isOk(), qPrintable(made.description()));
    }

    void orderAndContent_data()
    {
        QTest::addColumn<bool>("sections");
        QTest::addColumn<QString>("keys");
        QTest::newRow("by sort group") << true << QStringLiteral("K2 K5 | K1 K4 | K3");
        QTest::newRow("catalog order") << false << QStringLiteral("K1 K2 | K3 K4 | K5");
    }
    void orderAndContent()
    {
        QFETCH(bool, sections);
        QFETCH(QString, keys);
        QDir(site()).removeRecursively();
        SiteContext run;
        const auto first = write(run, sections);
        QVERIFY2(first.isOk(), qPrintable(first.status().description()));
        QCOMPARE(first.value(), site() + QStringLiteral("/index.html"));
        const QMap<QString, QByteArray> files = contents(site());
        QCOMPARE(keysByPage(files), keys);
        const QByteArray all = files.values().join();
        QCOMPARE(all.contains("<section"), sections);
        if (sections) {
            QVERIFY(files.value(QStringLiteral("index.html"))
                        .contains("<li><a href=\"page-2.html#s-2\">קבוצת מיון 2</a>"));
            QVERIFY(files.value(QStringLiteral("page-3.html")).contains("id=\"s-none\""));
        }
        QVERIFY(all.contains("<bdi>כיסא &lt;b&gt;&amp;&quot;&#39;</bdi>"));
        QVERIFY(!all.contains("<b>&"));
        QVERIFY(all.contains("Lamp 😀 灯"));
        QVERIFY(all.contains("<bdi>1,234.50</bdi> ש&quot;ח"));
        QCOMPARE(files.value(QStringLiteral("search-index.js")).count("[\"K"), 5);
        // Only the picture that exists is decoded; the missing one has the placeholder.
        QCOMPARE(all.count("alt=\"ארון\" src=\"pictures/"), 1);
        QVERIFY(all.contains("alt=\"Lamp 😀 灯\" src=\"pictures/placeholder.svg\""));
        // Nothing refers outside the folder, or to the disk.
        for (auto file = files.cbegin(); file != files.cend(); ++file) {
            QVERIFY2(!file.value().contains(m_dir.path().toUtf8()), qPrintable(file.key()));
            QVERIFY2(!file.value().contains("file:"), qPrintable(file.key()));
        }
    }

    // A stop, a failure to write and an empty catalog each leave a consistent folder.
    void earlierSiteStays_data()
    {
        QTest::addColumn<QString>("ending");
        QTest::newRow("stop while writing pages") << QStringLiteral("stop");
        QTest::newRow("a page cannot be written") << QStringLiteral("fault");
    }
    void earlierSiteStays()
    {
        QFETCH(QString, ending);
        QDir(site()).removeRecursively();
        SiteContext earlier;
        QVERIFY(write(earlier).isOk());
        const QMap<QString, QByteArray> before = contents(site());

        test::FaultyFileSystem files;
        SiteContext run(files);
        run.settings.rows = 2; // pages that would differ
        if (ending == QLatin1String("stop"))
            run.user.onYield = [&run] { run.state.StopRequested = run.user.yields >= 2; };
        else
            files.failingPaths << site() + QStringLiteral("/.zorbin-staging/page-2.html");
        const auto result = write(run, false);
        QCOMPARE(result.isOk(), ending == QLatin1String("stop"));
        if (result.isOk())
            QCOMPARE(result.value(), site() + QStringLiteral("/index.html"));
        else
            QVERIFY(result.status().description().contains(QStringLiteral("page-2.html")));
        // The cache record may list its entries in another order; the rest is as it was.
        const auto withoutRecord = [](QMap<QString, QByteArray> all) {
            all.remove(QStringLiteral("pictures/thumbnails.txt"));
            return all;
        };
        QCOMPARE(withoutRecord(contents(site())).keys(), withoutRecord(before).keys());
        QVERIFY(withoutRecord(contents(site())) == withoutRecord(before));
    }

    void emptyCatalogRemovesTheEarlierSite()
    {
        SiteContext earlier;
        QVERIFY(write(earlier).isOk());
        const QString empty = m_dir.filePath(QStringLiteral("empty.db"));
        QVERIFY(test::makeWorkDatabase(empty).isOk());
        test::writeFile(site() + QStringLiteral("/notes.txt"), "the shop's own file");
        SiteContext run;
        const auto result = write(run, true, empty);
        QVERIFY2(result.isOk(), qPrintable(result.status().description()));
        QCOMPARE(result.value(), QString());
        QCOMPARE(contents(site()).keys(),
                 (QStringList{QStringLiteral("notes.txt"), QStringLiteral("pictures/thumbnails.txt")}));
    }

    // A staging folder left as a link to elsewhere: the link goes, what it leads to stays.
    void stagingLinkLeavesItsTarget()
    {
        const QString elsewhere = m_dir.filePath(QStringLiteral("elsewhere"));
        QVERIFY(QDir().mkpath(elsewhere) && QDir().mkpath(site()));
        test::writeFile(elsewhere + QStringLiteral("/keep.txt"));
        QFile::remove(site() + QStringLiteral("/.zorbin-staging"));
        QVERIFY(QFile::link(elsewhere, site() + QStringLiteral("/.zorbin-staging")));
        SiteContext run;
        QVERIFY(write(run).isOk());
        QVERIFY(QFile::exists(elsewhere + QStringLiteral("/keep.txt")));
        QVERIFY(!QFileInfo::exists(site() + QStringLiteral("/.zorbin-staging")));
    }

    // Enough records in three streams to fill blocks and pass the limit of waiting records,
    // read back two streams alternately, then the third.
    void spoolReadsEachStreamInOrder()
    {
        auto spool = ItemSpool::create(m_dir.filePath(QStringLiteral("test.spool")));
        QVERIFY(spool);
        std::array<QList<QByteArray>, 3> streams;
        for (int n = 0; n < 6000; ++n) {
            const std::size_t stream = n % 7 == 0 ? 2 : n % 2;
            streams[stream] << QByteArray(100 + (n * 37) % 3000, char('a' + stream)) + QByteArray::number(n);
            QVERIFY(spool.value()->append(stream, streams[stream].last()).isOk());
        }
        QVERIFY(spool.value()->finish().isOk());
        for (qsizetype n = 0; n < std::max(streams[0].size(), streams[1].size()); ++n) {
            for (std::size_t stream : {0, 1}) {
                if (n < streams[stream].size())
                    QCOMPARE(spool.value()->next(stream).value().toByteArray(), streams[stream][n]);
            }
        }
        for (const QByteArray &expected : streams[2])
            QCOMPARE(spool.value()->next(2).value().toByteArray(), expected);
        QVERIFY(!spool.value()->next(2));
    }

    void sectionsInSortCodeOrder()
    {
        const std::vector<Section> sections =
            planSections({3, {}, 1, 3, 1, {}}, {{1, QStringLiteral("Lamps")}, {3, QStringLiteral(" ")}});
        QCOMPARE(sections.size(), std::size_t(3));
        QCOMPARE(sections[0].title, QStringLiteral("Lamps"));
        QCOMPARE(sections[1].title, QStringLiteral("קבוצת מיון 3"));
        QCOMPARE(sections[1].first, 2);
        QCOMPARE(sections[2].anchor(), QStringLiteral("s-none"));
        QCOMPARE(sections[2].first, 4);
        QCOMPARE(sections[2].count, 2);
    }
};

ZORBIN_TEST_CLASS(SiteRunTest)
#include "SiteRunTest.moc"
