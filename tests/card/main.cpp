#include "testutil/TestMain.h"

#include <QApplication>

ZORBIN_DECLARE_TEST(MainCardTest)
ZORBIN_DECLARE_TEST(CellLineEditorTest)
ZORBIN_DECLARE_TEST(DemoCardTest)

ZORBIN_TEST_MAIN_BEGIN(QApplication)
ZORBIN_TEST_ADD(MainCardTest)
ZORBIN_TEST_ADD(CellLineEditorTest)
ZORBIN_TEST_ADD(DemoCardTest)
ZORBIN_TEST_MAIN_END
