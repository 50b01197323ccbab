#include "platform/Paths.h"
#include "platform/SettingsStore.h"
#include "source/ConnectionStore.h"
#include "source/ConnectionString.h"
#include "testutil/CaseTable.h"
#include "testutil/EdgeOfMemory.h"
#include "testutil/MemorySettingsStore.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"

#include <QFileInfo>
#include <QSettings>
#include <QTemporaryDir>

using namespace zorbin;
using namespace zorbin::test;
using namespace Qt::Literals::StringLiterals;

namespace {

// The strings of each connection type (a file path written with "/" for the platform's separator).
const struct Built
{
    const char *name, *server, *user, *password, *database;
    int type;
    const char *expected;
} Builds[] = {
    {"ODBC", "s", "u", "p", "d", 1, "driver={SQL Server};server=s;uid=u;pwd=p;database=d"},
    {"ODBC ;", "s", "u", "a;b", "d", 1, "driver={SQL Server};server=s;uid=u;pwd={a;b};database=d"},
    {"ODBC }", "s", "u", "x}y", "d", 1, "driver={SQL Server};server=s;uid=u;pwd={x}}y};database=d"},
    {"ODBC {", "s", "{u", "p", "d", 1, "driver={SQL Server};server=s;uid={{u};pwd=p;database=d"},
    {"ODBC quotes stay", "s", "u", "a\"b'c", "d", 1,
     "driver={SQL Server};server=s;uid=u;pwd=a\"b'c;database=d"},
    {"OLE DB, integrated security", "s", "", "p", "d", 2,
     "Provider=sqloledb;Data Source=s;Integrated Security=SSPI;Persist Security Info=False;Initial Catalog=d"},
    {"OLE DB, a user of one blank", "s", " ", "p", "d", 2,
     "Provider=sqloledb;Data Source=s;User Id= ;Password=p;Initial Catalog=d"},
    {"OLE DB ;", "s", "u;v", "a;b", "d", 2,
     "Provider=sqloledb;Data Source=s;User Id=\"u;v\";Password=\"a;b\";Initial Catalog=d"},
    {"OLE DB \" '", "s", "it's", "a\"b", "d", 2,
     "Provider=sqloledb;Data Source=s;User Id=\"it's\";Password=\"a\"\"b\";Initial Catalog=d"},
    {"OLE DB brace stays", "s", "u", "{x}", "d", 2,
     "Provider=sqloledb;Data Source=s;User Id=u;Password={x};Initial Catalog=d"},
    // A shop may pass a driver attribute with the server or the database on purpose.
    {"ODBC, server and database as stored", "h;Port=1433", "u", "p;w", "d;TDS_Version=7.4", 1,
     "driver={SQL Server};server=h;Port=1433;uid=u;pwd={p;w};database=d;TDS_Version=7.4"},
    {"OLE DB, server and database as stored", "h;Port=1433", "u", "p", "d;TDS_Version=7.4", 2,
     "Provider=sqloledb;Data Source=h;Port=1433;User Id=u;Password=p;Initial Catalog=d;TDS_Version=7.4"},
    {"file", "data", "u", "p", "a.mdb", 3, "Provider=Microsoft.Jet.OLEDB.4.0;Data Source=data/a.mdb"},
    {"file, folder with separator", "data/", "", "", "a.mdb", 3,
     "Provider=Microsoft.Jet.OLEDB.4.0;Data Source=data/a.mdb"},
    {"file, no folder", "", "", "", "a.mdb", 3, "Provider=Microsoft.Jet.OLEDB.4.0;Data Source=a.mdb"},
    {"no type", "s", "u", "p", "d", 0, ""},
};

// A value read back from a connection string.
const struct Read
{
    const char *name, *text, *key, *value;
} Reads[] = {
    {"braced", "uid=u;pwd={a;b};database=d", "pwd", "a;b"},
    {"doubled closing mark", "pwd={x}}y};database=d", "pwd", "x}y"},
    {"braced at the very end", "uid=u;pwd={ab}", "pwd", "ab"},
    {"doubled closing mark at the very end", "uid=u;pwd={x}}}", "pwd", "x}"},
    {"unclosed brace", "uid=u;pwd={ab", "pwd", "ab"},
    {"after the closing mark", "pwd={a}junk;database=d", "database", "d"},
    {"ODBC keeps blanks", "uid= sa ;pwd=x", "uid", " sa "},
    {"any letter case", "PWD=x", "pwd", "x"},
    {"a part without =", "junk;pwd=x", "pwd", "x"},
    {"empty at the end", "uid=u;pwd=", "pwd", ""},
    {"missing", "uid=u", "pwd", ""},
    {"OLE DB double quotes", "Provider=sqloledb;Password=\"a\"\"b;c\";User Id=u", "Password", "a\"b;c"},
    {"OLE DB single quotes", "Provider=sqloledb;Password='it''s'", "Password", "it's"},
    {"OLE DB blanks before the quote", "Provider=sqloledb;Password=  \"x;y\"", "Password", "x;y"},
    {"OLE DB trims a bare value", "Provider=sqloledb;User Id= sa ;Password=p", "User Id", "sa"},
    {"OLE DB blanks at the very end", "Provider=sqloledb;Password=  ", "Password", ""},
    {"OLE DB braces are text", "Provider=sqloledb;Password={a};x=y", "Password", "{a}"},
};

// Passwords as printed.
const struct Masked
{
    const char *name, *text, *masked;
} Masks[] = {
    {"ODBC", "server=s;pwd=secret;database=d", "server=s;pwd=****;database=d"},
    {"ODBC braced, at the end", "server=s;uid=u;pwd={a;b}}c}", "server=s;uid=u;pwd=****"},
    {"ODBC empty", "server=s;pwd=;database=d", "server=s;pwd=;database=d"},
    {"OLE DB", "Provider=sqloledb;User Id=u;Password=\"x;y\";Initial Catalog=d",
     "Provider=sqloledb;User Id=u;Password=****;Initial Catalog=d"},
};

// The type is stored as the list index of the connection dialog; a stored text that is not a
// type leaves the type as it was (9 here).
const struct StoredType
{
    const char *name, *stored;
    int type;
} StoredTypes[] = {
    {"file", "2", 3},
    {"none chosen", "-1", 0},
    {"half rounds to even, up", "0.5", 2},
    {"half rounds to even, down", "1.5", 2},
    {"blanks around", " 1 ", 2},
    {"not a number", "ODBC", 9},
    {"largest", "32766", 32767},
    {"beyond 16 bits", "32767", 9},
    {"smallest", "-32769", -32768},
    {"half below the smallest", "-32769.5", -32768},
    {"below 16 bits", "-32770", 9},
};

QString text(const char *utf8)
{
    return QString::fromUtf8(utf8); // a null pointer gives the null text
}

} // namespace

// The stored connection: its strings, built from what the user typed and read back by the
// connection, the printed masks and the OLE DB conversion; its stored type; the settings file that
// holds its password. The texts parsed here touch unreadable memory at both ends, so that a read
// past an end fails the test.
class ConnectionSettingsTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void buildsTheStringOfEachType_data() { addCaseRows(Builds); }
    void buildsTheStringOfEachType()
    {
        const Built &c = fetchCase(Builds);
        const auto native = [&c](const char *path) {
            return c.type == 3 ? text(path).replace(u'/', pathSeparator()) : text(path);
        };
        QCOMPARE(BuildConnString(native(c.server), text(c.user), text(c.password), text(c.database),
                                 ConnectionKind(c.type)),
                 native(c.expected));
    }

    void readsAValue_data() { addCaseRows(Reads); }
    void readsAValue()
    {
        const Read &c = fetchCase(Reads);
        for (const QString &guarded : atEdgesOfMemory(text(c.text)))
            QCOMPARE(connStringValue(guarded, text(c.key)), text(c.value));
    }

    void masksThePasswordForPrinting_data() { addCaseRows(Masks); }
    void masksThePasswordForPrinting()
    {
        const Masked &c = fetchCase(Masks);
        for (const QString &guarded : atEdgesOfMemory(text(c.text)))
            QCOMPARE(maskConnStringPassword(guarded), text(c.masked));
    }

    void oleDbBecomesOdbc_data()
    {
        QTest::addColumn<QString>("security");
        QTest::addColumn<QString>("login");
        for (const char *login : {"", "false"})
            QTest::newRow(login) << text(login) << u"uid=sa;pwd=p"_s;
        for (const char *integrated : {"SSPI", "True", "yes"})
            QTest::newRow(integrated) << text(integrated) << u"Trusted_Connection=yes"_s;
    }
    void oleDbBecomesOdbc()
    {
        QFETCH(QString, security);
        QFETCH(QString, login);
        const QString oleDb =
            u"Provider=sqloledb;Data Source=srv;Integrated Security=%1;User Id=sa;Password=p;"
            "Initial Catalog=db"_s.arg(security);
        QCOMPARE(odbcConnStringForOleDb(oleDb),
                 u"driver={SQL Server};server=srv;%1;database=db"_s.arg(login));
    }

    void loadsTheStoredType_data() { addCaseRows(StoredTypes); }
    void loadsTheStoredType()
    {
        const StoredType &c = fetchCase(StoredTypes);
        MemorySettingsStore store;
        store.set(ConnTypeKey, text(c.stored));
        ConnectionParams params;
        params.kind = static_cast<ConnectionKind>(9);
        GetRegConnParams(store, params);
        QCOMPARE(int(params.kind), c.type);
    }

    // The settings hold the connection password in plain text (earlier versions read it so), so a
    // settings file that is written is its owner's only; one that is only read (the demo's installed
    // settings, a file given to zorbin-cli) keeps its permissions.
    void aWrittenFileIsTheOwnersOnly_data()
    {
        QTest::addColumn<QString>("file"); // empty: the user's own settings, made anew
        QTest::addColumn<bool>("written");
        QTest::newRow("the user's new settings") << QString() << true;
        QTest::newRow("a file others could read, written") << u"settings.ini"_s << true;
        QTest::newRow("a file others can read, only read") << u"settings.ini"_s << false;
    }
    void aWrittenFileIsTheOwnersOnly()
    {
#ifdef Q_OS_WIN
        QSKIP("The registry keeps the settings on Windows.");
#endif
        QFETCH(QString, file);
        QFETCH(bool, written);
        QTemporaryDir folder;
        // ctest points XDG_CONFIG_HOME into the build tree, so that no real settings are touched.
        QVERIFY2(qEnvironmentVariableIsSet("XDG_CONFIG_HOME"), "run through ctest");
        const QString path = file.isEmpty() ? QSettings(QSettings::NativeFormat, QSettings::UserScope,
                                                        u"Zorbin"_s, u"Zorbin"_s)
                                                  .fileName()
                                            : folder.filePath(file);
        const auto readable = QFileDevice::ReadOwner | QFileDevice::WriteOwner | QFileDevice::ReadGroup |
                              QFileDevice::ReadOther;
        QFile::remove(path);
        if (!file.isEmpty()) {
            writeFile(path, "[Params]\nConnPWD=old\n");
            QVERIFY(QFile::setPermissions(path, readable));
        }
        {
            auto store = file.isEmpty() ? openUserSettingsStore() : openIniSettingsStore(path);
            QCOMPARE(store->read(u"Zorbin"_s, u"Params"_s, u"ConnPWD"_s, {}),
                     file.isEmpty() ? QString() : u"old"_s);
            if (written)
                store->write(u"Zorbin"_s, u"Params"_s, u"ConnPWD"_s, u"secret"_s);
            store->flush();
        }
        const auto everyone = QFileDevice::Permissions::fromInt(0x7077); // owner, group, others
        QCOMPARE(QFileInfo(path).permissions() & everyone,
                 written ? QFileDevice::ReadOwner | QFileDevice::WriteOwner : readable);
    }
};

ZORBIN_TEST_CLASS(ConnectionSettingsTest)
#include "ConnectionSettingsTest.moc"
