// The stylesheet's cases beside the golden files: what it refuses and when it keeps a file.
#include "output/Stylesheet.h"

#include "OutputContext.h"
#include "testutil/FaultyFileSystem.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"

#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;

class StylesheetTest : public QObject
{
    Q_OBJECT

private:
    static QByteArray css(test::OutputContext &output, const QTemporaryDir &dir)
    {
        const Status written = CreateCSS(output.context, dir.path(), true);
        if (!written)
            qWarning("%s", qPrintable(written.description()));
        return test::readFile(dir.filePath(QStringLiteral("tarnik.css")));
    }

    static const QByteArray &fixedLines()
    {
        static const QByteArray lines =
            "@charset 'windows-1255';\r\n"
            "/* author: tarnik */\r\n"
            "body {background:white ;margin-top:10; margin-left:10; margin-right:10; vertical-align:top;}\r\n"
            "TABLE {padding: 0; border-spacing: 0; border-collapse: collapse; border: none; direction: rtl}\r\n"
            "TR {vertical-align: middle}\r\n"
            "TD {font-family:Arial; font-weight:Normal; font-size:9pt; color:black;}\r\n"
            ".Top1 {font-family:Arial; font-weight:Normal; font-size:12pt; color:black;}\r\n"
            ".Top2 {font-family:Arial; font-weight:Normal; font-size:11pt; color:black;}\r\n"
            ".Bot1 {font-family:Arial; font-weight:Normal; font-size:11pt; color:black;}\r\n";
        return lines;
    }

private Q_SLOTS:
    void noLinesAndOneCell()
    {
        QTemporaryDir dir;
        test::OutputContext output;
        output.settings.rows = 1;
        output.settings.columns = 1;
        QCOMPARE(css(output, dir),
                 fixedLines() + " .D1 {width:100.0%; height:100.0%; text-align: center}\r\n");
    }

    void lineClassesAndFrame()
    {
        QTemporaryDir dir;
        test::OutputContext output;
        output.settings.rows = 3;
        output.settings.columns = 2;
        output.settings.frameItems = true;
        CellLine &plain = output.settings.lines[2];
        plain.field = 6;
        plain.format = {1, 10, 2, 0, 0, 0};
        CellLine &both = output.settings.lines[4];
        both.field = 0;
        both.format = {2, 12, 1, 1, 1, 2};
        CellLine &unknownWords = output.settings.lines[8];
        unknownWords.field = 1;
        unknownWords.format = {7, 255, 9, 2, 3, 5};
        QCOMPARE(
            css(output, dir),
            fixedLines() +
                ".L2 {font-family:David; font-weight:Bold; font-size:10pt; text-align:Right; color:black;}\r\n"
                ".L4 {font-family:Miriam; font-weight:Bolder; font-size:12pt; text-align:Left; font-style: "
                "Italic\r\n"
                "; text-decoration: underline\r\n"
                "; color:black;}\r\n"
                ".L8 {font-family:Arial (Hebrew); font-weight:Normal; font-size:255pt; text-align:Right; "
                "color:black;}\r\n"
                " .D1 {width:50.0%; height:33.3%; text-align: center; border: thin solid; border-collapse: "
                "collapse}\r\n");
    }

    void keptWithoutReplace()
    {
        QTemporaryDir dir;
        const QString path = dir.filePath(QStringLiteral("tarnik.css"));
        test::writeFile(path, "old");
        test::OutputContext output;
        QVERIFY(CreateCSS(output.context, dir.path() + QLatin1Char('/'), false).isOk());
        QCOMPARE(test::readFile(path), QByteArray("old"));
        QVERIFY(CreateCSS(output.context, dir.path(), true).isOk());
        QVERIFY(test::readFile(path).startsWith("@charset"));
    }

    void badGridFailsBeforeWriting()
    {
        QTemporaryDir dir;
        test::writeFile(dir.filePath(QStringLiteral("tarnik.css")), "old");
        test::OutputContext output;
        output.settings.rows.reset();
        const Status written = CreateCSS(output.context, dir.path(), true);
        QVERIFY(!written.isOk());
        QVERIFY(written.description().contains(QStringLiteral("\"שורות\"")));
        QCOMPARE(test::readFile(dir.filePath(QStringLiteral("tarnik.css"))), QByteArray("old"));
    }

    void fileInUseFails()
    {
        QTemporaryDir dir;
        test::FaultyFileSystem files;
        files.failingPaths << dir.filePath(QStringLiteral("tarnik.css"));
        test::OutputContext output(files);
        const Status written = CreateCSS(output.context, dir.path(), true);
        QVERIFY(!written.isOk());
        QVERIFY(written.description().contains(QStringLiteral("tarnik.css")));
    }
};

ZORBIN_TEST_CLASS(StylesheetTest)
#include "StylesheetTest.moc"
