#include "testutil/TestMain.h"

#include <QCoreApplication>

ZORBIN_DECLARE_TEST(WorkDatabaseTest)
ZORBIN_DECLARE_TEST(CollectionTest)

ZORBIN_TEST_MAIN_BEGIN(QCoreApplication)
ZORBIN_TEST_ADD(WorkDatabaseTest)
ZORBIN_TEST_ADD(CollectionTest)
ZORBIN_TEST_MAIN_END
