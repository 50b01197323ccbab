#include "testutil/TestMain.h"

#include <QCoreApplication>

ZORBIN_DECLARE_TEST(ThumbnailTest)
ZORBIN_DECLARE_TEST(SiteRunTest)

ZORBIN_TEST_MAIN_BEGIN(QCoreApplication)
ZORBIN_TEST_ADD(ThumbnailTest)
ZORBIN_TEST_ADD(SiteRunTest)
ZORBIN_TEST_MAIN_END
