#include "testutil/TestMain.h"
#include "workdb/SqliteEngine.h"

#include <QCoreApplication>

ZORBIN_DECLARE_TEST(WorkDatabaseTest)
ZORBIN_DECLARE_TEST(CollectionTest)

int main(int argc, char *argv[])
{
    zorbin::setUpSqliteEngine(); // as the programs do
    QCoreApplication app(argc, argv);
    return runWorkDatabaseTest(argc, argv) + runCollectionTest(argc, argv);
}
