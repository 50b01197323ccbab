#include "testutil/TestMain.h"

#include <QProcess>
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
    process.closeWriteChannel();  // it must never wait for input
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
        QTest::newRow("missing settings file")
            << QStringList{QStringLiteral("catalog"), QStringLiteral("--settings"), QStringLiteral("/no/such.ini")};
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
        file.write(QStringLiteral("[Params]\nConnType=2\nConnServer=%1\nConnDataBase=missing.db\nPagingPath=%1/out\n")
                       .arg(folder.path())
                       .toUtf8());
        file.close();
        const Run run = runCli({QStringLiteral("catalog"), QStringLiteral("--settings"), settings}, folder.path());
        QCOMPARE(run.exitCode, 1);
        QVERIFY2(run.err.contains(QStringLiteral("תקלה")), qPrintable(run.err));
    }
};

ZORBIN_TEST_CLASS(CommandLineTest)
#include "CommandLineTest.moc"
