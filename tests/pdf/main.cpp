#include "testutil/TestMain.h"

#include <QGuiApplication>

ZORBIN_DECLARE_TEST(DemoPdfTest)
ZORBIN_DECLARE_TEST(PdfLayoutTest)
ZORBIN_DECLARE_TEST(PdfPictureTest)

// The writer draws text and pictures: a GUI application, on the offscreen platform.
ZORBIN_TEST_MAIN_BEGIN(QGuiApplication)
ZORBIN_TEST_ADD(DemoPdfTest)
ZORBIN_TEST_ADD(PdfLayoutTest)
ZORBIN_TEST_ADD(PdfPictureTest)
ZORBIN_TEST_MAIN_END
