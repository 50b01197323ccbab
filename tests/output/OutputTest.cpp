// The output writers. First each golden case (a folder of golden/ with a settings.ini): pages,
// stylesheet and list byte for byte, written in the temporary folder ROOT (pictures in
// ROOT/pictures, output in ROOT/out), which the settings and expected files write "{root}". A
// case's [Test] section: OnlyWithPic=1 ticks the option, NoItems=1 marks no item for the catalog.
// ZORBIN_UPDATE_GOLDEN=1 rewrites the expected files (review the difference before committing).
// Then names at their edges, progress, stop, sizes past 16 bits, and failures that fail the run
// yet leave whole pages.
#include "model/OptionTable.h"
#include "output/CatalogPages.h"
#include "output/FileNaming.h"
#include "output/ListPage.h"
#include "output/Stylesheet.h"
#include "platform/Paths.h"
#include "testutil/DamagedWorkDatabase.h"
#include "testutil/FaultyFileSystem.h"
#include "testutil/OutputContext.h"
#include "testutil/TestFiles.h"
#include "testutil/WorkDatabaseFixture.h"
#include "workdb/SqliteEngine.h"
#include "workdb/WorkDatabase.h"

#include <QDir>
#include <QLocale>
#include <QRegularExpression>
#include <QSettings>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;

namespace {

const QString Golden = QStringLiteral(ZORBIN_SOURCE_DIR "/tests/output/golden/");
const QString RootMark = u"{root}"_qs;

// The working database of golden/work-database.sql, its pictures under `root`.
Status makeGoldenWorkDatabase(const QString &path, const QString &root, bool noneIncluded)
{
    if (const Status created = createWorkDatabase(localFileSystem(), path); !created)
        return created;
    auto work = WorkDatabase::open(path);
    if (!work)
        return work.status();
    QString script = QString::fromUtf8(test::readFile(Golden + u"work-database.sql"_qs));
    script.replace(RootMark, root)
        .remove(QRegularExpression(u"^--[^\n]*\n"_qs, QRegularExpression::MultilineOption));
    if (noneIncluded)
        script += u"UPDATE tItems SET Include = 0;"_qs;
    for (const QString &statement : script.split(QLatin1Char(';'))) {
        if (statement.trimmed().isEmpty())
            continue;
        if (const WriteOutcome done = work.value()->exec(statement); !done)
            return done.status();
    }
    return Status::ok();
}

// The files of a folder (top level only) by name, with `root` replaced by the mark.
QMap<QString, QByteArray> filesOf(const QString &folder, const QString &root = {}, const QString &except = {})
{
    QMap<QString, QByteArray> files;
    const QDir dir(folder);
    for (const QString &name : dir.entryList(QDir::Files, QDir::Name)) {
        QByteArray content = test::readFile(dir.filePath(name));
        if (name != except)
            files.insert(name, root.isEmpty() ? content : content.replace(root.toUtf8(), RootMark.toUtf8()));
    }
    return files;
}

// A working database with `count` items, keys "K0000001" onwards, all in the catalog.
Status makeItems(const QString &path, int count)
{
    test::WorkRows rows;
    for (int i = 1; i <= count; ++i)
        rows.items << test::WorkItem{u"K%1"_qs.arg(i, 7, 10, QLatin1Char('0')), u"פריט %1"_qs.arg(i)};
    return test::makeWorkDatabase(path, rows);
}

// A whole page: one document, its tables, rows and cells all closed, ending as a page ends.
void verifyWholePage(const QByteArray &page)
{
    QCOMPARE(page.count("<HTML>"), 1);
    QVERIFY(page.endsWith("</table>\r\n</BODY>\r\n</HTML>\r\n"));
    for (const QByteArray element : {"table", "tr", "td"}) {
        qsizetype opened = 0;
        for (qsizetype at = page.indexOf('<' + element); at >= 0; at = page.indexOf('<' + element, at + 1)) {
            const char next = page.at(at + element.size() + 1);
            opened += next == ' ' || next == '>' ? 1 : 0;
        }
        QVERIFY2(opened == page.count("</" + element + '>'), element.constData());
    }
}

} // namespace

class OutputTest : public QObject
{
    Q_OBJECT

private:
    QTemporaryDir m_root;
    QString m_sevenItems;

    static void copyPictures(const QString &to)
    {
        QVERIFY(QDir().mkpath(to));
        const QDir from(Golden + u"pictures"_qs);
        for (const QString &name : from.entryList(QDir::Files))
            QVERIFY(QFile::copy(from.filePath(name), to + QLatin1Char('/') + name));
    }

    // Applies a case's settings as a load from the store does, after giving the source-dependent
    // lists two entries each.
    void loadSettings(const QSettings &ini, CatalogSettings &settings)
    {
        for (ChoiceList *list : settings.sourceLists()) {
            list->clear();
            list->addEntry(u"ראשון"_qs, 0);
            list->addEntry(u"שני"_qs, 2);
        }
        for (const QString &key : ini.allKeys()) {
            const QString value = ini.value(key).toString().replace(RootMark, m_root.path());
            if (key == u"Test/OnlyWithPic"_qs) {
                settings.onlyWithPicture = value == u"1"_qs;
            } else if (key.startsWith(u"Params/"_qs)) {
                const StoredOption *option = findStoredOption(key.mid(7));
                QVERIFY2(option && option->apply(settings, value), qPrintable(key + u'=' + value));
            }
        }
    }

    QString out(const QString &name = {}) const { return m_root.filePath(u"out/"_qs) + name; }

    // Two by two cells showing the name and the key, sorted by key.
    void prepare(test::OutputContext &output, bool filePerPage)
    {
        QVERIFY(QDir(out()).removeRecursively());
        QVERIFY(QDir().mkpath(out(u"images"_qs)));
        output.settings.rows = 2;
        output.settings.columns = 2;
        output.settings.pageSplit = filePerPage ? PageSplit::FilePerPage : PageSplit::OneFile;
        output.settings.sortKey = SortKey::ItemKey;
        output.settings.sortDirection = SortDirection::Ascending;
        output.settings.lines[0].field = 2;
        output.settings.lines[1].field = 1;
    }

    Result<QString> pages(test::OutputContext &output, const QString &db)
    {
        return CreateCatHTML(output.context, out(u"zo"_qs), db, out(u"images"_qs));
    }

    Status list(test::OutputContext &output, const QString &db)
    {
        return writeListPage(output.context, out(u"zorbin3.htm"_qs), db, QDate(2024, 3, 5));
    }

private Q_SLOTS:
    void initTestCase()
    {
        QVERIFY(setUpSqliteEngine()); // as the programs do
        // The C locale: "," groups thousands, "." marks decimals, "/" separates the date.
        QLocale::setDefault(QLocale::c());
        QVERIFY(m_root.isValid());
        QVERIFY2(m_root.path().toLatin1() == m_root.path().toUtf8(),
                 "the temporary folder's path must be ASCII");
        copyPictures(m_root.filePath(u"pictures"_qs));
        for (const bool none : {false, true}) {
            const QString db = m_root.filePath(none ? u"no-items.db"_qs : u"items.db"_qs);
            const Status made = makeGoldenWorkDatabase(db, m_root.path(), none);
            QVERIFY2(made.isOk(), qPrintable(made.description()));
        }
        m_sevenItems = m_root.filePath(u"seven.db"_qs);
        QVERIFY(makeItems(m_sevenItems, 7).isOk());
        QVERIFY(makeItems(m_root.filePath(u"six.db"_qs), 6).isOk());
        const QString badPrice = m_root.filePath(u"bad-price.db"_qs);
        QVERIFY(makeItems(badPrice, 3).isOk());
        QVERIFY(test::replacePriceList(badPrice, u"CREATE TABLE tItemPrice1 AS SELECT 'K0000002' AS ItemKey, "
                                                 u"'$' AS Coin, 'abc' AS Price"_qs)
                    .isOk());
    }

    void catalogFiles_data()
    {
        QTest::addColumn<QString>("caseName");
        const QDir golden(Golden);
        for (const QString &name : golden.entryList(QDir::Dirs | QDir::NoDotAndDotDot, QDir::Name))
            if (golden.exists(name + u"/settings.ini"_qs))
                QTest::newRow(qPrintable(name)) << name;
    }

    void catalogFiles()
    {
        QFETCH(QString, caseName);
        const QString caseFolder = Golden + caseName + QLatin1Char('/');
        QVERIFY(QDir(out()).removeRecursively());
        QVERIFY(QDir().mkpath(out(u"images"_qs)));
        test::OutputContext output;
        const QSettings ini(caseFolder + u"settings.ini"_qs, QSettings::IniFormat);
        loadSettings(ini, output.settings);
        const bool noItems = ini.value(u"Test/NoItems"_qs).toBool();
        if (output.settings.pageSplit == PageSplit::FilePerPage)
            copyPictures(out(u"images"_qs));

        const QString db = m_root.filePath(noItems ? u"no-items.db"_qs : u"items.db"_qs);
        const auto first = pages(output, db);
        QVERIFY2(first.isOk(), qPrintable(first.status().description()));
        QCOMPARE(first.value(), noItems ? QString() : out(u"zoindex.htm"_qs));
        const Status styled = CreateCSS(output.context, out(), true);
        QVERIFY2(styled.isOk(), qPrintable(styled.description()));
        const Status listed = list(output, db);
        QVERIFY2(listed.isOk(), qPrintable(listed.description()));
        QCOMPARE(output.user.fillWidth, 0);

        const auto produced = filesOf(out(), m_root.path());
        if (qEnvironmentVariableIntValue("ZORBIN_UPDATE_GOLDEN") == 1) {
            for (const QString &name : filesOf(caseFolder, {}, u"settings.ini"_qs).keys())
                QFile::remove(caseFolder + name);
            for (auto it = produced.cbegin(); it != produced.cend(); ++it)
                test::writeFile(caseFolder + it.key(), it.value());
            QSKIP("golden files written");
        }
        const auto expected = filesOf(caseFolder, {}, u"settings.ini"_qs);
        QCOMPARE(produced.keys(), expected.keys());
        for (auto it = expected.cbegin(); it != expected.cend(); ++it) { // the first line that differs
            const auto actual = produced.value(it.key()).split('\n'), wanted = it.value().split('\n');
            for (qsizetype i = 0; i < qMax(actual.size(), wanted.size()); ++i) {
                QVERIFY2(actual.value(i) == wanted.value(i),
                         qPrintable(u"%1:%2:\n  produced: %3\n  expected: %4"_qs.arg(it.key()).arg(i + 1).arg(
                             QString::fromLatin1(actual.value(i)), QString::fromLatin1(wanted.value(i)))));
            }
        }
    }

    // A stop, a price that is not a number (the schema keeps text out of a price column, a
    // damaged file does not) and a read that fails where the rows end: each leaves whole pages
    // where the writing stood; the failures fail the run.
    void abandonedPagesAreWhole_data()
    {
        QTest::addColumn<bool>("filePerPage");
        QTest::addColumn<QString>("database");
        QTest::addColumn<QString>("failure"); // none: a stop at the first progress point
        QTest::addColumn<QString>("lastPage");
        QTest::addColumn<QByteArray>("lastItem");
        for (const bool filePerPage : {true, false}) {
            const QString second = filePerPage ? u"zo000002.htm"_qs : u"zoindex.htm"_qs;
            QTest::addRow("stop, file per page %d", filePerPage)
                << filePerPage << u"seven.db"_qs << QString() << second << QByteArray("K0000005");
            QTest::addRow("read failure after the last row, file per page %d", filePerPage)
                << filePerPage << u"six.db"_qs << u"interrupted"_qs << second << QByteArray("K0000006");
        }
        QTest::newRow("price not a number")
            << false << u"bad-price.db"_qs << u"abc"_qs << u"zoindex.htm"_qs << QByteArray("K0000002");
    }

    void abandonedPagesAreWhole()
    {
        QFETCH(bool, filePerPage);
        QFETCH(QString, database);
        QFETCH(QString, failure);
        QFETCH(QString, lastPage);
        QFETCH(QByteArray, lastItem);
        test::OutputContext output;
        prepare(output, filePerPage);
        output.settings.lines[2].field = 4;
        const bool interrupted = failure == u"interrupted"_qs;
        output.user.onYield = [&] {
            output.state.StopRequested = failure.isEmpty();
            if (interrupted && output.user.yields == 1)
                test::interruptWorkDatabases();
        };
        const auto first = pages(output, m_root.filePath(database));
        if (failure.isEmpty()) {
            QVERIFY(first.isOk());
            QCOMPARE(first.value(), out(u"zoindex.htm"_qs));
            // The bar stays where the writing stopped: 5 of 8 cells.
            QCOMPARE(output.user.widths, (QList<int>{0, 625}));
        } else {
            QVERIFY(!first.isOk());
            QVERIFY2(first.status().description().contains(failure),
                     qPrintable(first.status().description()));
        }
        const QByteArray page = test::readFile(out(lastPage));
        QVERIFY(page.contains(lastItem));
        QVERIFY(!page.contains(lastItem.chopped(1) + char(lastItem.back() + 1)));
        verifyWholePage(page);
        verifyWholePage(test::readFile(out(u"zoindex.htm"_qs)));
        QVERIFY(!QFile::exists(out(u"zo000003.htm"_qs)));
        if (interrupted) { // the list fails the read after its sixth and last row
            output.user.yields = 0;
            output.user.onYield = [&output] {
                if (output.user.yields == 6)
                    test::interruptWorkDatabases();
            };
            QVERIFY(!list(output, m_root.filePath(database)).isOk());
            const QByteArray listed = test::readFile(out(u"zorbin3.htm"_qs));
            QVERIFY(listed.contains("K0000006"));
            verifyWholePage(listed);
        }
    }

    void noSixteenBitLimits()
    {
        // 32,768 pages of one cell, and a page of 200 x 200 cells: both past 16-bit numbers.
        const QString many = m_root.filePath(u"many.db"_qs);
        const Status made = makeItems(many, 32768);
        QVERIFY2(made.isOk(), qPrintable(made.description()));
        test::OutputContext output;
        prepare(output, false);
        output.settings.rows = 1;
        output.settings.columns = 1;
        output.settings.bottomPercent = 5;
        QVERIFY(pages(output, many).isOk());
        const QByteArray page = test::readFile(out(u"zoindex.htm"_qs));
        QCOMPARE(page.count("<table height='100%' width='100%'>"), 32768);
        QVERIFY(page.contains("K0032768"));
        QCOMPARE(output.user.widths.size(), 32768 / 5 + 2);

        test::OutputContext large;
        prepare(large, true);
        large.settings.rows = 200;
        large.settings.columns = 200;
        QVERIFY(pages(large, m_sevenItems).isOk());
        QCOMPARE(test::readFile(out(u"zoindex.htm"_qs)).count("<td class=D1>"), 40000);
        QCOMPARE(large.user.widths.size(), 40000 / 5 + 2);
    }

    void failuresBeforeAnyPage()
    {
        test::OutputContext output;
        prepare(output, true);
        const QString none = m_root.filePath(u"none.db"_qs);
        QVERIFY(!pages(output, none).isOk());
        QVERIFY(!list(output, none).isOk());
        QVERIFY(QDir(out()).entryList(QDir::Files).isEmpty());
    }

    void pageThatCannotBeWrittenFails()
    {
        test::FaultyFileSystem files;
        test::OutputContext output(files);
        prepare(output, true);
        files.failingPaths << out(u"zo000002.htm"_qs);
        const auto first = pages(output, m_sevenItems);
        QVERIFY(!first.isOk());
        QVERIFY(first.status().description().contains(out(u"zo000002.htm"_qs)));
        verifyWholePage(test::readFile(out(u"zoindex.htm"_qs)));
    }

    void listStopsAsAWholePage()
    {
        test::OutputContext output;
        prepare(output, false);
        output.user.onYield = [&output] {
            if (output.user.yields == 3)
                output.state.StopRequested = true;
        };
        QVERIFY(list(output, m_sevenItems).isOk());
        const QByteArray content = test::readFile(out(u"zorbin3.htm"_qs));
        QCOMPARE(content.count("  <tr bgcolor='#FFFFFF' align='right'>"), 3);
        QVERIFY(content.endsWith("    <td>K0000003</td>\r\n  </tr>\r\n</table>\r\n</BODY>\r\n</HTML>\r\n"));
        QCOMPARE(output.user.widths, (QList<int>{0, 143, 286, 429, 0}));
    }

    // Page numbers past 16 bits; the name in the images folder: what follows the platform's
    // separator, and only that.
    void fileNames()
    {
        QCOMPARE(HTMLFileName(u"/out/zo"_qs, 32768), u"/out/zo032768.htm"_qs);
        QCOMPARE(HTMLFileName(u"/out/zo"_qs, 1234567), u"/out/zo1234567.htm"_qs);
        const QString s = pathSeparator();
        const QString other = s == QLatin1String("/") ? u"\\"_qs : u"/"_qs;
        const QString images = u"images"_qs + s;
        QCOMPARE(ImageFileName(u"images"_qs, s + u"photos"_qs + s + u"A12.JPG"_qs), images + u"A12.JPG"_qs);
        QCOMPARE(ImageFileName(u"images"_qs, u"A12.JPG"_qs), images + u"A12.JPG"_qs);
        QCOMPARE(ImageFileName(u"images"_qs, u"photos"_qs + s), images);
        QCOMPARE(ImageFileName(u"images"_qs, u"x:A.JPG"_qs), images + u"x:A.JPG"_qs);
        QCOMPARE(ImageFileName(u"images"_qs, u"a"_qs + other + u"b.png"_qs),
                 images + u"a"_qs + other + u"b.png"_qs);
        QCOMPARE(ImageFileName(u"images"_qs, QString()), QString());
    }

    // Letters alef to tav; points, maqaf, geresh and ligatures are no letters.
    void hebrew()
    {
        QVERIFY(HasHebrew(u"x\u05D0"_qs));
        QVERIFY(HasHebrew(u"\u05EA"_qs));
        for (const QString &text : {QString(), u"Bolt M8 100"_qs, u"\u05B0\u05B8\u05BC\u05C7"_qs,
                                    u"\u05BE\u05F3\u05F4\u05F0"_qs, u"\u05CF\u05EB"_qs})
            QVERIFY2(!HasHebrew(text), qPrintable(text));
    }

    // A file path is percent-encoded where a URL would read it otherwise; a URL is only escaped.
    void fileReferences_data()
    {
        QTest::addColumn<QString>("path");
        QTest::addColumn<QString>("expected");
        QTest::newRow("url marks") << u"/p/50% #2?.png"_qs << u"/p/50%25 %232%3F.png"_qs;
        QTest::newRow("markup") << u"/p/<b>\".png"_qs << u"/p/&lt;b&gt;&quot;.png"_qs;
        QTest::newRow("hebrew and windows path stay")
            << u"c:\\תמונות\\כיסא.png"_qs << u"c:\\תמונות\\כיסא.png"_qs;
        QTest::newRow("a URL keeps its query and fragment")
            << u"http://host/p.php?id=5&s=1#x"_qs << u"http://host/p.php?id=5&amp;s=1#x"_qs;
        QTest::newRow("a URL keeps its percent codes")
            << u"https://cdn.example/l'or%20a.png"_qs << u"https://cdn.example/l&#39;or%20a.png"_qs;
        QTest::newRow("a colon alone is no scheme") << u"/p/a:b?.png"_qs << u"/p/a:b%3F.png"_qs;
    }

    void fileReferences()
    {
        QFETCH(QString, path);
        QFETCH(QString, expected);
        QCOMPARE(attributeFileReference(path), expected);
    }

    // Format bytes that the editor does not offer (a stored file can hold them) write the first word.
    void stylesheetOfUnknownFormatBytesWritesTheFirstWord()
    {
        test::OutputContext output;
        CellLine &line = output.settings.lines[8];
        line.field = 1;
        line.format = {3, 255, 3, 2, 3, 3}; // font, size, weight, underline, italic, align
        QVERIFY(CreateCSS(output.context, m_root.path(), true).isOk());
        QVERIFY(
            test::readFile(m_root.filePath(u"tarnik.css"_qs))
                .contains(
                    ".L8 {font-family:Arial (Hebrew); font-weight:Normal; font-size:255pt; text-align:Right; "
                    "color:black;}\r\n"));
    }
};

QTEST_GUILESS_MAIN(OutputTest)
#include "OutputTest.moc"
