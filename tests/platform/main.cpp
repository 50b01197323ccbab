#include "testutil/TestMain.h"

#include <QCoreApplication>

ZORBIN_DECLARE_TEST(EncodingTest)
ZORBIN_DECLARE_TEST(ValueFormatTest)

ZORBIN_TEST_MAIN_BEGIN(QCoreApplication)
ZORBIN_TEST_ADD(EncodingTest)
ZORBIN_TEST_ADD(ValueFormatTest)
ZORBIN_TEST_MAIN_END
