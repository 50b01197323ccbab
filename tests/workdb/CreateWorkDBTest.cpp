#include "model/CatalogSettings.h"
#include "model/ConnectionParams.h"
#include "model/RunContext.h"
#include "model/RunState.h"
#include "testutil/FaultyFileSystem.h"
#include "testutil/RecordingUserPort.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"
#include "testutil/WorkDatabaseFixture.h"
#include "workdb/WorkDatabase.h"
#include "workdb/WorkDatabasePath.h"

#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

class CreateWorkDBTest : public QObject
{
    Q_OBJECT

private:
    QTemporaryDir m_temp;
    QByteArray m_oldTemp;
    CatalogSettings m_settings;
    ConnectionParams m_connection;
    RunState m_state;
    RecordingUserPort m_user;
    FaultyFileSystem m_files;
    RunContext m_context{m_settings, m_connection, m_state, m_user, m_files};

    QString expectedPath() const { return m_temp.filePath(QStringLiteral("zorbindb.tmp")); }

private Q_SLOTS:
    void initTestCase()
    {
        QVERIFY(m_temp.isValid());
        m_oldTemp = qgetenv("TMPDIR");
        qputenv("TMPDIR", QFile::encodeName(m_temp.path()));
    }
    void cleanupTestCase() { qputenv("TMPDIR", m_oldTemp); }
    void init()
    {
        m_user = RecordingUserPort();
        m_files.failingPaths.clear();
    }

    // Without TMPDIR the working database is not put into the temporary folder that every user
    // shares, where another user's file of the same name would stop the run.
    void withoutTmpdirTheFolderIsTheUsersOwn()
    {
#ifdef Q_OS_WIN
        QSKIP("The temporary folder of Windows is the user's own.");
#else
        QTemporaryDir cache;
        const QByteArray oldCache = qgetenv("XDG_CACHE_HOME");
        qputenv("XDG_CACHE_HOME", QFile::encodeName(cache.path()));
        qunsetenv("TMPDIR");
        const QString path = workDatabasePath();
        qputenv("TMPDIR", QFile::encodeName(m_temp.path()));
        qputenv("XDG_CACHE_HOME", oldCache);
        QCOMPARE(path, cache.filePath(QStringLiteral("zorbin/zorbindb.tmp")));
        const auto everyone = QFileDevice::Permissions::fromInt(0x7077); // owner, group, others
        QCOMPARE(QFileInfo(cache.filePath(QStringLiteral("zorbin"))).permissions() & everyone,
                 QFileDevice::ReadOwner | QFileDevice::WriteOwner | QFileDevice::ExeOwner);
#endif
    }

    void createsTheFileInTheTemporaryFolder()
    {
        QCOMPARE(workDatabasePath(), expectedPath());
        QCOMPARE(CreateWorkDB(m_context).value(), expectedPath());
        QVERIFY(m_user.messages.isEmpty());
        for (const QString &table : {QStringLiteral("tItems"), QStringLiteral("tItemSort")})
            QCOMPARE(readWorkTable(expectedPath(), table).size(), 0);
    }

    void replacesTheDatabaseOfTheLastRun()
    {
        WorkRows rows;
        rows.items << WorkItem{QStringLiteral("old")};
        rows.other[QStringLiteral("tItemSort")] << QVariantList{1, QStringLiteral("old group")};
        QVERIFY(makeWorkDatabase(expectedPath(), rows));
        writeFile(expectedPath() + QStringLiteral("-journal"), QByteArray(512, 'j'));
        QCOMPARE(CreateWorkDB(m_context).value(), expectedPath());
        QVERIFY(!QFile::exists(expectedPath() + QStringLiteral("-journal")));
        QCOMPARE(readWorkTable(expectedPath(), QStringLiteral("tItems")).size(), 0);
        QCOMPARE(readWorkTable(expectedPath(), QStringLiteral("tItemSort")).size(), 0);
    }

    void anOldFileThatCannotBeDeletedIsAFault()
    {
        QVERIFY(makeWorkDatabase(expectedPath()));
        m_files.failingPaths.insert(expectedPath());
        const Result<QString> created = CreateWorkDB(m_context);
        QVERIFY(!created);
        QVERIFY(created.status().description().contains(expectedPath()));
    }

    void aFolderThatCannotBeWrittenIsAFault()
    {
        const QString path = m_temp.filePath(QStringLiteral("no such folder/zorbindb.tmp"));
        const Status created = createWorkDatabase(m_files, path);
        QVERIFY(!created);
        QVERIFY(created.description().contains(QStringLiteral("לא ניתן לפתוח")));
    }
};

ZORBIN_TEST_CLASS(CreateWorkDBTest)
#include "CreateWorkDBTest.moc"
