#pragma once

#include "model/CatalogSettings.h"
#include "model/ConnectionParams.h"
#include "model/RunContext.h"
#include "model/RunState.h"
#include "platform/FileSystem.h"
#include "testutil/RecordingUserPort.h"

#include <QList>
#include <QString>
#include <QStringList>

namespace zorbin::test {

// One cell line of a test catalog; the format bytes as the page tab's table holds them.
struct TestLine
{
    int field = 0;
    QString caption;
    int font = 0; // 0 Arial, 1 David, 2 Miriam
    int size = 9;
    int weight = 0;
    int align = 0; // 0 right, 1 centre, 2 left
};

struct TestCatalog
{
    int rows = 3;
    int columns = 2;
    bool frames = true;
    int topPercent = 10;
    int bottomPercent = 8;
    QString topTitle = QStringLiteral("קטלוג <b>בדיקה</b>");
    QString bottomTitle = QStringLiteral("טלפון: 03-1234567");
    QList<TestLine> lines;
};

// What the writer runs with: fresh settings, a recording user port, the local file system.
struct PdfRig
{
    PdfRig() : context{settings, connection, state, user, localFileSystem()} {}
    CatalogSettings settings;
    ConnectionParams connection;
    RunState state;
    RecordingUserPort user;
    RunContext context;
};

// With ZORBIN_KEEP_TEST_FILES set, a test keeps its folder for a look and says where it is.
bool keepTestFiles(const QString &folder);

// The one place the PDF tests write the settings record.
void applyCatalog(const TestCatalog &catalog, CatalogSettings &settings);

struct ToolRun
{
    int exitCode = -1;
    QByteArray out;
    QByteArray err;
};
// Runs a program to its end (two minutes at most).
ToolRun runTool(const QString &program, const QStringList &arguments);

// pdffonts: one row per font.
struct FontRow
{
    QString name;
    bool embedded = false;
};
QList<FontRow> pdfFonts(const QString &pdf);

// pdfimages -list: one row per picture drawn on a page.
struct ImageRow
{
    int page = 0;
    QString type; // "image", "smask", ...
    int width = 0;
    int height = 0;
    int object = 0;
};
QList<ImageRow> pdfImages(const QString &pdf);

// pdfinfo's page count.
int pdfPageCount(const QString &pdf);

// pdftotext -bbox-layout: the words of each page with their boxes, in points from the top left.
struct Word
{
    double xMin = 0, yMin = 0, xMax = 0, yMax = 0;
    QString text;
};
struct PageWords
{
    double width = 0;
    double height = 0;
    QList<Word> words;
};
QList<PageWords> pdfWords(const QString &pdf);

} // namespace zorbin::test
