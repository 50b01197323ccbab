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

// Runs zorbin-cli in `folder` (its working database there too), with the demo's settings file
// in place of "SETTINGS".
Run runCli(QStringList arguments, const DemoScratch &demo)
{
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

void setStored(DemoScratch &demo, const QString &key, const QString &value)
{
    demo.store->write(QStringLiteral("Zorbin"), QStringLiteral("Params"), key, value);
    demo.store->flush();
}

} // namespace

class CommandLineTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void commandLines_data()
    {
        QTest::addColumn<QStringList>("arguments");
        QTest::addColumn<int>("exitCode");
        QTest::addColumn<QString>("printed"); // a part of standard output
        const QString settings = QStringLiteral("--settings");
        QTest::newRow("help") << QStringList{QStringLiteral("--help")} << 0 << QStringLiteral("demo ");
        QTest::newRow("catalog help") << QStringList{QStringLiteral("catalog"), QStringLiteral("--help")} << 0
                                      << QStringLiteral("--use-marked");
        QTest::newRow("nothing") << QStringList{} << 2 << QStringLiteral("Usage");
        QTest::newRow("unknown command") << QStringList{QStringLiteral("print")} << 2 << QString();
        QTest::newRow("unknown option")
            << QStringList{QStringLiteral("catalog"), QStringLiteral("--colour")} << 2 << QString();
        QTest::newRow("stray argument")
            << QStringList{QStringLiteral("list"), QStringLiteral("now")} << 2 << QString();
        QTest::newRow("missing settings file")
            << QStringList{QStringLiteral("catalog"), settings, QStringLiteral("/no/such.ini")} << 2
            << QString();
        QTest::newRow("sql, missing settings file")
            << QStringList{QStringLiteral("sql"), settings, QStringLiteral("/no/such.ini")} << 2 << QString();
    }
    void commandLines()
    {
        QFETCH(QStringList, arguments);
        QFETCH(int, exitCode);
        QFETCH(QString, printed);
        DemoScratch demo;
        const Run run = runCli(arguments, demo);
        QCOMPARE(run.exitCode, exitCode);
        QVERIFY2(run.out.contains(printed), qPrintable(run.out));
    }

    // Each run prints the path of what it wrote; the test reads the files themselves.
    void wholeRunsOnTheDemo_data()
    {
        QTest::addColumn<QStringList>("arguments");
        QTest::addColumn<QString>("printed"); // relative to the scratch folder
        QTest::addColumn<QStringList>("written");
        QTest::addColumn<QStringList>("absent");
        QTest::addColumn<int>("listRows"); // -1: a catalog, whose first item is checked
        // 301 items, nine to a page.
        const QStringList pages = {QStringLiteral("zo000002.htm"), QStringLiteral("zo000034.htm"),
                                   QStringLiteral("tarnik.css"), QStringLiteral("images/item-11.jpg")};
        const QStringList notPages = {QStringLiteral("zo000035.htm"), QStringLiteral("zorbin3.htm")};
        QTest::newRow("catalog") << QStringList{QStringLiteral("catalog"), QStringLiteral("--settings"),
                                                QStringLiteral("SETTINGS")}
                                 << QStringLiteral("catalog/zoindex.htm") << pages << notPages << -1;
        QTest::newRow("list") << QStringList{QStringLiteral("list"), QStringLiteral("--settings"),
                                             QStringLiteral("SETTINGS")}
                              << QStringLiteral("catalog/zorbin3.htm") << QStringList()
                              << QStringList{QStringLiteral("zoindex.htm"), QStringLiteral("tarnik.css")}
                              << 301;
        QTest::newRow("demo") << QStringList{QStringLiteral("demo"), QStringLiteral("--out"),
                                             QStringLiteral("shop")}
                              << QStringLiteral("shop/zoindex.htm") << pages << notPages << -1;
    }
    void wholeRunsOnTheDemo()
    {
        QFETCH(QStringList, arguments);
        QFETCH(QString, printed);
        QFETCH(QStringList, written);
        QFETCH(QStringList, absent);
        QFETCH(int, listRows);
        DemoScratch demo;
        const Run run = runCli(arguments, demo);
        QCOMPARE(run.exitCode, 0);
        const QString first = demo.folder.filePath(printed);
        QCOMPARE(run.out, first + QLatin1Char('\n'));
        const QDir folder = QFileInfo(first).dir();
        for (const QString &name : written)
            QVERIFY2(QFileInfo::exists(folder.filePath(name)), qPrintable(name));
        for (const QString &name : absent)
            QVERIFY2(!QFileInfo::exists(folder.filePath(name)), qPrintable(name));
        if (listRows < 0)
            QCOMPARE(firstItemKey(first), QStringLiteral("00010"));
        else
            QCOMPARE(zorbin::test::listRows(first), listRows);
    }

    // --use-marked makes the catalog of the working database the last collection left, marks
    // and all; with none there, the run says what to do and fails.
    void catalogOfTheMarkedItems()
    {
        DemoScratch demo;
        const QStringList marked = {QStringLiteral("catalog"), QStringLiteral("--use-marked"),
                                    QStringLiteral("--settings"), QStringLiteral("SETTINGS")};
        const Run none = runCli(marked, demo);
        QCOMPARE(none.exitCode, 1);
        QVERIFY2(none.err.contains(QStringLiteral("בחירת פריטים")), qPrintable(none.err));
        QCOMPARE(
            runCli({QStringLiteral("list"), QStringLiteral("--settings"), demo.settingsFile}, demo).exitCode,
            0);
        const Run run = runCli(marked, demo);
        QCOMPARE(run.exitCode, 0);
        QCOMPARE(firstItemKey(demo.out(QStringLiteral("zoindex.htm"))), QStringLiteral("00010"));
        QVERIFY2(!run.err.contains(QStringLiteral("סורק")), qPrintable(run.err)); // nothing collected
    }

    // A run that cannot reach the accounting database says why on standard error and fails.
    void unreachableDatabaseFails()
    {
        DemoScratch demo;
        setStored(demo, QStringLiteral("ConnDataBase"), QStringLiteral("missing.db"));
        const Run run =
            runCli({QStringLiteral("catalog"), QStringLiteral("--settings"), demo.settingsFile}, demo);
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
        setStored(demo, QStringLiteral("TopPercent"), QStringLiteral("abc"));
        setStored(demo, QStringLiteral("BottomPercent"), QStringLiteral("100"));
        setStored(demo, QStringLiteral("ImageW"), QStringLiteral("0"));
        const QStringList catalog = {QStringLiteral("catalog"), QStringLiteral("--settings"),
                                     demo.settingsFile};
        const Run run = runCli(catalog, demo);
        QCOMPARE(run.exitCode, 0);
        const QString page = QString::fromLatin1(readFile(run.out.trimmed()));
        QVERIFY(!page.contains(QStringLiteral("class=Top1")));
        QVERIFY(page.contains(QRegularExpression(QStringLiteral("<td colspan=\\d+ height='100%'>"))));
        QVERIFY(page.contains(QStringLiteral("<img src=")));
        QVERIFY(!page.contains(QRegularExpression(QStringLiteral("<img [^>]* height=\\d"))));

        setStored(demo, QStringLiteral("Rows"), QStringLiteral("abc"));
        const Run refused = runCli(catalog, demo);
        QCOMPARE(refused.exitCode, 1);
        QVERIFY2(refused.err.contains(QStringLiteral("\"שורות\"")), qPrintable(refused.err));
    }

    // Each enabled step prints its statement once, in the order of a run; the password never
    // shows; a step enabled without its list's choice is a fault.
    void sqlListsTheStatementsOfARun()
    {
        DemoScratch demo;
        auto labels = [](const Run &run) {
            QStringList found;
            for (const QString &line : run.out.split(QLatin1Char('\n'), Qt::SkipEmptyParts))
                found << line.section(QLatin1Char(':'), 0, 0);
            return found;
        };
        const QStringList sql = {QStringLiteral("sql"), QStringLiteral("--settings"), demo.settingsFile};
        const Run run = runCli(sql, demo);
        QCOMPARE(run.exitCode, 0);
        QCOMPARE(labels(run), (QStringList{QStringLiteral("connection"), QStringLiteral("items"),
                                           QStringLiteral("sort-groups"), QStringLiteral("price1"),
                                           QStringLiteral("catalog")}));
        QVERIFY(run.out.contains(QStringLiteral("PriceListNumber = 1 ")));

        setStored(demo, QStringLiteral("ConnType"), QStringLiteral("0"));
        setStored(demo, QStringLiteral("ConnUID"), QStringLiteral("shop"));
        setStored(demo, QStringLiteral("ConnPWD"), QStringLiteral("s3cret"));
        setStored(demo, QStringLiteral("UseCatCode"), QStringLiteral("1"));
        setStored(demo, QStringLiteral("FromSort"), QStringLiteral("10"));
        setStored(demo, QStringLiteral("UsePriceField"), QStringLiteral("0"));
        setStored(demo, QStringLiteral("UseExtraNote2"), QStringLiteral("1"));
        const Run secret = runCli(sql, demo);
        QCOMPARE(secret.exitCode, 1); // the note kinds could not be read, so no note is chosen
        QVERIFY2(secret.err.contains(QStringLiteral("נתון נוסף 2")), qPrintable(secret.err));
        setStored(demo, QStringLiteral("UseExtraNote2"), QStringLiteral("0"));
        const Run listed = runCli(sql, demo);
        QCOMPARE(listed.exitCode, 0);
        QVERIFY(listed.out.contains(QStringLiteral("connection: driver={SQL Server};")));
        QVERIFY(listed.out.contains(QStringLiteral(";uid=shop;pwd=")));
        QVERIFY(!listed.out.contains(QStringLiteral("s3cret")));
        QVERIFY(listed.out.contains(QStringLiteral(" And Items.SortGroup >= 10")));
    }
};

QTEST_GUILESS_MAIN(CommandLineTest)
#include "CommandLineTest.moc"
