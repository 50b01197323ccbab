// Debian's Chromium without a screen opens catalogs from disk: an inspector page beside this test
// (inspect-catalog.html, inspect-site.html) reads what the browser shows and reports it.
#include "output/CatalogPages.h"
#include "testutil/OutputContext.h"
#include "testutil/TestFiles.h"
#include "testutil/WorkDatabaseFixture.h"
#include "workdb/SqliteEngine.h"

#include <QDir>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QProcess>
#include <QRegularExpression>
#include <QSettings>
#include <QTemporaryDir>
#include <QTest>
#include <QUrl>

using namespace zorbin;
using namespace Qt::Literals::StringLiterals;

namespace {

// Runs a program to its end (five minutes at most) with TMPDIR set: its standard output and
// error, or nothing when it failed.
std::pair<QByteArray, QByteArray> run(const QString &program, const QStringList &arguments,
                                      const QString &temporary)
{
    QProcess process;
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    environment.insert(u"TMPDIR"_s, temporary);
    process.setProcessEnvironment(environment);
    process.start(program, arguments);
    const bool ended = process.waitForFinished(300000) && process.exitStatus() == QProcess::NormalExit;
    if (ended && process.exitCode() == 0)
        return {process.readAllStandardOutput(), process.readAllStandardError()};
    qWarning("%s failed: %s", qPrintable(program), process.readAllStandardError().right(2000).constData());
    return {};
}

// Opens the inspector `name` with its marks replaced (@PAGE@: `page`), the profile in `work`: the
// findings it wrote into its document, or an object with the single key "error"; and "console":
// what pages in `page`'s folder wrote to the browser's console (errors included).
QJsonObject inspect(const QString &name, const QString &page, const QString &work,
                    QList<std::pair<QByteArray, QByteArray>> marks = {})
{
    QByteArray inspector = test::readFile(QStringLiteral(ZORBIN_BROWSER_TEST_DIR "/") + name);
    marks << std::pair("@PAGE@", QUrl::fromLocalFile(page).toEncoded());
    for (const auto &[mark, value] : marks)
        inspector.replace(mark, value);
    test::writeFile(QDir(work).filePath(name), inspector);
    // The browser puts its single-instance socket under TMPDIR; a test's own temporary folder
    // in a deep checkout passes the 107 bytes a socket path may have, and the browser aborts.
    // The inspector reads the frame's document: file pages must count as one origin.
    const auto [dom, log] =
        run(QStringLiteral(ZORBIN_CHROMIUM),
            u"--headless --no-sandbox --disable-gpu --no-first-run --disable-background-networking "
            "--disable-component-update --disable-sync --allow-file-access-from-files "
            "--enable-logging=stderr --v=0 --virtual-time-budget=15000 --dump-dom"_s.split(u' ') +
                QStringList{u"--user-data-dir="_s + QDir(work).filePath(u"profile"_s),
                            QUrl::fromLocalFile(QDir(work).filePath(name)).toString()},
            u"/tmp"_s);
    const qsizetype start = dom.indexOf("RESULT:"), end = dom.indexOf(":END", start);
    const QJsonDocument json =
        QJsonDocument::fromJson(QByteArray::fromPercentEncoding(dom.mid(start + 7, end - start - 7)));
    if (start < 0 || end < 0 || !json.isObject())
        return {{u"error"_s, u"no findings: "_s + QString::fromUtf8(dom.left(2000))}};
    QJsonObject findings = json.object();
    QJsonArray console;
    const QByteArray folder = QUrl::fromLocalFile(QFileInfo(page).absolutePath()).toEncoded();
    for (const QByteArray &line : log.split('\n')) {
        if (line.contains(":CONSOLE") && line.contains(folder))
            console << QString::fromUtf8(line);
    }
    findings[u"console"_s] = console;
    return findings;
}

// The local file a link or picture address of the findings names.
QString fileOf(const QJsonValue &address)
{
    return QUrl(address.toString()).toLocalFile();
}

// Every picture of a classic page shows but the demo's deliberately missing ones, which are not
// there ("missing-..."); how many show, or -1.
int shownPictures(const QJsonObject &page)
{
    int shown = 0;
    for (const QJsonValue image : page[u"images"_s].toArray()) {
        const QFileInfo file(fileOf(image[u"url"_s]));
        const bool loaded = image[u"naturalWidth"_s].toInt() > 0;
        if (loaded != file.exists() || loaded == file.fileName().startsWith("missing-"_L1)) {
            qWarning("picture %s shown: %d", qPrintable(file.filePath()), loaded);
            return -1;
        }
        shown += loaded;
    }
    return shown;
}

} // namespace

class BrowserTest : public QObject
{
    Q_OBJECT

    QTemporaryDir m_work;
    const QSettings m_demo{test::demoFolder() + u"/demo-settings.ini"_s, QSettings::IniFormat};
    QString m_catalog, m_site; // the first pages of the demo's catalog and web catalog

private Q_SLOTS:
    // The demo's catalog and web catalog, written through the command line.
    void initTestCase()
    {
        QVERIFY(setUpSqliteEngine()); // as the programs do
        QVERIFY2(QFileInfo(QStringLiteral(ZORBIN_CHROMIUM)).isExecutable(), ZORBIN_CHROMIUM);
        const auto cli = [this](const QStringList &arguments) {
            return QString::fromLocal8Bit(run(QStringLiteral(ZORBIN_CLI), arguments, m_work.path()).first)
                .trimmed();
        };
        m_catalog = cli({u"demo"_s, u"--out"_s, m_work.filePath(u"catalog"_s)});
        QCOMPARE(m_catalog, m_work.filePath(u"catalog/zoindex.htm"_s));
        m_site = cli({u"web"_s, u"--settings"_s, m_demo.fileName(), u"--out"_s, m_work.filePath(u"site"_s)});
        QCOMPARE(m_site, m_work.filePath(u"site/index.html"_s));
    }

    // The first page in windows-1255 with the demo's titles and a full grid, every picture shown,
    // and its next-page link leads to the second page, which links back.
    void demoCatalog()
    {
        const int cells = m_demo.value(u"Params/Rows"_s).toInt() * m_demo.value(u"Params/Cols"_s).toInt();
        QVERIFY(cells > 0);
        const QJsonObject findings = inspect(u"inspect-catalog.html"_s, m_catalog, m_work.path());
        QVERIFY2(!findings.contains(u"error"_s), qPrintable(findings[u"error"_s].toString()));
        const QJsonArray pages = findings[u"pages"_s].toArray();
        QCOMPARE(pages.size(), 2);
        const QJsonObject first = pages.at(0).toObject(), second = pages.at(1).toObject();
        QCOMPARE(first[u"characterSet"_s].toString(), u"windows-1255"_s);
        QCOMPARE(first[u"title"_s].toString(), u"טרניק מערכות מידע מציגה"_s);
        QCOMPARE(first[u"topTitle"_s].toString(), m_demo.value(u"Params/TopTitle"_s).toString());
        const QString texts = first[u"texts"_s].toVariant().toStringList().join(u'\n');
        QVERIFY2(!texts.contains(QChar(0xFFFD)) && texts.contains(QRegularExpression(u"[א-ת]"_s)),
                 qPrintable(texts));
        QCOMPARE(first[u"cells"_s].toInt(), cells);
        QVERIFY(shownPictures(first) > 1); // the logo and item pictures
        const QString secondPage = QFileInfo(m_catalog).dir().filePath(u"zo000002.htm"_s);
        QCOMPARE(fileOf(first[u"next"_s]), secondPage);
        QVERIFY(first[u"previous"_s].isNull());
        QCOMPARE(fileOf(second[u"location"_s]), secondPage); // where the click led
        QCOMPARE(fileOf(second[u"previous"_s]), m_catalog);
    }

    // The demo's web catalog on a phone and on a wide screen.
    void webCatalog_data()
    {
        QTest::addColumn<QSize>("window");
        QTest::addColumn<int>("columns");
        QTest::newRow("phone") << QSize(390, 844) << 1;
        QTest::newRow("wide") << QSize(1280, 800) << m_demo.value(u"Params/Cols"_s).toInt();
    }
    void webCatalog()
    {
        QFETCH(QSize, window);
        QFETCH(int, columns);
        const QString key = u"B0009"_s; // an item on another page: the search covers the whole catalog
        const QJsonObject findings = inspect(u"inspect-site.html"_s, m_site, m_work.path(),
                                             {{"@WIDTH@", QByteArray::number(window.width())},
                                              {"@HEIGHT@", QByteArray::number(window.height())},
                                              {"@KEY@", key.toUtf8()}});
        QVERIFY2(!findings.contains(u"error"_s), qPrintable(findings[u"error"_s].toString()));
        QCOMPARE(findings[u"characterSet"_s].toString(), u"UTF-8"_s);
        QCOMPARE(findings[u"dir"_s].toString(), u"rtl"_s);
        QVERIFY(findings[u"scrollWidth"_s].toInt() <= findings[u"clientWidth"_s].toInt());
        QCOMPARE(findings[u"columns"_s].toInt(), columns);
        const QJsonArray images = findings[u"images"_s].toArray();
        QVERIFY(images.size() > 1);
        for (const QJsonValue image : images)
            QVERIFY2(image[u"naturalWidth"_s].toInt() > 0, qPrintable(image[u"src"_s].toString()));
        QVERIFY(findings[u"searchShown"_s].toBool());
        const QJsonArray found = findings[u"found"_s].toArray();
        QCOMPARE(found.size(), 1);
        QVERIFY(found.at(0).toString().contains(key));
        // Links to sections on this page find their heading; the last leads to its own page.
        const QJsonArray links = findings[u"sectionLinks"_s].toArray();
        QVERIFY(links.size() > 1);
        for (const QJsonValue link : links) {
            if (const QString href = link[u"href"_s].toString(); href.startsWith(u'#'))
                QCOMPARE(link[u"target"_s].toString(), href.mid(1));
        }
        const QJsonObject last = findings[u"lastSection"_s].toObject();
        QVERIFY(last[u"location"_s].toString().endsWith(links.last()[u"href"_s].toString()));
        QCOMPARE(last[u"heading"_s].toString(), links.last()[u"text"_s].toString());
        QCOMPARE(findings[u"console"_s].toArray(), QJsonArray());
        // Every rule of the stylesheet (each closes with a brace) was one the browser could read.
        const QString style = QString::fromUtf8(test::readFile(m_work.filePath(u"site/site.css"_s)));
        QCOMPARE(findings[u"styleRules"_s].toInt(), int(style.count(u'}')));
    }

    // Pictures in a folder and under names with quotes, '#', '%', '&' and Hebrew all show.
    void picturesWithMarksInTheirNames()
    {
        const QString pictures = m_work.filePath(u"תמונות #1 & 'more' 100%"_s);
        QVERIFY(QDir().mkpath(pictures));
        const QStringList names = {u"l'or & fils.png"_s, u"50% #1?.png"_s, u"כיסא \"נוח\".png"_s};
        const QByteArray png =
            test::readFile(QStringLiteral(ZORBIN_SOURCE_DIR "/tests/output/golden/pictures/chair.png"));
        QVERIFY(!png.isEmpty());
        test::WorkRows rows;
        for (const QString &name : names) {
            test::writeFile(pictures + u'/' + name, png);
            rows.items << test::WorkItem{
                .key = u"P%1"_s.arg(rows.items.size()), .name = name, .picture = pictures + u'/' + name};
        }
        const QString db = m_work.filePath(u"marks.db"_s), out = m_work.filePath(u"marks/"_s);
        QVERIFY(test::makeWorkDatabase(db, rows));
        QVERIFY(QDir().mkpath(out + u"images"_s));
        test::OutputContext run;
        run.settings.rows = 1;
        run.settings.columns = 3;
        run.settings.lines[0].field = 0;
        run.settings.lines[1].field = 2;
        const auto first = CreateCatHTML(run.context, out + u"zo"_s, db, out + u"images"_s);
        QVERIFY2(first, qPrintable(first.status().description()));

        const QJsonObject findings = inspect(u"inspect-catalog.html"_s, first.value(), m_work.path());
        QVERIFY2(!findings.contains(u"error"_s), qPrintable(findings[u"error"_s].toString()));
        const QJsonObject page = findings[u"pages"_s][0].toObject();
        QCOMPARE(page[u"cells"_s].toInt(), 3);
        const QJsonArray images = page[u"images"_s].toArray();
        QCOMPARE(images.size(), names.size());
        QStringList shown = page[u"texts"_s].toVariant().toStringList();
        shown.removeIf([&names](const QString &text) { return !names.contains(text); });
        QCOMPARE(shown, names);
        for (int i = 0; i < names.size(); ++i) {
            QCOMPARE(fileOf(images.at(i)[u"url"_s]), pictures + u'/' + names.at(i));
            QCOMPARE(images.at(i)[u"naturalWidth"_s].toInt(), 200);
        }
    }
};

QTEST_GUILESS_MAIN(BrowserTest)

#include "BrowserTest.moc"
