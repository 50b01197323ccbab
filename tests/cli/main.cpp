#include "testutil/TestMain.h"

#include <QCoreApplication>

ZORBIN_DECLARE_TEST(CommandLineTest)

ZORBIN_TEST_MAIN_BEGIN(QCoreApplication)
ZORBIN_TEST_ADD(CommandLineTest)
ZORBIN_TEST_MAIN_END
