// A real browser opens catalogs from disk: Debian's Chromium without a screen reads each page
// through inspect-catalog.html and reports what it shows.
#include "HeadlessChromium.h"
#include "model/CatalogSettings.h"
#include "model/ConnectionParams.h"
#include "model/RunContext.h"
#include "model/RunState.h"
#include "output/CatalogPages.h"
#include "platform/FileSystem.h"
#include "testutil/RecordingUserPort.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"
#include "testutil/WorkDatabaseFixture.h"

#include <QCoreApplication>
#include <QDir>
#include <QJsonArray>
#include <QProcess>
#include <QSettings>
#include <QTemporaryDir>
#include <QTest>
#include <QUrl>

using namespace zorbin;

namespace {

const QString NextPage = QStringLiteral("לעמוד הבא");
const QString PreviousPage = QStringLiteral("לעמוד הקודם");

bool hasHebrewLetter(const QString &text)
{
    for (const QChar c : text) {
        if (c.unicode() >= 0x05D0 && c.unicode() <= 0x05EA)
            return true;
    }
    return false;
}

QJsonArray pagesOf(const QJsonObject &findings)
{
    return findings.value(QStringLiteral("pages")).toArray();
}

QString linkTo(const QJsonObject &page, const QString &text)
{
    for (const QJsonValue link : page.value(QStringLiteral("links")).toArray()) {
        if (link[QStringLiteral("text")].toString() == text)
            return QUrl(link[QStringLiteral("href")].toString()).toLocalFile();
    }
    return {};
}

} // namespace

class BrowserTest : public QObject
{
    Q_OBJECT

private:
    QTemporaryDir m_webWork;
    QString m_site; // the first page of the demo's web catalog, once written

    // Writes the demo's web catalog through the command line, once for all widths.
    QString demoSite()
    {
        if (!m_site.isEmpty())
            return m_site;
        QProcess cli;
        QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
        environment.insert(QStringLiteral("TMPDIR"), m_webWork.path());
        cli.setProcessEnvironment(environment);
        cli.start(QStringLiteral(ZORBIN_CLI),
                  {QStringLiteral("web"), QStringLiteral("--settings"),
                   test::demoFolder() + QStringLiteral("/demo-settings.ini"), QStringLiteral("--out"),
                   m_webWork.filePath(QStringLiteral("site"))});
        if (!cli.waitForFinished(300000) || cli.exitCode() != 0)
            qWarning("zorbin-cli web failed: %s", cli.readAllStandardError().constData());
        m_site = QString::fromLocal8Bit(cli.readAllStandardOutput()).trimmed();
        return m_site;
    }

    // Every picture of the page whose file exists has loaded; the others are the demo's
    // deliberately missing pictures. Returns how many loaded.
    static int checkPictures(const QJsonObject &page)
    {
        int loaded = 0;
        for (const QJsonValue image : page.value(QStringLiteral("images")).toArray()) {
            const QString file = QUrl(image[QStringLiteral("url")].toString()).toLocalFile();
            if (QFileInfo::exists(file)) {
                if (image[QStringLiteral("naturalWidth")].toInt() <= 0)
                    qWarning("picture not shown: %s", qPrintable(file));
                loaded += image[QStringLiteral("naturalWidth")].toInt() > 0 ? 1 : 0;
            } else if (!QFileInfo(file).fileName().startsWith(QLatin1String("missing-"))) {
                qWarning("a picture the demo does not leave out is missing: %s", qPrintable(file));
                return -1;
            }
        }
        return loaded;
    }

    static int existingPictures(const QJsonObject &page)
    {
        int count = 0;
        for (const QJsonValue image : page.value(QStringLiteral("images")).toArray())
            count += QFileInfo::exists(QUrl(image[QStringLiteral("url")].toString()).toLocalFile()) ? 1 : 0;
        return count;
    }

private Q_SLOTS:
    void initTestCase()
    {
        QVERIFY2(QFileInfo(QStringLiteral(ZORBIN_CHROMIUM)).isExecutable(), ZORBIN_CHROMIUM);
    }

    void demoCatalog()
    {
        QTemporaryDir work;
        QVERIFY(work.isValid());
        const QString catalog = work.filePath(QStringLiteral("catalog"));
        QProcess cli;
        QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
        environment.insert(QStringLiteral("TMPDIR"), work.path()); // a working database of its own
        cli.setProcessEnvironment(environment);
        cli.start(QStringLiteral(ZORBIN_CLI), {QStringLiteral("demo"), QStringLiteral("--out"), catalog});
        QVERIFY(cli.waitForFinished(300000));
        QVERIFY2(cli.exitCode() == 0, cli.readAllStandardError().constData());
        const QString firstPage = QString::fromLocal8Bit(cli.readAllStandardOutput()).trimmed();
        QCOMPARE(firstPage, QDir(catalog).filePath(QStringLiteral("zoindex.htm")));

        const QSettings demo(test::demoFolder() + QStringLiteral("/demo-settings.ini"), QSettings::IniFormat);
        const int cells = demo.value(QStringLiteral("Params/Rows")).toInt() *
                          demo.value(QStringLiteral("Params/Cols")).toInt();
        QVERIFY(cells > 0);
        QCOMPARE(demo.value(QStringLiteral("Params/PageSplit")).toString(), QStringLiteral("1"));

        const test::HeadlessChromium browser(work.filePath(QStringLiteral("profile")));
        const QJsonObject findings = browser.inspectCatalog(firstPage, work.path());
        QVERIFY2(!findings.contains(QStringLiteral("error")),
                 qPrintable(findings.value(QStringLiteral("error")).toString()));
        const QJsonArray pages = pagesOf(findings);
        QCOMPARE(pages.size(), 2);

        const QJsonObject first = pages.at(0).toObject();
        QCOMPARE(first[QStringLiteral("characterSet")].toString(), QStringLiteral("windows-1255"));
        QCOMPARE(first[QStringLiteral("title")].toString(), QStringLiteral("טרניק מערכות מידע מציגה"));
        QCOMPARE(first[QStringLiteral("topTitle")].toString(),
                 demo.value(QStringLiteral("Params/TopTitle")).toString());
        int hebrewCells = 0;
        for (const QJsonValue text : first[QStringLiteral("texts")].toArray()) {
            QVERIFY2(!text.toString().contains(QChar(0xFFFD)), qPrintable(text.toString()));
            hebrewCells += hasHebrewLetter(text.toString()) ? 1 : 0;
        }
        QVERIFY(hebrewCells > 0);
        QCOMPARE(first[QStringLiteral("cells")].toInt(), cells);
        const int loaded = checkPictures(first);
        QCOMPARE(loaded, existingPictures(first));
        QVERIFY(loaded > 1); // the logo and item pictures
        QCOMPARE(linkTo(first, NextPage), QDir(catalog).filePath(QStringLiteral("zo000002.htm")));
        QVERIFY(linkTo(first, PreviousPage).isEmpty());

        // Where the next-page link led, after a click.
        const QJsonObject second = pages.at(1).toObject();
        QCOMPARE(QUrl(second[QStringLiteral("location")].toString()).toLocalFile(),
                 QDir(catalog).filePath(QStringLiteral("zo000002.htm")));
        QCOMPARE(second[QStringLiteral("cells")].toInt(), cells);
        QCOMPARE(linkTo(second, PreviousPage), firstPage);
        QCOMPARE(checkPictures(second), existingPictures(second));
    }

    // The demo's web catalog on a phone and on a wide screen.
    void webCatalog_data()
    {
        const QSettings demo(test::demoFolder() + QStringLiteral("/demo-settings.ini"), QSettings::IniFormat);
        QTest::addColumn<QSize>("window");
        QTest::addColumn<int>("columns");
        QTest::newRow("phone") << QSize(390, 844) << 1;
        QTest::newRow("wide") << QSize(1280, 800) << demo.value(QStringLiteral("Params/Cols")).toInt();
    }
    void webCatalog()
    {
        QFETCH(QSize, window);
        QFETCH(int, columns);
        const QString first = demoSite();
        QCOMPARE(first, m_webWork.filePath(QStringLiteral("site/index.html")));
        // A key of an item on another page: the search covers the whole catalog.
        const QString key = QStringLiteral("B0009");
        const QJsonObject findings = test::HeadlessChromium(m_webWork.filePath(QStringLiteral("profile")))
                                         .inspectSite(first, m_webWork.path(), window, key);
        QVERIFY2(!findings.contains(QStringLiteral("error")),
                 qPrintable(findings.value(QStringLiteral("error")).toString()));
        QCOMPARE(findings[QStringLiteral("characterSet")].toString(), QStringLiteral("UTF-8"));
        QCOMPARE(findings[QStringLiteral("dir")].toString(), QStringLiteral("rtl"));
        QVERIFY(findings[QStringLiteral("scrollWidth")].toInt() <=
                findings[QStringLiteral("clientWidth")].toInt());
        QCOMPARE(findings[QStringLiteral("columns")].toInt(), columns);
        const QJsonArray images = findings[QStringLiteral("images")].toArray();
        QVERIFY(images.size() > 1);
        for (const QJsonValue image : images)
            QVERIFY2(image[QStringLiteral("naturalWidth")].toInt() > 0,
                     qPrintable(image[QStringLiteral("src")].toString()));
        const QJsonArray found = findings[QStringLiteral("found")].toArray();
        QCOMPARE(found.size(), 1);
        QVERIFY(found.at(0).toString().contains(key));
        // Links to sections on this page find their heading; the last leads to its own page.
        const QJsonArray links = findings[QStringLiteral("sectionLinks")].toArray();
        QVERIFY(links.size() > 1);
        for (const QJsonValue link : links) {
            const QString href = link[QStringLiteral("href")].toString();
            if (href.startsWith(QLatin1Char('#')))
                QCOMPARE(link[QStringLiteral("target")].toString(), href.mid(1));
        }
        const QJsonObject last = findings[QStringLiteral("lastSection")].toObject();
        QVERIFY(last[QStringLiteral("location")].toString().endsWith(
            links.last()[QStringLiteral("href")].toString()));
        QCOMPARE(last[QStringLiteral("heading")].toString(), links.last()[QStringLiteral("text")].toString());
        QCOMPARE(findings[QStringLiteral("console")].toArray(), QJsonArray());
    }

    void picturesWithMarksInTheirNames()
    {
        QTemporaryDir work;
        QVERIFY(work.isValid());
        const QString pictures = work.filePath(QStringLiteral("תמונות #1 & 'more' 100%"));
        QVERIFY(QDir().mkpath(pictures));
        const QStringList names = {QStringLiteral("l'or & fils.png"), QStringLiteral("50% #1?.png"),
                                   QStringLiteral("כיסא \"נוח\".png")};
        const QByteArray png =
            test::readFile(QStringLiteral(ZORBIN_SOURCE_DIR "/tests/output/golden/pictures/chair.png"));
        QVERIFY(!png.isEmpty());
        test::WorkRows rows;
        for (int i = 0; i < names.size(); ++i) {
            test::writeFile(pictures + QLatin1Char('/') + names.at(i), png);
            test::WorkItem item(QStringLiteral("P%1").arg(i));
            item.name = names.at(i);
            item.picture = pictures + QLatin1Char('/') + names.at(i);
            rows.items << item;
        }
        const QString db = work.filePath(QStringLiteral("work.db"));
        const Status made = test::makeWorkDatabase(db, rows);
        QVERIFY2(made.isOk(), qPrintable(made.description()));

        CatalogSettings settings;
        settings.rows = 1;
        settings.columns = 3;
        settings.pictureWidth = 50;
        settings.pictureHeight = 50;
        settings.lines[0].field = 0;
        settings.lines[1].field = 2;
        settings.pageSplit = PageSplit::OneFile;
        settings.sortKey = SortKey::ItemKey;
        settings.sortDirection = SortDirection::Ascending;
        ConnectionParams connection;
        RunState state;
        test::RecordingUserPort user;
        RunContext context{settings, connection, state, user, localFileSystem()};
        const QString out = work.filePath(QStringLiteral("out/"));
        QVERIFY(QDir().mkpath(out + QStringLiteral("images")));
        const auto first =
            CreateCatHTML(context, out + QStringLiteral("zo"), db, out + QStringLiteral("images"));
        QVERIFY2(first.isOk(), qPrintable(first.status().description()));

        const test::HeadlessChromium browser(work.filePath(QStringLiteral("profile")));
        const QJsonObject findings = browser.inspectCatalog(first.value(), work.path());
        QVERIFY2(!findings.contains(QStringLiteral("error")),
                 qPrintable(findings.value(QStringLiteral("error")).toString()));
        const QJsonObject page = pagesOf(findings).at(0).toObject();
        QCOMPARE(page[QStringLiteral("cells")].toInt(), 3);
        const QJsonArray images = page[QStringLiteral("images")].toArray();
        QCOMPARE(images.size(), names.size());
        for (int i = 0; i < names.size(); ++i) {
            QCOMPARE(QUrl(images.at(i)[QStringLiteral("url")].toString()).toLocalFile(),
                     pictures + QLatin1Char('/') + names.at(i));
            QCOMPARE(images.at(i)[QStringLiteral("naturalWidth")].toInt(), 200);
        }
        QStringList shownNames;
        for (const QJsonValue text : page[QStringLiteral("texts")].toArray()) {
            if (names.contains(text.toString()))
                shownNames << text.toString();
        }
        QCOMPARE(shownNames, names);
    }
};

ZORBIN_TEST_CLASS(BrowserTest)

ZORBIN_TEST_MAIN_BEGIN(QCoreApplication)
ZORBIN_TEST_ADD(BrowserTest)
ZORBIN_TEST_MAIN_END

#include "BrowserTest.moc"
