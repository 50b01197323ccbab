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
    QString out, err;
};

// Runs zorbin-cli with the words of `commandLine` (the demo's settings file in place of
// "SETTINGS") in the demo's scratch folder, where its working database goes too.
Run runCli(const QString &commandLine, const DemoScratch &demo)
{
    QStringList arguments = commandLine.split(QLatin1Char(' '), Qt::SkipEmptyParts);
    arguments.replaceInStrings(u"SETTINGS"_qs, demo.settingsFile);
    QProcess process;
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    environment.insert(u"TMPDIR"_qs, demo.folder.path());
    process.setProcessEnvironment(environment);
    process.setWorkingDirectory(demo.folder.path());
    process.start(QStringLiteral(ZORBIN_CLI), arguments);
    process.closeWriteChannel(); // it must never wait for input
    if (!process.waitForFinished(120000))
        return {};
    return {process.exitCode(), QString::fromUtf8(process.readAllStandardOutput()),
            QString::fromUtf8(process.readAllStandardError())};
}

// Stores "Key=value" options in the demo's settings file.
void setStored(DemoScratch &demo, std::initializer_list<const char *> options)
{
    for (const char *option : options) {
        const QString text = QString::fromLatin1(option);
        demo.store->write(u"Zorbin"_qs, u"Params"_qs, text.section(QLatin1Char('='), 0, 0),
                          text.section(QLatin1Char('='), 1));
    }
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
        // Help succeeds; a command line that is none fails with status 2.
        for (const char *line : {"--help", "catalog --help"})
            QTest::newRow(line) << QString::fromLatin1(line) << 0;
        for (const char *line : {"", "print", "catalog --colour", "list now",
                                 "catalog --settings /no/such.ini", "sql --settings /no/such.ini"})
            QTest::newRow(*line ? line : "nothing") << QString::fromLatin1(line) << 2;
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
        QTest::newRow("catalog") << u"catalog --settings SETTINGS"_qs << u"catalog/zoindex.htm"_qs << true;
        QTest::newRow("list") << u"list --settings SETTINGS"_qs << u"catalog/zorbin3.htm"_qs << false;
        QTest::newRow("demo") << u"demo --out shop"_qs << u"shop/zoindex.htm"_qs << true;
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
        const QStringList written = folder.entryList({u"*.htm"_qs, u"*.css"_qs});
        QCOMPARE(written.size(), catalog ? 35 : 1);
        QVERIFY(folder.exists(u"images/item-11.jpg"_qs) == catalog);
        if (catalog)
            QCOMPARE(firstItemKey(first), u"00010"_qs);
        else
            QCOMPARE(listRows(first), 301);
    }

    // --use-marked makes the catalog of the working database that the last collection left,
    // marks and all.
    void catalogOfTheMarkedItems()
    {
        DemoScratch demo;
        QCOMPARE(runCli(u"list --settings SETTINGS"_qs, demo).exitCode, 0);
        const Run run = runCli(u"catalog --use-marked --settings SETTINGS"_qs, demo);
        QCOMPARE(run.exitCode, 0);
        QCOMPARE(firstItemKey(demo.out(u"zoindex.htm"_qs)), u"00010"_qs);
        QVERIFY2(!run.err.contains(u"סורק"_qs), qPrintable(run.err)); // nothing collected
    }

    // Stored numbers are read as the pages have always read them: a band that is no number is left
    // out, a band of 100 is the whole height, a picture box of 0 gives no size attributes; only a
    // grid that cannot be made is refused, told as a fault on standard error with the field's name.
    void catalogReadsStoredNumbersAsThePagesDo()
    {
        DemoScratch demo;
        setStored(demo, {"TopPercent=abc", "BottomPercent=100", "ImageW=0"});
        const Run run = runCli(u"catalog --settings SETTINGS"_qs, demo);
        QCOMPARE(run.exitCode, 0);
        const QString page = QString::fromLatin1(readFile(run.out.trimmed()));
        QVERIFY(!page.contains(u"class=Top1"_qs));
        QVERIFY(page.contains(QRegularExpression(u"<td colspan=\\d+ height='100%'>"_qs)));
        QVERIFY(page.contains(u"<img src="_qs));
        QVERIFY(!page.contains(QRegularExpression(u"<img [^>]* height=\\d"_qs)));

        setStored(demo, {"Rows=abc"});
        const Run refused = runCli(u"catalog --settings SETTINGS"_qs, demo);
        QCOMPARE(refused.exitCode, 1);
        QVERIFY2(refused.err.contains(u"תקלה: "_qs) && refused.err.contains(u"\"שורות\""_qs),
                 qPrintable(refused.err));
    }

    // Each enabled step prints its statement once, in the order of a run; the password never
    // shows; a step enabled without its list's choice is a fault.
    void sqlListsTheStatementsOfARun()
    {
        DemoScratch demo;
        const QString sql = u"sql --settings SETTINGS"_qs;
        const Run run = runCli(sql, demo);
        QCOMPARE(run.exitCode, 0);
        QStringList labels;
        for (const QString &line : run.out.split(QLatin1Char('\n'), Qt::SkipEmptyParts))
            labels << line.section(QLatin1Char(':'), 0, 0);
        QCOMPARE(labels, (QStringList{u"connection"_qs, u"items"_qs, u"sort-groups"_qs, u"price1"_qs,
                                      u"catalog"_qs}));
        QVERIFY(run.out.contains(u"PriceListNumber = 1 "_qs));

        // A server that cannot be reached: no list is filled.
        setStored(demo, {"ConnType=0", "ConnUID=shop", "ConnPWD=s3cret", "UsePriceField=0", "UseCatCode=1",
                         "FromSort=10", "UseExtraNote2=1"});
        const Run noNote = runCli(sql, demo);
        QCOMPARE(noNote.exitCode, 1);
        QVERIFY2(noNote.err.contains(u"נתון נוסף 2"_qs), qPrintable(noNote.err));
        setStored(demo, {"UseExtraNote2=0"});
        const Run listed = runCli(sql, demo);
        QCOMPARE(listed.exitCode, 0);
        QVERIFY(listed.out.startsWith(u"connection: driver={SQL Server};"_qs));
        QVERIFY(listed.out.contains(u";uid=shop;pwd="_qs) && !listed.out.contains(QLatin1String("s3cret")));
        QVERIFY(listed.out.contains(u" And Items.SortGroup >= 10"_qs));
    }
};

QTEST_GUILESS_MAIN(CommandLineTest)
#include "CommandLineTest.moc"
