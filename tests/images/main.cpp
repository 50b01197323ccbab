#include "testutil/TestMain.h"

#include <QCoreApplication>

ZORBIN_DECLARE_TEST(ImageHeaderTest)
ZORBIN_DECLARE_TEST(ImageSizeTest)
ZORBIN_DECLARE_TEST(ImageCollectionTest)

ZORBIN_TEST_MAIN_BEGIN(QCoreApplication)
ZORBIN_TEST_ADD(ImageHeaderTest)
ZORBIN_TEST_ADD(ImageSizeTest)
ZORBIN_TEST_ADD(ImageCollectionTest)
ZORBIN_TEST_MAIN_END
