#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"

#include <QDir>
#include <QFileInfo>
#include <QProcess>
#include <QRegularExpression>
#include <QTemporaryDir>
#include <QTest>

namespace {

struct Run
{
    int exitCode = -1;
    QString out;
    QString err;
};

Run runCli(const QStringList &arguments, const QString &folder = {})
{
    QProcess process;
    process.setProgram(QStringLiteral(ZORBIN_CLI));
    process.setArguments(arguments);
    if (!folder.isEmpty())
        process.setWorkingDirectory(folder);
    process.start();
    process.closeWriteChannel(); // it must never wait for input
    if (!process.waitForFinished(120000))
        return {};
    return {process.exitCode(), QString::fromUtf8(process.readAllStandardOutput()),
            QString::fromUtf8(process.readAllStandardError())};
}

} // namespace

class CommandLineTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void everyCommandHasHelp_data()
    {
        QTest::addColumn<QString>("command");
        QTest::addColumn<QString>("mentions");
        QTest::newRow("catalog") << QStringLiteral("catalog") << QStringLiteral("--use-marked");
        QTest::newRow("list") << QStringLiteral("list") << QStringLiteral("--only-with-picture");
        QTest::newRow("demo") << QStringLiteral("demo") << QStringLiteral("--out");
        QTest::newRow("sql") << QStringLiteral("sql") << QStringLiteral("--settings");
    }
    void everyCommandHasHelp()
    {
        QFETCH(QString, command);
        QFETCH(QString, mentions);
        const Run run = runCli({command, QStringLiteral("--help")});
        QCOMPARE(run.exitCode, 0);
        QVERIFY2(run.out.contains(mentions), qPrintable(run.out));
    }

    void wrongCommandLinesAreUsageErrors_data()
    {
        QTest::addColumn<QStringList>("arguments");
        QTest::newRow("nothing") << QStringList{};
        QTest::newRow("unknown command") << QStringList{QStringLiteral("print")};
        QTest::newRow("unknown option") << QStringList{QStringLiteral("catalog"), QStringLiteral("--colour")};
        QTest::newRow("stray argument") << QStringList{QStringLiteral("list"), QStringLiteral("now")};
        QTest::newRow("missing settings file") << QStringList{
            QStringLiteral("catalog"), QStringLiteral("--settings"), QStringLiteral("/no/such.ini")};
    }
    void wrongCommandLinesAreUsageErrors()
    {
        QFETCH(QStringList, arguments);
        QCOMPARE(runCli(arguments).exitCode, 2);
    }

    // A run that cannot reach the accounting database says why on standard error and fails.
    void unreachableDatabaseFails()
    {
        QTemporaryDir folder;
        QVERIFY(folder.isValid());
        const QString settings = folder.filePath(QStringLiteral("settings.ini"));
        QFile file(settings);
        QVERIFY(file.open(QIODevice::WriteOnly));
        file.write(QStringLiteral(
                       "[Params]\nConnType=2\nConnServer=%1\nConnDataBase=missing.db\nPagingPath=%1/out\n")
                       .arg(folder.path())
                       .toUtf8());
        file.close();
        const Run run =
            runCli({QStringLiteral("catalog"), QStringLiteral("--settings"), settings}, folder.path());
        QCOMPARE(run.exitCode, 1);
        QVERIFY2(run.err.contains(QStringLiteral("missing.db")), qPrintable(run.err));
        QVERIFY2(run.err.contains(QStringLiteral("תקלה")), qPrintable(run.err));
    }

    void demoWritesTheCatalog()
    {
        QTemporaryDir folder;
        QVERIFY(folder.isValid());
        const Run run =
            runCli({QStringLiteral("demo"), QStringLiteral("--out"), QStringLiteral("shop")}, folder.path());
        QCOMPARE(run.exitCode, 0);
        const QString first = folder.filePath(QStringLiteral("shop/zoindex.htm"));
        QCOMPARE(run.out.trimmed(), first);
        QVERIFY(QFileInfo::exists(first));
        QVERIFY(QFileInfo::exists(folder.filePath(QStringLiteral("shop/zo000002.htm"))));
        QVERIFY(QFileInfo::exists(folder.filePath(QStringLiteral("shop/tarnik.css"))));
        QVERIFY(!QDir(folder.filePath(QStringLiteral("shop/images"))).isEmpty());
    }

    // Stored numbers are read as the pages have always read them: a band that is no number is left
    // out, a band of 100 is the whole height, a picture box of 0 gives no size attributes; only a
    // grid that cannot be made is refused, with the field's name.
    void catalogReadsStoredNumbersAsThePagesDo()
    {
        QTemporaryDir folder;
        QVERIFY(folder.isValid());
        const QString settings = folder.filePath(QStringLiteral("settings.ini"));
        QByteArray demo = zorbin::test::readFile(
            QDir(zorbin::test::demoFolder()).filePath(QStringLiteral("demo-settings.ini")));
        const QByteArray output = "\nPagingPath=" + folder.filePath(QStringLiteral("out")).toUtf8() + "\n";
        zorbin::test::writeFile(settings, demo + "\nTopPercent=abc\nBottomPercent=100\nImageW=0" + output);
        const Run run =
            runCli({QStringLiteral("catalog"), QStringLiteral("--settings"), settings}, folder.path());
        QCOMPARE(run.exitCode, 0);
        const QString first = folder.filePath(QStringLiteral("out/zoindex.htm"));
        QCOMPARE(run.out.trimmed(), first);
        const QString page = QString::fromLatin1(zorbin::test::readFile(first));
        QVERIFY(!page.contains(QStringLiteral("class=Top1")));
        QVERIFY(page.contains(QRegularExpression(QStringLiteral("<td colspan=\\d+ height='100%'>"))));
        QVERIFY(page.contains(QStringLiteral("<img src=")));
        QVERIFY(!page.contains(QRegularExpression(QStringLiteral("<img [^>]* height=\\d"))));

        zorbin::test::writeFile(settings, demo + "\nRows=abc" + output);
        const Run refused =
            runCli({QStringLiteral("catalog"), QStringLiteral("--settings"), settings}, folder.path());
        QCOMPARE(refused.exitCode, 1);
        QVERIFY2(refused.err.contains(QStringLiteral("\"שורות\"")), qPrintable(refused.err));
    }

    // Each enabled step prints its statement once, in the order of a run; the password never shows.
    void sqlListsTheStatementsOfARun()
    {
        QTemporaryDir folder;
        QVERIFY(folder.isValid());
        const QString settings = folder.filePath(QStringLiteral("settings.ini"));
        const QByteArray common = "[Params]\nConnType=0\nConnServer=db1\nConnUID=shop\nConnPWD=s3cret\n"
                                  "ConnDataBase=stock\nUseCatCode=1\nFromSort=10\nLineTag0=0\nLineTag1=8\n";
        zorbin::test::writeFile(settings, common + "UseExtraNote2=1\n");
        const Run run = runCli({QStringLiteral("sql"), QStringLiteral("--settings"), settings});
        QCOMPARE(run.exitCode, 1); // the note kinds could not be read, so no note is chosen
        QVERIFY2(run.err.contains(QStringLiteral("נתון נוסף 2")), qPrintable(run.err));

        zorbin::test::writeFile(settings, common);
        const Run listed = runCli({QStringLiteral("sql"), QStringLiteral("--settings"), settings});
        QCOMPARE(listed.exitCode, 0);
        QStringList labels;
        for (const QString &line : listed.out.split(QLatin1Char('\n'), Qt::SkipEmptyParts))
            labels << line.section(QLatin1Char(':'), 0, 0);
        QCOMPARE(labels, (QStringList{QStringLiteral("connection"), QStringLiteral("items"),
                                      QStringLiteral("sort-groups"), QStringLiteral("catalog")}));
        QVERIFY(
            listed.out.contains(QStringLiteral("connection: driver={SQL Server};server=db1;uid=shop;pwd=")));
        QVERIFY(!listed.out.contains(QStringLiteral("s3cret")));
        QVERIFY(listed.out.contains(QStringLiteral(" And Items.SortGroup >= 10")));
        QVERIFY(listed.out.contains(QStringLiteral("(Select ExtraNote From tExtraNote2")));
    }
};

ZORBIN_TEST_CLASS(CommandLineTest)
#include "CommandLineTest.moc"
