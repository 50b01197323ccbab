#include "DemoExpectations.h"
#include "source/ConnectionString.h"
#include "source/SourceConnection.h"
#include "testutil/AccountingFixture.h"
#include "testutil/TestMain.h"

#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

// Connection types 1 and 2 through the real unixODBC driver manager, with the SQLite ODBC driver
// registered under the name "SQL Server" in a private odbcinst.ini (ctest sets ODBCSYSINI): the
// exact strings of BuildConnString reach a copy of the demo database, whose file name stands in
// the place of the database name. (A password that needs braces is tried on the PostgreSQL
// driver: the SQLite driver does not read braced values.)
class SqliteOdbcTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase()
    {
        QVERIFY2(qEnvironmentVariableIsSet("ODBCSYSINI"), "run through ctest, which registers the driver");
        QVERIFY(m_folder.isValid());
        m_database = copyDemoDatabase(m_folder.path());
    }

    void connectsWithTheOdbcString_data()
    {
        QTest::addColumn<int>("type");
        QTest::addColumn<QString>("user");
        QTest::addColumn<QString>("password");
        QTest::newRow("ODBC") << int(ConnectionKind::Odbc) << "sa"
                              << "";
        QTest::newRow("OLE DB through the ODBC driver") << int(ConnectionKind::OleDb) << "sa"
                                                        << "pw";
        QTest::newRow("OLE DB, integrated security") << int(ConnectionKind::OleDb) << ""
                                                     << "";
    }
    void connectsWithTheOdbcString()
    {
        QFETCH(int, type);
        QFETCH(QString, user);
        QFETCH(QString, password);
        const ConnectionParams params = serverParams(static_cast<ConnectionKind>(type), user, password);
        checkLogonTestSucceeds(params);
        checkListsFillFromDemo(params);
        checkItemQueryReadsDemo(params);
    }

    void theFaultIsTheDriversOwnText()
    {
        ConnectionParams params = serverParams(ConnectionKind::Odbc, QStringLiteral("sa"), QString());
        params.database = m_folder.filePath(QStringLiteral("no-such-folder/accounting.db"));
        const auto opened = SourceConnection::open(BuildConnString(params));
        QVERIFY(!opened);
        QVERIFY2(!opened.status().description().isEmpty(), "no description");
        // The driver is registered, so there is nothing to say about registering it.
        QVERIFY(!opened.status().description().contains(QStringLiteral("odbcinst.ini")));
    }

private:
    ConnectionParams serverParams(ConnectionKind type, const QString &user, const QString &password) const
    {
        return {QStringLiteral("127.0.0.1"), user, password, m_database, type};
    }

    QTemporaryDir m_folder;
    QString m_database;
};

ZORBIN_TEST_CLASS(SqliteOdbcTest)
#include "SqliteOdbcTest.moc"
