#include "source/SourceConnection.h"

#include "dialogs/LogonForm.h"
#include "model/CatalogSettings.h"
#include "source/ChoiceLists.h"
#include "source/ConnectionString.h"
#include "source/SourceCriteria.h"
#include "testutil/AccountingFixture.h"
#include "testutil/CaseTable.h"
#include "testutil/TestFiles.h"

#include <QDir>
#include <QSettings>
#include <QSqlRecord>
#include <QTemporaryDir>

using namespace zorbin;
using namespace zorbin::test;
using namespace Qt::Literals::StringLiterals;

namespace {

// Statements on the sample files (" / " between statements and between rows, "|" between
// values); "%1" stands for the file's path. company.db is the Jet file under another name.
const struct Sample
{
    const char *name, *file, *sql, *rows;
} Samples[] = {
    {"Jet file under another name", "company.db", "SELECT count(*) FROM Shippers", "3"},
    {"Jet numbers and texts", "nwind.mdb",
     "SELECT ProductID, typeof(ProductID), ProductName, typeof(ProductName), UnitPrice, typeof(UnitPrice), "
     "Discontinued FROM Products ORDER BY ProductID LIMIT 1",
     "1|integer|Chai|text|18|real|0"},
    {"Jet, every row", "nwind.mdb", "SELECT count(*), sum(Discontinued) FROM Products", "77|8"},
    {"Jet Nulls", "nwind.mdb",
     "SELECT EmployeeID, ReportsTo, Region FROM Employees WHERE EmployeeID IN (1, 2, 5) ORDER BY EmployeeID",
     "1|2|WA / 2|<null>|WA / 5|2|<null>"},
    {"Jet long values", "nwind.mdb",
     "SELECT typeof(Photo), length(Photo), length(Notes) FROM Employees WHERE EmployeeID = 1",
     "blob|21626|175"},
    // mdbtools answers only single-table queries; the statements of the catalog join tables.
    {"Jet join", "nwind.mdb",
     "SELECT Categories.CategoryName FROM Products, Categories WHERE Products.CategoryID = Categories.CategoryID "
     "And Products.ProductID = 1",
     "Beverages"},
    {"Jet table name with a blank", "nwind.mdb", "SELECT count(*) FROM [Order Details]", "2155"},
    // Texts compare without regard to letter case, as in the file's own engine.
    {"Jet letter case", "nwind.mdb", "SELECT count(*) FROM Products WHERE ProductName = 'CHAI'", "1"},
    {"Jet, a table it does not have", "nwind.mdb", "SELECT * FROM Accounts",
     "refused: בקובץ \"%1\" אין טבלה בשם \"Accounts\"."},
    {"Access", "ASampleDatabase.accdb",
     "SELECT count(*), max([Asset No]) FROM [Asset Items] / SELECT Cost, typeof(Cost), Warranty, Comments, "
     "substr(Acquired, 1, 10) FROM [Asset Items] WHERE [Asset No] = '30118'",
     "65|30118 / 3425.5|real|0|<null>|1999-10-27"},
};

// Only single SELECT statements are sent: a second statement could change the accounting data.
const struct Statement
{
    const char *name, *sql;
    bool sent;
} Statements[] = {
    {"delete", "DELETE FROM Accounts", false},
    {"a second statement", "SELECT 1; DELETE FROM Accounts", false},
    {"update", "  update Accounts SET x = 1", false},
    {"block comment", "SELECT 1 /* it's */; DELETE FROM Accounts", false},
    {"a closing ;", "SELECT * FROM Accounts;  ", true},
    {"quoted text", "select 'a;b--/*' FROM Accounts", true},
    {"quoted name", "SELECT \"a;b\".* FROM Accounts AS \"a;b\"", true},
    {"bracketed name", "SELECT [a;b].* FROM Accounts AS [a;b]", true},
    {"a line comment", "SELECT * FROM Accounts -- it's;", true},
    // A quote mark in a comment must not hide the ";" after the line break that ends it.
    {"comment to \\n", "SELECT 1 -- it's\n; DELETE FROM Accounts", false},
    {"comment to \\r", "SELECT 1 -- it's\r; DELETE FROM Accounts", false},
    {"comment to \\v", "SELECT 1 -- it's\v; DELETE FROM Accounts", false},
    {"comment to \\f", "SELECT 1 -- it's\f; DELETE FROM Accounts", false},
    {"comment to U+0085", "SELECT 1 -- it's\u0085; DELETE FROM Accounts", false},
    {"comment to U+2028", "SELECT 1 -- it's\u2028; DELETE FROM Accounts", false},
    {"comment to U+2029", "SELECT 1 -- it's\u2029; DELETE FROM Accounts", false},
};

// The rows of the names tables (statements separated by "; "), and the entries of the note lists
// and of the price lists after a filling ("earlier=99": the entry they held before).
const struct Names
{
    const char *name, *rows, *notes, *priceLists;
} NamesTables[] = {
    {"empty tables: the lists stay", "", "earlier=99", "earlier=99"},
    {"one price list", "INSERT INTO PriceListNames (PriceListID, PriceListName) VALUES (7, 'X')",
     "earlier=99", "מחיר מכירה=0 X=7"},
    {"only blank names",
     "INSERT INTO PriceListNames (PriceListID, PriceListName) VALUES (1, ' '), (2, NULL); INSERT INTO "
     "ExtraNoteNames VALUES (1, '', 1), (2, NULL, 1)",
     "", "מחיר מכירה=0"},
    {"only note kinds of other owners", "INSERT INTO ExtraNoteNames VALUES (1, 'a', 0), (2, 'b', 2)",
     "earlier=99", "earlier=99"},
    {"names trimmed, numbers as texts and fractions, ascending",
     "INSERT INTO ExtraNoteNames VALUES ('12', ' twelve ', 1), (2.5, 'two and a half', 1)",
     "two and a half=2 twelve=12", "earlier=99"},
    // SQLite orders texts after numbers: the filling stops at "x", after "a" and "c".
    {"a number that does not convert",
     "INSERT INTO ExtraNoteNames VALUES (1, 'a', 1), ('x', 'b', 1), (3, 'c', 1)", "a=1 c=3", "earlier=99"},
    {"a number beyond 32 bits", "INSERT INTO ExtraNoteNames VALUES (1, 'a', 1), (2147483648, 'b', 1)", "a=1",
     "earlier=99"},
    // A names table without the name column: the rows are there, the names are not.
    {"no name column",
     "DROP TABLE PriceListNames; CREATE TABLE PriceListNames (PriceListID INTEGER, Name TEXT); INSERT INTO "
     "PriceListNames VALUES (1, 'a')",
     "earlier=99", "מחיר מכירה=0"},
    {"no database", nullptr, "earlier=99", "earlier=99"},
};

QString jetFile(const QString &name)
{
    return QStringLiteral(ZORBIN_SOURCE_DIR "/tests/data/jet/") + name;
}

// The rows of a statement as Samples writes them; "refused: " and why, when it does not run.
QString rowsOf(SourceConnection &source, const QString &sql)
{
    auto query = source.select(sql);
    QStringList rows;
    while (query && query->next()) {
        QStringList row;
        for (int i = 0; i < query->record().count(); ++i)
            row << (query->value(i).isNull() ? u"<null>"_s : query->value(i).toString());
        rows << row.join(u'|');
    }
    return query ? rows.join(u" / "_s) : u"refused: "_s + query.status().description();
}

std::unique_ptr<SourceConnection> open(const QString &connection)
{
    auto opened = SourceConnection::open(connection);
    if (!opened)
        qWarning("%s", qPrintable(opened.status().description()));
    return opened ? std::move(opened).value() : nullptr;
}

QString entriesOf(const ChoiceList &list)
{
    QStringList entries;
    for (const auto &entry : list.entries())
        entries << entry.text + u'=' + QString::number(entry.itemData);
    return entries.join(u' ');
}

} // namespace

Q_DECLARE_METATYPE(ConnectionParams)

// The accounting database reached each way a user reaches one, one way per test group (main.cpp):
// database files (the demo, the sample Jet and Access files through mdbtools, a table at a time);
// the SQLite ODBC driver registered under the name "SQL Server" (types 1 and 2: the file name
// stands in the place of the database); and a PostgreSQL server that the fixture
// (postgres-fixture.sh) started on 127.0.0.1, through the PostgreSQL ODBC driver under that name.
// The strings carry no port: libpq takes it from PGPORT, as a DSN would give it.
class SourceConnectionTest : public QObject
{
    Q_OBJECT

public:
    explicit SourceConnectionTest(QByteArray group) : m_group(std::move(group)) {}

private Q_SLOTS:
    void initTestCase()
    {
        m_demo = m_folder.filePath(u"accounting.db"_s);
        QVERIFY2(QFile::copy(demoFolder() + u"/demo-accounting.db"_s, m_demo), "is the demo built?");
        QFile::setPermissions(m_demo, QFileDevice::ReadOwner | QFileDevice::WriteOwner);
        QVERIFY(QFile::copy(jetFile(u"nwind.mdb"_s), m_folder.filePath(u"company.db"_s)));
        if (m_group != "postgres")
            return;
        const QString file = QDir(qEnvironmentVariable("ZORBIN_POSTGRES_FIXTURE")).filePath(u"fixture.ini"_s);
        QVERIFY2(QFile::exists(file), qPrintable(file + u": the server did not start"_s));
        QSettings fixture(file, QSettings::IniFormat);
        fixture.beginGroup(u"server"_s);
        for (const QString &key : fixture.childKeys())
            m_server[key] = fixture.value(key).toString();
        QVERIFY(m_server.value(u"trickyPassword"_s).contains(u'}'));
        qputenv("PGPORT", m_server.value(u"port"_s).toLatin1());
    }

    // The connection dialog's test succeeds, the five lists fill, and the item query of a catalog
    // run (no range settings) reads the demo's items with Hebrew texts and Nulls intact.
    void readsTheDemo_data()
    {
        QTest::addColumn<ConnectionParams>("params");
        if (m_group == "main") {
            QTest::newRow("database file") << fileConnection(m_demo);
        } else if (m_group == "sqlite-odbc") {
            QTest::newRow("ODBC") << server(ConnectionKind::Odbc, u"sa"_s, {});
            QTest::newRow("OLE DB") << server(ConnectionKind::OleDb, u"sa"_s, u"pw"_s);
            QTest::newRow("OLE DB, integrated security") << server(ConnectionKind::OleDb, {}, {});
        } else {
            QTest::newRow("ODBC") << server(ConnectionKind::Odbc, m_server[u"user"_s],
                                            m_server[u"password"_s]);
            // A password with ";" and braces reaches the server whole.
            QTest::newRow("a password that needs braces")
                << server(ConnectionKind::Odbc, m_server[u"trickyUser"_s], m_server[u"trickyPassword"_s]);
        }
    }
    void readsTheDemo()
    {
        QFETCH(ConnectionParams, params);
        LogonForm form;
        form.Form_Load(params);
        QVERIFY(form.CmdCheck_Click());
        QCOMPARE(form.LblMsg, LogonForm::TestSucceededText);
        CatalogSettings settings;
        FillCmbExtraNote(params, settings);
        FillCmbPriceField(params, settings);
        for (const ChoiceList *list : {&settings.pictureNote, &settings.extraNote1, &settings.extraNote2})
            QCOMPARE(entriesOf(*list), u"צבע=1 חומר=2 תמונה נוספת=3 ארץ ייצור=7"_s);
        for (const ChoiceList *list : {&settings.priceList1, &settings.priceList2})
            QCOMPARE(entriesOf(*list),
                     u"מחיר מכירה=0 מחירון סיטונאי=1 מחירון קמעונאי=2 Export prices=3 מבצע חורף=6"_s);
        auto source = open(BuildConnString(params));
        QVERIFY(source);
        // The generated items, the second row of A0008 and Z9999; not "#", "*" or the Null key.
        const QString selected =
            u" FROM Items WHERE Not (ItemKey Is Null)"_s + BuildSourceDBCriteria(settings).value();
        QCOMPARE(rowsOf(*source, u"SELECT count(*)"_s + selected), u"302"_s);
        QCOMPARE(
            rowsOf(*source,
                   u"SELECT ItemKey, ItemName, SalesUnit, Price"_s + selected +
                       u" And ItemKey IN ('B0041', 'C0002', 'F0053', '#', '*', '') ORDER BY ItemKey"_s),
            u"B0041|שולחן זכוכית 51|ק\"ג|<null> / C0002|מנורה עץ אלון 12|מטר|84.4 / F0053|<null>|זוג|971.15"_s);
    }

    // A connection that fails says why in the driver's words, and how to register a driver only
    // when the one it names is not registered.
    void failsWithTheDriversOwnText_data()
    {
        QTest::addColumn<QByteArray>("content"); // of the file company.mdb; empty: no such file
        QTest::addColumn<QString>("connection"); // null: to company.mdb
        QTest::addColumn<QString>("expected");   // "%1": the file's path
        const auto row = [](const char *name, const QByteArray &content, const QString &connection,
                            const QString &expected) {
            QTest::newRow(name) << content << connection << expected;
        };
        if (m_group == "main") {
            const QString unknown = u"\"%1\" אינו בסיס נתונים מוכר"_s;
            row("no file", {}, {}, u"\"%1\" לא נמצא"_s);
            row("a text file", "ItemKey;Name\nA1;chair\n", {}, unknown);
            row("a short file", "ab", {}, unknown);
            row("a broken Jet file", QByteArray("\0\1\0\0Standard Jet DB\0", 20) + QByteArray(2048, 'x'), {},
                u"ההתחברות לבסיס הנתונים נכשלה."_s);
            row("no connection type", {}, u""_s, u"סוג בסיס הנתונים"_s);
            row("another provider", {}, u"Provider=Other.1;Data Source=x"_s, u"\"Other.1\""_s);
            row("a driver that is not registered", {},
                u"driver={Zorbin No Such Driver};server=127.0.0.1;uid=sa;pwd=;database=x"_s, u"[unixODBC]"_s);
            row("a registered driver", {}, u"driver={SQLite3};database=/nonexistent/folder/x.db"_s, {});
        } else if (m_group == "sqlite-odbc") {
            ConnectionParams noFolder = server(ConnectionKind::Odbc, u"sa"_s, {});
            noFolder.database = m_folder.filePath(u"no-such-folder/accounting.db"_s);
            row("a file the driver cannot open", {}, BuildConnString(noFolder), {});
            // This group's registry has no mdbtools driver for the Jet file.
            row("a Jet file without its driver", {}, BuildConnString(fileConnection(jetFile(u"nwind.mdb"_s))),
                u"[unixODBC][Driver Manager]Can't open lib 'MDBTools'"_s);
        } else {
            const QString wrong =
                BuildConnString(server(ConnectionKind::Odbc, m_server[u"user"_s], u"wrong"_s));
            row("a wrong password", {}, wrong, u"password authentication failed"_s);
            row("a stopped server", {}, wrong, m_server[u"closedPort"_s]); // where the server is looked for
        }
    }
    void failsWithTheDriversOwnText()
    {
        QFETCH(QByteArray, content);
        QFETCH(QString, connection);
        QFETCH(QString, expected);
        const QString path = m_folder.filePath(u"company.mdb"_s);
        QFile::remove(path);
        if (!content.isEmpty())
            writeFile(path, content);
        const bool stopped = qstrcmp(QTest::currentDataTag(), "a stopped server") == 0;
        if (stopped)
            qputenv("PGPORT", expected.toLatin1());
        const auto opened =
            SourceConnection::open(connection.isNull() ? BuildConnString(fileConnection(path)) : connection);
        if (stopped)
            qputenv("PGPORT", m_server.value(u"port"_s).toLatin1());
        QVERIFY(!opened);
        const QString text = opened.status().description();
        QVERIFY2(!text.isEmpty() && text.contains(QString(expected).replace(u"%1"_s, path)),
                 qPrintable(text));
        // Where the driver manager cannot find the driver, the fault says how to register it.
        QCOMPARE(text.contains(u"odbcinst.ini"_s), expected.startsWith(u"[unixODBC]"_s));
    }

    void readsTheSampleFiles_data() { addCaseRows(Samples); }
    void readsTheSampleFiles()
    {
        if (m_group != "main")
            QSKIP("The sample files are read in the main group.");
        const Sample &c = fetchCase(Samples);
        const QString file = QString::fromUtf8(c.file);
        const QString path = file == "company.db"_L1 ? m_folder.filePath(file) : jetFile(file);
        auto source = open(BuildConnString(fileConnection(path)));
        QVERIFY(source);
        QStringList read;
        for (const QString &statement : QString::fromUtf8(c.sql).split(u" / "_s))
            read << rowsOf(*source, statement);
        QCOMPARE(read.join(u" / "_s), QString::fromUtf8(c.rows).replace(u"%1"_s, path));
    }

    void sendsOnlyOneSelect_data() { addCaseRows(Statements); }
    void sendsOnlyOneSelect()
    {
        const Statement &c = fetchCase(Statements);
        auto source = open(BuildConnString(fileConnection(m_demo)));
        QVERIFY(source);
        const QString rows = rowsOf(*source, QString::fromUtf8(c.sql));
        QCOMPARE(rows.startsWith(u"refused: "_s), !c.sent);
        QCOMPARE(rows.contains(u"רק שאילתת SELECT אחת"_s), !c.sent);
    }

    // A database file is opened read-only: even past the guard it takes no change.
    void neverWritesTheFile()
    {
        const QString copy = m_folder.filePath(u"copy.db"_s);
        QVERIFY(QFile::copy(m_demo, copy));
        const QByteArray before = readFile(copy);
        {
            auto source = open(BuildConnString(fileConnection(copy)));
            QVERIFY(source && !QSqlQuery(source->database()).exec(u"DELETE FROM Accounts"_s));
        }
        QCOMPARE(readFile(copy), before);
    }

    // The note kinds and price lists follow the names tables. A failure is silent and ends the
    // filling at once.
    void followsTheRowsOfTheNamesTables_data() { addCaseRows(NamesTables); }
    void followsTheRowsOfTheNamesTables()
    {
        const Names &c = fetchCase(NamesTables);
        QTemporaryDir folder;
        const QString path = folder.filePath(u"accounting.db"_s);
        if (c.rows)
            QVERIFY(makeAccountingFile(path, QString::fromUtf8(c.rows).split(u"; "_s)));
        CatalogSettings settings;
        for (ChoiceList *list : settings.sourceLists()) {
            list->addEntry(u"earlier"_s, 99);
            list->setCurrentIndex(0);
        }
        FillCmbExtraNote(fileConnection(path), settings);
        FillCmbPriceField(fileConnection(path), settings);
        for (const ChoiceList *list : {&settings.pictureNote, &settings.extraNote1, &settings.extraNote2})
            QCOMPARE(entriesOf(*list), QString::fromUtf8(c.notes));
        for (const ChoiceList *list : {&settings.priceList1, &settings.priceList2}) {
            QCOMPARE(entriesOf(*list), QString::fromUtf8(c.priceLists));
            QCOMPARE(list->currentIndex(), QByteArray(c.priceLists) == "earlier=99" ? 0 : -1);
        }
    }

private:
    ConnectionParams server(ConnectionKind type, const QString &user, const QString &password) const
    {
        const QString database = m_group == "postgres" ? m_server.value(u"database"_s) : m_demo;
        return {u"127.0.0.1"_s, user, password, database, type};
    }

    QByteArray m_group;
    QTemporaryDir m_folder;
    QString m_demo;
    QMap<QString, QString> m_server; // the PostgreSQL fixture's port, logins and passwords
};

int runSourceConnectionTest(const QByteArray &group, int argc, char *argv[])
{
    SourceConnectionTest test(group);
    return QTest::qExec(&test, argc, argv) != 0 ? 1 : 0;
}

#include "SourceConnectionTest.moc"
