// zorbin-cli as a user runs it: each command on the demo database, and what it wrote or printed.
#include "testutil/DemoScratch.h"
#include "testutil/TestFiles.h"

#include <QDir>
#include <QFileInfo>
#include <QProcess>
#include <QRegularExpression>
#include <QTest>

using namespace zorbin::test;

namespace {

struct Run
{
    int exitCode = -1;
    QString out;
    QString err;
};

// Runs zorbin-cli with the words of `commandLine` (the demo's settings file in place of
// "SETTINGS") in the demo's scratch folder, where its working database goes too.
Run runCli(const QString &commandLine, const DemoScratch &demo)
{
    QStringList arguments = commandLine.split(QLatin1Char(' '), Qt::SkipEmptyParts);
    arguments.replaceInStrings(QStringLiteral("SETTINGS"), demo.settingsFile);
    QProcess process;
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    environment.insert(QStringLiteral("TMPDIR"), demo.folder.path());
    process.setProcessEnvironment(environment);
    process.setWorkingDirectory(demo.folder.path());
    process.start(QStringLiteral(ZORBIN_CLI), arguments);
    process.closeWriteChannel(); // it must never wait for input
    if (!process.waitForFinished(120000))
        return {};
    return {process.exitCode(), QString::fromUtf8(process.readAllStandardOutput()),
            QString::fromUtf8(process.readAllStandardError())};
}

void setStored(DemoScratch &demo, const char *key, const char *value)
{
    demo.store->write(QStringLiteral("Zorbin"), QStringLiteral("Params"), QLatin1String(key),
                      QLatin1String(value));
    demo.store->flush();
}

} // namespace

class CommandLineTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void commandLines_data()
    {
        QTest::addColumn<QString>("commandLine");
        QTest::addColumn<int>("exitCode");
        for (const auto &[line, exitCode] :
             std::initializer_list<std::pair<const char *, int>>{{"--help", 0},
                                                                 {"catalog --help", 0},
                                                                 {"", 2},
                                                                 {"print", 2},
                                                                 {"catalog --colour", 2},
                                                                 {"list now", 2},
                                                                 {"catalog --settings /no/such.ini", 2},
                                                                 {"sql --settings /no/such.ini", 2}})
            QTest::newRow(*line ? line : "nothing") << QString::fromLatin1(line) << exitCode;
    }
    void commandLines()
    {
        QFETCH(QString, commandLine);
        QFETCH(int, exitCode);
        QCOMPARE(runCli(commandLine, DemoScratch()).exitCode, exitCode);
    }

    // Each run prints the path of what it wrote; the test reads the files themselves.
    void wholeRunsOnTheDemo_data()
    {
        QTest::addColumn<QString>("commandLine");
        QTest::addColumn<QString>("printed"); // relative to the scratch folder
        QTest::addColumn<bool>("catalog");
        QTest::newRow("catalog") << QStringLiteral("catalog --settings SETTINGS")
                                 << QStringLiteral("catalog/zoindex.htm") << true;
        QTest::newRow("list") << QStringLiteral("list --settings SETTINGS")
                              << QStringLiteral("catalog/zorbin3.htm") << false;
        QTest::newRow("demo") << QStringLiteral("demo --out shop") << QStringLiteral("shop/zoindex.htm")
                              << true;
    }
    void wholeRunsOnTheDemo()
    {
        QFETCH(QString, commandLine);
        QFETCH(QString, printed);
        QFETCH(bool, catalog);
        DemoScratch demo;
        const Run run = runCli(commandLine, demo);
        QCOMPARE(run.exitCode, 0);
        const QString first = demo.folder.filePath(printed);
        QCOMPARE(run.out, first + QLatin1Char('\n'));
        // 301 items, nine to a page: the first page, 33 more, the stylesheet; or the list alone.
        const QDir folder = QFileInfo(first).dir();
        const QStringList written = folder.entryList({QStringLiteral("*.htm"), QStringLiteral("*.css")});
        QCOMPARE(written.size(), catalog ? 35 : 1);
        QVERIFY(written.contains(QStringLiteral("zo000034.htm")) == catalog);
        QVERIFY(folder.exists(QStringLiteral("images/item-11.jpg")) == catalog);
        if (catalog)
            QCOMPARE(firstItemKey(first), QStringLiteral("00010"));
        else
            QCOMPARE(listRows(first), 301);
    }

    // --use-marked makes the catalog of the working database that the last collection left,
    // marks and all; with none there, the run says what to do and fails.
    void catalogOfTheMarkedItems()
    {
        DemoScratch demo;
        const QString marked = QStringLiteral("catalog --use-marked --settings SETTINGS");
        const Run none = runCli(marked, demo);
        QCOMPARE(none.exitCode, 1);
        QVERIFY2(none.err.contains(QStringLiteral("בחירת פריטים")), qPrintable(none.err));
        QCOMPARE(runCli(QStringLiteral("list --settings SETTINGS"), demo).exitCode, 0);
        const Run run = runCli(marked, demo);
        QCOMPARE(run.exitCode, 0);
        QCOMPARE(firstItemKey(demo.out(QStringLiteral("zoindex.htm"))), QStringLiteral("00010"));
        QVERIFY2(!run.err.contains(QStringLiteral("סורק")), qPrintable(run.err)); // nothing collected
    }

    // A run that cannot reach the accounting database says why on standard error and fails.
    void unreachableDatabaseFails()
    {
        DemoScratch demo;
        setStored(demo, "ConnDataBase", "missing.db");
        const Run run = runCli(QStringLiteral("catalog --settings SETTINGS"), demo);
        QCOMPARE(run.exitCode, 1);
        QVERIFY2(run.err.contains(QStringLiteral("missing.db")), qPrintable(run.err));
        QVERIFY2(run.err.contains(QStringLiteral("תקלה")), qPrintable(run.err));
        QVERIFY(!QFileInfo::exists(demo.out(QStringLiteral("zoindex.htm"))));
    }

    // Stored numbers are read as the pages have always read them: a band that is no number is left
    // out, a band of 100 is the whole height, a picture box of 0 gives no size attributes; only a
    // grid that cannot be made is refused, with the field's name.
    void catalogReadsStoredNumbersAsThePagesDo()
    {
        DemoScratch demo;
        setStored(demo, "TopPercent", "abc");
        setStored(demo, "BottomPercent", "100");
        setStored(demo, "ImageW", "0");
        const Run run = runCli(QStringLiteral("catalog --settings SETTINGS"), demo);
        QCOMPARE(run.exitCode, 0);
        const QString page = QString::fromLatin1(readFile(run.out.trimmed()));
        QVERIFY(!page.contains(QStringLiteral("class=Top1")));
        QVERIFY(page.contains(QRegularExpression(QStringLiteral("<td colspan=\\d+ height='100%'>"))));
        QVERIFY(page.contains(QStringLiteral("<img src=")));
        QVERIFY(!page.contains(QRegularExpression(QStringLiteral("<img [^>]* height=\\d"))));

        setStored(demo, "Rows", "abc");
        const Run refused = runCli(QStringLiteral("catalog --settings SETTINGS"), demo);
        QCOMPARE(refused.exitCode, 1);
        QVERIFY2(refused.err.contains(QStringLiteral("\"שורות\"")), qPrintable(refused.err));
    }

    // Each enabled step prints its statement once, in the order of a run; the password never
    // shows; a step enabled without its list's choice is a fault.
    void sqlListsTheStatementsOfARun()
    {
        DemoScratch demo;
        const QString sql = QStringLiteral("sql --settings SETTINGS");
        const Run run = runCli(sql, demo);
        QCOMPARE(run.exitCode, 0);
        QStringList labels;
        for (const QString &line : run.out.split(QLatin1Char('\n'), Qt::SkipEmptyParts))
            labels << line.section(QLatin1Char(':'), 0, 0);
        QCOMPARE(labels, (QStringList{QStringLiteral("connection"), QStringLiteral("items"),
                                      QStringLiteral("sort-groups"), QStringLiteral("price1"),
                                      QStringLiteral("catalog")}));
        QVERIFY(run.out.contains(QStringLiteral("PriceListNumber = 1 ")));

        // A server that cannot be reached: no list is filled.
        for (const auto &[key, value] :
             std::initializer_list<std::pair<const char *, const char *>>{{"ConnType", "0"},
                                                                          {"ConnUID", "shop"},
                                                                          {"ConnPWD", "s3cret"},
                                                                          {"UsePriceField", "0"},
                                                                          {"UseCatCode", "1"},
                                                                          {"FromSort", "10"},
                                                                          {"UseExtraNote2", "1"}})
            setStored(demo, key, value);
        const Run noNote = runCli(sql, demo);
        QCOMPARE(noNote.exitCode, 1);
        QVERIFY2(noNote.err.contains(QStringLiteral("נתון נוסף 2")), qPrintable(noNote.err));
        setStored(demo, "UseExtraNote2", "0");
        const Run listed = runCli(sql, demo);
        QCOMPARE(listed.exitCode, 0);
        QVERIFY(listed.out.startsWith(QStringLiteral("connection: driver={SQL Server};")));
        QVERIFY(listed.out.contains(QStringLiteral(";uid=shop;pwd=")) &&
                !listed.out.contains(QLatin1String("s3cret")));
        QVERIFY(listed.out.contains(QStringLiteral(" And Items.SortGroup >= 10")));
    }
};

QTEST_GUILESS_MAIN(CommandLineTest)
#include "CommandLineTest.moc"
