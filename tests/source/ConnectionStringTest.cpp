#include "source/ConnectionString.h"

#include "platform/Paths.h"
#include "source/ConnectionStore.h"
#include "testutil/MemorySettingsStore.h"
#include "testutil/TestMain.h"

#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

class ConnectionStringTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void firstStartUsesTheDefaults()
    {
        MemorySettingsStore store;
        ConnectionParams params;
        GetRegConnParams(store, params);
        QCOMPARE(params.server, QStringLiteral("server"));
        QCOMPARE(params.user, QStringLiteral("sa"));
        QCOMPARE(params.password, QString());
        QCOMPARE(params.database, QStringLiteral("tarnik02"));
        QCOMPARE(params.kind, ConnectionKind::Odbc);
        QCOMPARE(BuildConnString(params),
                 QStringLiteral("driver={SQL Server};server=server;uid=sa;pwd=;database=tarnik02"));
    }

    void storedValuesAreLoaded()
    {
        MemorySettingsStore store;
        store.set(QStringLiteral("ConnServer"), QStringLiteral("SRV\\SQL2019"));
        store.set(QStringLiteral("ConnUID"), QString());
        store.set(QStringLiteral("ConnPWD"), QStringLiteral("secret"));
        store.set(QStringLiteral("ConnDataBase"), QStringLiteral("company7"));
        store.set(QStringLiteral("ConnType"), QStringLiteral("1"));
        ConnectionParams params;
        GetRegConnParams(store, params);
        QCOMPARE(params.server, QStringLiteral("SRV\\SQL2019"));
        QCOMPARE(params.user, QString());
        QCOMPARE(params.password, QStringLiteral("secret"));
        QCOMPARE(params.database, QStringLiteral("company7"));
        QCOMPARE(params.kind, ConnectionKind::OleDb);
    }

    void storedTypeIsTheListIndexPlusOne_data()
    {
        QTest::addColumn<QString>("stored");
        QTest::addColumn<int>("type"); // -1: the field keeps its value
        QTest::newRow("ODBC") << "0" << 1;
        QTest::newRow("OLE DB") << "1" << 2;
        QTest::newRow("file") << "2" << 3;
        QTest::newRow("none chosen") << "-1" << 0;
        QTest::newRow("half rounds to even, up") << "0.5" << 2;
        QTest::newRow("half rounds to even, down") << "1.5" << 2;
        QTest::newRow("blanks around") << " 2 " << 3;
        QTest::newRow("not a number") << "ODBC" << -1;
        QTest::newRow("empty") << "" << -1;
        QTest::newRow("beyond 16 bits") << "40000" << -1;
    }
    void storedTypeIsTheListIndexPlusOne()
    {
        QFETCH(QString, stored);
        QFETCH(int, type);
        MemorySettingsStore store;
        store.set(QStringLiteral("ConnType"), stored);
        ConnectionParams params;
        params.kind = ConnectionKind::File;
        GetRegConnParams(store, params);
        QCOMPARE(int(params.kind), type < 0 ? 3 : type);
    }

    void buildsTheStringOfEachType_data()
    {
        const QString sep = pathSeparator();
        QTest::addColumn<QString>("server");
        QTest::addColumn<QString>("user");
        QTest::addColumn<QString>("password");
        QTest::addColumn<QString>("database");
        QTest::addColumn<int>("type");
        QTest::addColumn<QString>("expected");
        QTest::newRow("ODBC") << "srv"
                              << "sa"
                              << "pw"
                              << "db" << 1 << "driver={SQL Server};server=srv;uid=sa;pwd=pw;database=db";
        QTest::newRow("ODBC, empty user")
            << "srv"
            << ""
            << ""
            << "db" << 1 << "driver={SQL Server};server=srv;uid=;pwd=;database=db";
        QTest::newRow("ODBC, null password")
            << "srv"
            << "sa" << QString() << "db" << 1 << "driver={SQL Server};server=srv;uid=sa;pwd=;database=db";
        QTest::newRow("OLE DB, integrated security")
            << "srv"
            << ""
            << "ignored"
            << "db" << 2
            << "Provider=sqloledb;Data Source=srv;Integrated Security=SSPI;Persist Security Info=False;Initial Catalog=db";
        QTest::newRow("OLE DB, a user of one blank")
            << "srv"
            << " "
            << "pw"
            << "db" << 2 << "Provider=sqloledb;Data Source=srv;User Id= ;Password=pw;Initial Catalog=db";
        QTest::newRow("OLE DB, login")
            << "srv"
            << "sa"
            << "pw"
            << "db" << 2 << "Provider=sqloledb;Data Source=srv;User Id=sa;Password=pw;Initial Catalog=db";
        QTest::newRow("file, folder without separator")
            << "data"
            << "sa"
            << "pw"
            << "company.mdb" << 3
            << QStringLiteral("Provider=Microsoft.Jet.OLEDB.4.0;Data Source=data") + sep +
                   QStringLiteral("company.mdb");
        QTest::newRow("file, folder with separator")
            << QStringLiteral("data") + sep << ""
            << ""
            << "company.mdb" << 3
            << QStringLiteral("Provider=Microsoft.Jet.OLEDB.4.0;Data Source=data") + sep +
                   QStringLiteral("company.mdb");
        QTest::newRow("file, no folder")
            << ""
            << ""
            << ""
            << "company.mdb" << 3 << "Provider=Microsoft.Jet.OLEDB.4.0;Data Source=company.mdb";
        QTest::newRow("no type") << "srv"
                                 << "sa"
                                 << "pw"
                                 << "db" << 0 << "";
        QTest::newRow("type 4") << "srv"
                                << "sa"
                                << "pw"
                                << "db" << 4 << "";
        QTest::newRow("type -1") << "srv"
                                 << "sa"
                                 << "pw"
                                 << "db" << -1 << "";
    }
    void buildsTheStringOfEachType()
    {
        QFETCH(QString, server);
        QFETCH(QString, user);
        QFETCH(QString, password);
        QFETCH(QString, database);
        QFETCH(int, type);
        QFETCH(QString, expected);
        QCOMPARE(BuildConnString(server, user, password, database, static_cast<ConnectionKind>(type)),
                 expected);
    }

    // A value that would split the string goes between braces (ODBC) or double quotes (OLE DB).
    void quotesValuesThatWouldBreakTheString_data()
    {
        QTest::addColumn<QString>("password");
        QTest::addColumn<int>("type");
        QTest::addColumn<QString>("expected");
        QTest::newRow("ODBC ;") << "a;b" << 1 << "driver={SQL Server};server=s;uid=u;pwd={a;b};database=d";
        QTest::newRow("ODBC }") << "x}y" << 1 << "driver={SQL Server};server=s;uid=u;pwd={x}}y};database=d";
        QTest::newRow("ODBC {") << "{abc" << 1 << "driver={SQL Server};server=s;uid=u;pwd={{abc};database=d";
        QTest::newRow("ODBC quote stays")
            << "a\"b'c" << 1 << "driver={SQL Server};server=s;uid=u;pwd=a\"b'c;database=d";
        QTest::newRow("OLE DB ;")
            << "a;b" << 2 << "Provider=sqloledb;Data Source=s;User Id=u;Password=\"a;b\";Initial Catalog=d";
        QTest::newRow("OLE DB \"")
            << "a\"b" << 2
            << "Provider=sqloledb;Data Source=s;User Id=u;Password=\"a\"\"b\";Initial Catalog=d";
        QTest::newRow("OLE DB '")
            << "it's" << 2 << "Provider=sqloledb;Data Source=s;User Id=u;Password=\"it's\";Initial Catalog=d";
        QTest::newRow("OLE DB brace stays")
            << "{x}" << 2 << "Provider=sqloledb;Data Source=s;User Id=u;Password={x};Initial Catalog=d";
    }
    void quotesValuesThatWouldBreakTheString()
    {
        QFETCH(QString, password);
        QFETCH(int, type);
        QFETCH(QString, expected);
        QCOMPARE(BuildConnString(QStringLiteral("s"), QStringLiteral("u"), password, QStringLiteral("d"),
                                 static_cast<ConnectionKind>(type)),
                 expected);
    }

    // A user or password comes back out of the string as it went in, whatever it holds.
    void loginSurvivesTheRoundTrip_data()
    {
        QTest::addColumn<QString>("value");
        for (const char *value :
             {"", "plain", "a;b", "}{", "x}}y", "{", "\"quoted\"", "it's", " spaced ", "a=b", "a;b}c{d\"e'f"})
            QTest::newRow(value) << QString::fromUtf8(value);
        QTest::newRow("Hebrew") << QStringLiteral("סיסמה;שלי");
    }
    void loginSurvivesTheRoundTrip()
    {
        QFETCH(QString, value);
        const QString odbc =
            BuildConnString(QStringLiteral("s"), value, value, QStringLiteral("d"), ConnectionKind::Odbc);
        QCOMPARE(connStringValue(odbc, QStringLiteral("uid")), value);
        QCOMPARE(connStringValue(odbc, QStringLiteral("pwd")), value);
        QCOMPARE(splitConnString(odbc).size(), 5);
        const QString oleDb = BuildConnString(QStringLiteral("s"), QStringLiteral("u"), value,
                                              QStringLiteral("d"), ConnectionKind::OleDb);
        const QString asParsed =
            oleDbConnValue(value) == value ? value.trimmed() : value; // OLE DB trims a bare value
        QCOMPARE(connStringValue(oleDb, QStringLiteral("Password")), asParsed);
        QCOMPARE(splitConnString(oleDb).size(), 5);
        // Type 2 reaches the server through the ODBC driver with the same values.
        const QString converted = odbcConnStringForOleDb(oleDb);
        QCOMPARE(connStringValue(converted, QStringLiteral("pwd")),
                 connStringValue(oleDb, QStringLiteral("Password")));
    }

    // A shop may pass a driver attribute with the server or the database on purpose.
    void serverAndDatabaseGoInAsStored_data()
    {
        QTest::addColumn<int>("type");
        QTest::addColumn<QString>("expected");
        QTest::newRow("ODBC") << int(ConnectionKind::Odbc)
                              << QStringLiteral("driver={SQL Server};server=myhost;Port=1433;uid=u;pwd={p;w};"
                                                "database=db;TDS_Version=7.4");
        QTest::newRow("OLE DB") << int(ConnectionKind::OleDb)
                                << QStringLiteral("Provider=sqloledb;Data Source=myhost;Port=1433;User Id=u;"
                                                  "Password=\"p;w\";Initial Catalog=db;TDS_Version=7.4");
    }
    void serverAndDatabaseGoInAsStored()
    {
        QFETCH(int, type);
        QFETCH(QString, expected);
        QCOMPARE(BuildConnString(QStringLiteral("myhost;Port=1433"), QStringLiteral("u"),
                                 QStringLiteral("p;w"), QStringLiteral("db;TDS_Version=7.4"),
                                 static_cast<ConnectionKind>(type)),
                 expected);
    }

    void oleDbBecomesOdbc_data()
    {
        QTest::addColumn<QString>("user");
        QTest::addColumn<QString>("expected");
        QTest::newRow("login") << "sa"
                               << "driver={SQL Server};server=srv;uid=sa;pwd=p;database=db";
        QTest::newRow("integrated security")
            << ""
            << "driver={SQL Server};server=srv;Trusted_Connection=yes;database=db";
    }
    void oleDbBecomesOdbc()
    {
        QFETCH(QString, user);
        QFETCH(QString, expected);
        const QString oleDb = BuildConnString(QStringLiteral("srv"), user, QStringLiteral("p"),
                                              QStringLiteral("db"), ConnectionKind::OleDb);
        QCOMPARE(odbcConnStringForOleDb(oleDb), expected);
    }

    void masksThePasswordForPrinting_data()
    {
        QTest::addColumn<QString>("text");
        QTest::addColumn<QString>("masked");
        QTest::newRow("ODBC") << "driver={SQL Server};server=s;uid=u;pwd=secret;database=d"
                              << "driver={SQL Server};server=s;uid=u;pwd=****;database=d";
        QTest::newRow("ODBC braced") << "driver={SQL Server};server=s;uid=u;pwd={a;b}}c};database=d"
                                     << "driver={SQL Server};server=s;uid=u;pwd=****;database=d";
        QTest::newRow("ODBC empty") << "driver={SQL Server};server=s;uid=u;pwd=;database=d"
                                    << "driver={SQL Server};server=s;uid=u;pwd=;database=d";
        QTest::newRow("OLE DB")
            << "Provider=sqloledb;Data Source=s;User Id=u;Password=\"x;y\";Initial Catalog=d"
            << "Provider=sqloledb;Data Source=s;User Id=u;Password=****;Initial Catalog=d";
        QTest::newRow("file") << "Provider=Microsoft.Jet.OLEDB.4.0;Data Source=/data/a.mdb"
                              << "Provider=Microsoft.Jet.OLEDB.4.0;Data Source=/data/a.mdb";
    }
    void masksThePasswordForPrinting()
    {
        QFETCH(QString, text);
        QFETCH(QString, masked);
        QCOMPARE(maskConnStringPassword(text), masked);
    }
};

ZORBIN_TEST_CLASS(ConnectionStringTest)
#include "ConnectionStringTest.moc"
