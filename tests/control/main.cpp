#include "testutil/TestMain.h"

#include <QCoreApplication>

ZORBIN_DECLARE_TEST(NumbersTest)
ZORBIN_DECLARE_TEST(CatalogControlTest)

ZORBIN_TEST_MAIN_BEGIN(QCoreApplication)
ZORBIN_TEST_ADD(NumbersTest)
ZORBIN_TEST_ADD(CatalogControlTest)
ZORBIN_TEST_MAIN_END
