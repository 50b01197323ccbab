#include "testutil/TestMain.h"

#include <QCoreApplication>

ZORBIN_DECLARE_TEST(OptionsTest)
ZORBIN_DECLARE_TEST(ProgressMeterTest)

ZORBIN_TEST_MAIN_BEGIN(QCoreApplication)
ZORBIN_TEST_ADD(OptionsTest)
ZORBIN_TEST_ADD(ProgressMeterTest)
ZORBIN_TEST_MAIN_END
