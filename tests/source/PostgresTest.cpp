#include "DemoExpectations.h"
#include "dialogs/LogonForm.h"
#include "model/CatalogSettings.h"
#include "source/ChoiceLists.h"
#include "source/ConnectionString.h"
#include "source/SourceConnection.h"
#include "testutil/TestMain.h"

#include <QDir>
#include <QSettings>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

// The accounting database on a PostgreSQL server that the test fixture started on 127.0.0.1
// (tests/source/postgres-fixture.sh), reached with the exact type 1 string of BuildConnString
// through the PostgreSQL ODBC driver, registered under the name "SQL Server" in the fixture's
// odbcinst.ini. The string carries no port: libpq takes it from PGPORT, as a DSN would give it.
class PostgresTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase()
    {
        const QString folder = qEnvironmentVariable("ZORBIN_POSTGRES_FIXTURE");
        QVERIFY2(!folder.isEmpty(), "run through ctest, whose fixture starts the server");
        const QString file = QDir(folder).filePath(QStringLiteral("fixture.ini"));
        QVERIFY2(QFile::exists(file),
                 qPrintable(file + QStringLiteral(" is missing: the server did not start")));
        QSettings fixture(file, QSettings::IniFormat);
        fixture.beginGroup(QStringLiteral("server"));
        m_port = fixture.value(QStringLiteral("port")).toString();
        m_closedPort = fixture.value(QStringLiteral("closedPort")).toString();
        m_database = fixture.value(QStringLiteral("database")).toString();
        m_user = fixture.value(QStringLiteral("user")).toString();
        m_password = fixture.value(QStringLiteral("password")).toString();
        m_trickyUser = fixture.value(QStringLiteral("trickyUser")).toString();
        m_trickyPassword = fixture.value(QStringLiteral("trickyPassword")).toString();
        QVERIFY(!m_port.isEmpty() && !m_closedPort.isEmpty());
        qputenv("PGPORT", m_port.toLatin1());
    }

    void theDialogsTestSucceeds()
    {
        const ConnectionParams params = reader();
        QCOMPARE(BuildConnString(params),
                 QStringLiteral("driver={SQL Server};server=127.0.0.1;uid=%1;pwd=%2;database=%3")
                     .arg(m_user, m_password, m_database));
        checkLogonTestSucceeds(params);
    }

    // A password with ";" and braces reaches the server whole.
    void aPasswordThatNeedsBracesConnects()
    {
        QVERIFY(m_trickyPassword.contains(QLatin1Char(';')) && m_trickyPassword.contains(QLatin1Char('}')));
        checkLogonTestSucceeds(
            {QStringLiteral("127.0.0.1"), m_trickyUser, m_trickyPassword, m_database, ConnectionKind::Odbc});
    }

    void aWrongPasswordFailsWithTheDriversText()
    {
        ConnectionParams params = reader();
        params.password = QStringLiteral("wrong");
        checkFailure(params, QStringLiteral("password authentication failed"));
    }

    void aStoppedServerFailsWithTheDriversText()
    {
        qputenv("PGPORT", m_closedPort.toLatin1());
        checkFailure(reader(), m_closedPort);
        qputenv("PGPORT", m_port.toLatin1());
    }

    void theListsFillFromTheServer() { checkListsFillFromDemo(reader()); }

    void theItemQueryReadsTheServer() { checkItemQueryReadsDemo(reader()); }

    void nothingChangesWhenTheServerIsDown()
    {
        CatalogSettings settings;
        FillCmbExtraNote(reader(), settings);
        FillCmbPriceField(reader(), settings);
        qputenv("PGPORT", m_closedPort.toLatin1());
        FillCmbExtraNote(reader(), settings);
        FillCmbPriceField(reader(), settings);
        qputenv("PGPORT", m_port.toLatin1());
        QCOMPARE(entriesOf(settings.extraNote1), demoNoteEntries());
        QCOMPARE(entriesOf(settings.priceList2), demoPriceListEntries());
    }

private:
    ConnectionParams reader() const
    {
        return {QStringLiteral("127.0.0.1"), m_user, m_password, m_database, ConnectionKind::Odbc};
    }

    void checkFailure(const ConnectionParams &params, const QString &expected)
    {
        LogonForm form;
        form.Form_Load(params);
        const Status outcome = form.CmdCheck_Click();
        QVERIFY(!outcome);
        QCOMPARE(form.LblMsg, LogonForm::TestFailedText);
        QVERIFY2(outcome.description().contains(expected), qPrintable(outcome.description()));
        QVERIFY(!outcome.description().contains(QStringLiteral("odbcinst.ini")));
    }

    QString m_port;
    QString m_closedPort;
    QString m_database;
    QString m_user;
    QString m_password;
    QString m_trickyUser;
    QString m_trickyPassword;
};

ZORBIN_TEST_CLASS(PostgresTest)
#include "PostgresTest.moc"
