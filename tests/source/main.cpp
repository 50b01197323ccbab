// The tests of the accounting-database access, in three groups that differ in the ODBC drivers
// they need registered (ctest runs each with its own ODBCSYSINI):
//   source-tests [QtTest options]               files, strings, criteria, lists, the settings file
//   source-tests sqlite-odbc [QtTest options]    "SQL Server" is the SQLite ODBC driver
//   source-tests postgres [QtTest options]       "SQL Server" is the PostgreSQL ODBC driver
#include "testutil/TestMain.h"

#include <QApplication>
#include <cstring>

ZORBIN_DECLARE_TEST(ConnectionSettingsTest)
ZORBIN_DECLARE_TEST(CriteriaTest)
int runSourceConnectionTest(const QByteArray &group, int argc, char *argv[]);

int main(int argc, char *argv[])
{
    QApplication app(argc, argv);
    const QByteArray group = argc > 1 && argv[1][0] != '-' ? argv[1] : "main";
    if (group != "main") { // the group is ours; QtTest sees the rest
        std::memmove(argv + 1, argv + 2, sizeof(char *) * std::size_t(argc - 1));
        --argc;
    }
    if (group != "main" && group != "sqlite-odbc" && group != "postgres")
        qFatal("unknown test group %s", group.constData());
    const int failed =
        group == "main" ? runConnectionSettingsTest(argc, argv) + runCriteriaTest(argc, argv) : 0;
    return failed + runSourceConnectionTest(group, argc, argv);
}
