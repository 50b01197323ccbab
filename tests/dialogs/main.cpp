#include "testutil/TestMain.h"

#include <QApplication>

ZORBIN_DECLARE_TEST(CellLineEditorTest)
ZORBIN_DECLARE_TEST(SelectItemDialogTest)

ZORBIN_TEST_MAIN_BEGIN(QApplication)
ZORBIN_TEST_ADD(CellLineEditorTest)
ZORBIN_TEST_ADD(SelectItemDialogTest)
ZORBIN_TEST_MAIN_END
