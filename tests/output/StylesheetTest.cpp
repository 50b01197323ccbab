// The stylesheet beside its golden files: format bytes the editor does not offer, when it
// keeps a file, and what it refuses.
#include "output/Stylesheet.h"

#include "testutil/FaultyFileSystem.h"
#include "testutil/OutputContext.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"

#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;

class StylesheetTest : public QObject
{
    Q_OBJECT

private:
    QTemporaryDir m_dir;

    QString path() const { return m_dir.filePath(u"tarnik.css"_qs); }

private Q_SLOTS:
    void unknownFormatBytesWriteTheFirstWord()
    {
        test::OutputContext output;
        CellLine &line = output.settings.lines[8];
        line.field = 1;
        line.format = {3, 255, 3, 2, 3, 3}; // font, size, weight, underline, italic, align
        QVERIFY(CreateCSS(output.context, m_dir.path(), true).isOk());
        QVERIFY(test::readFile(path()).contains(
            ".L8 {font-family:Arial (Hebrew); font-weight:Normal; font-size:255pt; text-align:Right; "
            "color:black;}\r\n"));
    }

    // Without replace an existing file is kept; a grid that cannot be made fails before writing.
    void keepsTheFileUnlessToldToReplaceIt()
    {
        test::writeFile(path(), "old");
        test::OutputContext output;
        QVERIFY(CreateCSS(output.context, m_dir.path() + QLatin1Char('/'), false).isOk());
        output.settings.rows.reset();
        const Status written = CreateCSS(output.context, m_dir.path(), true);
        QVERIFY(!written.isOk());
        QVERIFY(written.description().contains(u"\"שורות\""_qs));
        QCOMPARE(test::readFile(path()), QByteArray("old"));
        output.settings.rows = 2;
        QVERIFY(CreateCSS(output.context, m_dir.path(), true).isOk());
        QVERIFY(test::readFile(path()).startsWith("@charset"));
    }

    void fileInUseFails()
    {
        test::FaultyFileSystem files;
        files.failingPaths << path();
        test::OutputContext output(files);
        const Status written = CreateCSS(output.context, m_dir.path(), true);
        QVERIFY(!written.isOk());
        QVERIFY(written.description().contains(u"tarnik.css"_qs));
    }
};

ZORBIN_TEST_CLASS(StylesheetTest)
#include "StylesheetTest.moc"
