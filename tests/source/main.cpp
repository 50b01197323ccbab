// The tests of the accounting-database access, in three groups that differ in the ODBC drivers
// they need registered (ctest runs each with its own ODBCSYSINI):
//   source-tests [QtTest options]               files, criteria, lists, the dialog, the settings file
//   source-tests sqlite-odbc [QtTest options]    "SQL Server" is the SQLite ODBC driver
//   source-tests postgres [QtTest options]       "SQL Server" is the PostgreSQL ODBC driver
#include "testutil/TestMain.h"

#include <QApplication>
#include <QByteArray>
#include <cstring>

ZORBIN_DECLARE_TEST(ConnectionStringTest)
ZORBIN_DECLARE_TEST(CriteriaTest)
ZORBIN_DECLARE_TEST(FileSourceTest)
ZORBIN_DECLARE_TEST(ChoiceListsTest)
ZORBIN_DECLARE_TEST(LogonDialogTest)
ZORBIN_DECLARE_TEST(SettingsFileTest)
ZORBIN_DECLARE_TEST(SqliteOdbcTest)
ZORBIN_DECLARE_TEST(PostgresTest)

int main(int argc, char *argv[])
{
    QApplication app(argc, argv);
    QByteArray group = "main";
    if (argc > 1 && argv[1][0] != '-') {
        group = argv[1];
        // The group is ours; QtTest sees the rest.
        std::memmove(argv + 1, argv + 2, sizeof(char *) * std::size_t(argc - 1));
        --argc;
    }
    std::vector<std::unique_ptr<QObject>> tests;
    if (group == "main") {
        tests.push_back(makeConnectionStringTest());
        tests.push_back(makeCriteriaTest());
        tests.push_back(makeFileSourceTest());
        tests.push_back(makeChoiceListsTest());
        tests.push_back(makeLogonDialogTest());
        tests.push_back(makeSettingsFileTest());
    } else if (group == "sqlite-odbc") {
        tests.push_back(makeSqliteOdbcTest());
    } else if (group == "postgres") {
        tests.push_back(makePostgresTest());
    } else {
        qCritical("unknown test group %s", group.constData());
        return 2;
    }
    return zorbin::test::runTestObjects(argc, argv, tests);
}
