#include "testutil/TestMain.h"

#include <QCoreApplication>

ZORBIN_DECLARE_TEST(FileNamingTest)
ZORBIN_DECLARE_TEST(GoldenCatalogTest)
ZORBIN_DECLARE_TEST(PagesRunTest)
ZORBIN_DECLARE_TEST(StylesheetTest)

ZORBIN_TEST_MAIN_BEGIN(QCoreApplication)
ZORBIN_TEST_ADD(FileNamingTest)
ZORBIN_TEST_ADD(GoldenCatalogTest)
ZORBIN_TEST_ADD(PagesRunTest)
ZORBIN_TEST_ADD(StylesheetTest)
ZORBIN_TEST_MAIN_END
