// The PDF writer read back with poppler's tools: the demo through `zorbin-cli pdf`, and small working
// databases for fonts, the grid, alignment, right-to-left order, pictures, a stop and no items.
#include "pdf/CatalogPdf.h"
#include "testutil/OutputContext.h"
#include "testutil/TestFiles.h"
#include "testutil/WorkDatabaseFixture.h"
#include "workdb/SqliteEngine.h"

#include <QDir>
#include <QImage>
#include <QProcess>
#include <QRegularExpression>
#include <QSet>
#include <QTemporaryDir>
#include <QTest>
#include <QXmlStreamReader>
#include <algorithm>
#include <unicode/ubidi.h>

using namespace zorbin;
using namespace zorbin::test;
using namespace Qt::Literals::StringLiterals;

namespace {

constexpr double Millimetre = 72 / 25.4;
// The grid of the layout catalog, its bands in percent of the printable height; on an A4 page
// with margins of 10 mm, in points: the bands' inner edges and the cells' width.
constexpr int Rows = 3, Columns = 2, TopPercent = 10, BottomPercent = 8, Items = 8;
constexpr double Width = 595, Height = 842, Margin = 10 * Millimetre, Printable = Height - 2 * Margin;
constexpr double Top = Margin + Printable * TopPercent / 100, CellWidth = (Width - 2 * Margin) / Columns;
constexpr double Bottom = Height - Margin - Printable * BottomPercent / 100;

// Runs a program to its end (two minutes at most): its exit code (-1 when it did not end by
// itself) and its standard output; its standard error goes to the test's.
std::pair<int, QByteArray> run(const QString &program, const QStringList &arguments)
{
    QProcess process;
    process.setProcessChannelMode(QProcess::ForwardedErrorChannel);
    process.start(program, arguments);
    const bool ended = process.waitForFinished(120000) && process.exitStatus() == QProcess::NormalExit;
    return {ended ? process.exitCode() : -1, process.readAllStandardOutput()};
}

// The rows of pdffonts' or pdfimages' table after its two heading lines, split at white space.
QList<QStringList> table(const QString &tool, const QStringList &arguments)
{
    QList<QStringList> rows;
    for (const QString &line :
         QString::fromUtf8(run(tool, arguments).second).split(u'\n', Qt::SkipEmptyParts).mid(2))
        rows << line.split(QRegularExpression(u"\\s+"_s), Qt::SkipEmptyParts);
    return rows;
}

// pdfimages -list: the kind of each picture drawn ("smask": a transparency mask), the objects.
std::pair<QStringList, QSet<int>> drawnPictures(const QString &pdf)
{
    std::pair<QStringList, QSet<int>> drawn;
    for (const QStringList &row : table(u"pdfimages"_s, {u"-list"_s, pdf})) {
        drawn.first << row.at(2);
        drawn.second << row.at(10).toInt();
    }
    return drawn;
}

// pdftotext -bbox-layout: the words of each page with their boxes, in points from the top left.
struct Word
{
    double xMin = 0, yMin = 0, xMax = 0, yMax = 0;
    QString text;
    double middle() const { return (yMin + yMax) / 2; }
};
using Page = QList<Word>;
QList<Page> pdfWords(const QString &pdf)
{
    QList<Page> pages;
    QXmlStreamReader xml(run(u"pdftotext"_s, {u"-bbox-layout"_s, pdf, u"-"_s}).second);
    while (!xml.atEnd()) {
        if (xml.readNext() != QXmlStreamReader::StartElement)
            continue;
        const auto number = [&xml](const char *name) {
            return xml.attributes().value(QLatin1String(name)).toDouble();
        };
        if (xml.name() == "page"_L1)
            pages << Page();
        else if (xml.name() == "word"_L1 && !pages.isEmpty())
            pages.last() << Word{number("xMin"), number("yMin"), number("xMax"), number("yMax"),
                                 xml.readElementText()};
    }
    return pages;
}

// The right edge of a word's cell in the layout catalog (column 0 at the right).
double cellRight(const Word &word)
{
    return Width - Margin - int((Width - Margin - (word.xMin + word.xMax) / 2) / CellWidth) * CellWidth;
}

// A text line of a cell, its words from left to right.
using Line = QList<Word>;
// The lines of the layout catalog's cells on a page, the bands' words left out: words go by
// cell, then by their vertical middle (faces differ in height).
QList<Line> cellLines(Page words)
{
    words.removeIf([](const Word &word) { return word.middle() < Top || word.middle() > Bottom; });
    std::sort(words.begin(), words.end(), [](const Word &a, const Word &b) {
        return std::pair(-cellRight(a), a.middle()) < std::pair(-cellRight(b), b.middle());
    });
    QList<Line> lines;
    for (const Word &word : words) {
        if (lines.isEmpty() || cellRight(lines.last().constFirst()) != cellRight(word) ||
            word.middle() - lines.last().constFirst().middle() > 0.4 * (word.yMax - word.yMin))
            lines << Line();
        lines.last() << word;
    }
    for (Line &line : lines)
        std::sort(line.begin(), line.end(), [](const Word &a, const Word &b) { return a.xMin < b.xMin; });
    return lines;
}

// The visual order, left to right, of a line typed in logical order, by ICU's implementation of
// the Unicode bidirectional algorithm in a right-to-left paragraph, with mirrored brackets.
QString visualOrder(const QString &logical)
{
    UErrorCode error = U_ZERO_ERROR;
    UBiDi *bidi = ubidi_open();
    ubidi_setPara(bidi, reinterpret_cast<const UChar *>(logical.utf16()), int32_t(logical.size()), UBIDI_RTL,
                  nullptr, &error);
    QString visual(logical.size() * 2, QChar());
    const int32_t length =
        ubidi_writeReordered(bidi, reinterpret_cast<UChar *>(visual.data()), int32_t(visual.size()),
                             UBIDI_DO_MIRRORING | UBIDI_REMOVE_BIDI_CONTROLS, &error);
    ubidi_close(bidi);
    return U_SUCCESS(error) ? visual.left(length) : QString();
}

bool near(QRgb a, QRgb b)
{
    return qAbs(qRed(a) - qRed(b)) + qAbs(qGreen(a) - qGreen(b)) + qAbs(qBlue(a) - qBlue(b)) < 100;
}

// Items P000, P001, ... showing these pictures (in the test's picture folder; "?" for none).
WorkRows itemsWithPictures(const QStringList &pictures)
{
    WorkRows rows;
    for (const QString &file : pictures)
        rows.items << WorkItem{
            .key = u"P%1"_s.arg(int(rows.items.size()), 3, 10, QChar(u'0')),
            .picture = file == u'?' ? file : QDir(QStringLiteral(ZORBIN_PDF_TEST_PICTURES)).filePath(file)};
    return rows;
}

// Three items show the photograph.
const QStringList Pictures =
    u"photo-exif.jpg photo-exif.jpg transparent.png broken.jpg missing.jpg ? photo-exif.jpg ?"_s.split(u' ');

} // namespace

class PdfTest : public QObject
{
    Q_OBJECT

    QTemporaryDir m_folder;
    QString m_layout; // the layout catalog's PDF
    PdfWritten m_written;

    // Writes the rows as the PDF `pdf` on a grid of framed cells under a top and a bottom band:
    // the settings' lines, or else the picture and the name.
    Result<PdfWritten> write(OutputContext &out, const QString &pdf, const WorkRows &rows, int gridRows,
                             int gridColumns)
    {
        const QString database = pdf + u".db"_s;
        if (const Status made = makeWorkDatabase(database, rows); !made)
            return made;
        CatalogSettings &settings = out.settings;
        settings.rows = gridRows;
        settings.columns = gridColumns;
        settings.frameItems = true;
        settings.topPercent = TopPercent;
        settings.bottomPercent = BottomPercent;
        settings.topTitle = u"קטלוג <b>בדיקה</b>"_s;
        settings.bottomTitle = u"טלפון: 03-1234567"_s;
        settings.priceList1.setCurrentIndex(settings.priceList1.addEntry(u"מחיר מכירה"_s, 0));
        if (!settings.lines[0].isUsed()) {
            settings.lines[0].field = 0;
            settings.lines[1].field = 2;
        }
        const Result<PdfWritten> written = CreateCatPDF(out.context, {pdf, database, PdfPageSize::A4});
        QFile::remove(database);
        return written;
    }

private Q_SLOTS:
    // The layout catalog: eight items in Hebrew and Latin, a picture and four lines each.
    void initTestCase()
    {
        QVERIFY(setUpSqliteEngine()); // as the programs do
        if (qEnvironmentVariableIsSet("ZORBIN_KEEP_TEST_FILES")) {
            // For a look at the PDFs.
            m_folder.setAutoRemove(false);
            qInfo("keeping %s", qPrintable(m_folder.path()));
        }
        WorkRows rows = itemsWithPictures(Pictures);
        for (int i = 0; i < Items; ++i) {
            WorkItem &item = rows.items[i];
            item.key = i == 0 ? u"IKEA-200"_s : u"K%1"_s.arg(i + 1);
            item.name = i == 0 ? u"ארון IKEA (לבן) 2 דלתות"_s : u"פריט %1"_s.arg(i + 1);
            item.price = i == 0 ? 1234.5 : 10.0 * (i + 1);
            item.coin = i == 0 ? u"ש\"ח"_s : u"$"_s;
        }
        rows.other[u"tExtraNote1"_s] = {{u"IKEA-200"_s, u"1,234.50 ש\"ח (IKEA-200)"_s}};
        OutputContext out;
        out.settings.lines = {{{{}, 0, {}},                       // the picture
                               {{}, 2, {1, 11, 2}},               // name: David, bold
                               {u"<i>פריט:</i>"_s, 1, {2, 9, 0}}, // key: Miriam; markup
                               {u"מחיר נטו:"_s, 4, {0, 10, 1}},   // price: Arial, bolder
                               {u"מחיר:"_s, 7, {0, 9, 0}}}};      // a note
        m_layout = m_folder.filePath(u"layout.pdf"_s);
        const Result<PdfWritten> written = write(out, m_layout, rows, Rows, Columns);
        QVERIFY2(written, qPrintable(written.status().description()));
        QCOMPARE(written->ending, PdfWritten::Ending::Written);
        QCOMPARE(written->file, m_layout);
        QCOMPARE(written->pages, 2); // eight items, six cells a page
        m_written = written.value();
        QCOMPARE(out.user.fillWidth, 0); // a run that ends puts the bar back
    }

    // The demo's first page as pdftotext lays it out, against the text beside this test (after a
    // deliberate change ZORBIN_UPDATE_GOLDEN=1 rewrites it: review the diff); its pictures; the page sizes.
    void demoCatalog()
    {
        const auto cli = [](const QStringList &arguments) {
            return run(QStringLiteral(ZORBIN_CLI),
                       QStringList{u"pdf"_s, u"--settings"_s, demoFolder() + u"/demo-settings.ini"_s} +
                           arguments);
        };
        const QString pdf = m_folder.filePath(u"demo.pdf"_s), letter = m_folder.filePath(u"letter.pdf"_s);
        const auto [exitCode, out] = cli({u"--out"_s, pdf});
        QCOMPARE(exitCode, 0);
        QCOMPARE(QString::fromUtf8(out).trimmed(), QDir::toNativeSeparators(pdf));
        const QByteArray text = run(u"pdftotext"_s, {u"-layout"_s, u"-l"_s, u"1"_s, pdf, u"-"_s}).second;
        const QString expected = QStringLiteral(ZORBIN_SOURCE_DIR "/tests/pdf/demo-first-page.txt");
        if (qEnvironmentVariableIsSet("ZORBIN_UPDATE_GOLDEN"))
            writeFile(expected, text);
        QCOMPARE(QString::fromUtf8(text), QString::fromUtf8(readFile(expected)));

        QCOMPARE(drawnPictures(pdf).second.size(), 13); // the twelve pictures and the logo, each stored once
        QVERIFY(run(u"pdfinfo"_s, {pdf}).second.contains("595 x 842 pts (A4)"));
        QCOMPARE(cli({u"--out"_s, letter, u"--page-size"_s, u"letter"_s}).first, 0);
        QVERIFY(run(u"pdfinfo"_s, {letter}).second.contains("612 x 792 pts (letter)"));
        QCOMPARE(cli({u"--page-size"_s, u"a5"_s}).first, 2);
    }

    // Every face the lines name is there and embedded, and nothing but them and the fallback.
    void fontsAreEmbedded()
    {
        QSet<QString> families;
        const QRegularExpression face(u"^(\\w+\\+)?(LiberationSans|DavidCLM|MiriamCLM|DejaVuSans)"_s);
        for (const QStringList &font : table(u"pdffonts"_s, {m_layout})) {
            // name ... emb sub uni object generation
            QVERIFY2(font.at(font.size() - 5) == "yes"_L1 && face.match(font.first()).hasMatch(),
                     qPrintable(font.first()));
            families << face.match(font.first()).captured(2);
        }
        families.remove(u"DejaVuSans"_s);
        QCOMPARE(families.size(), 3);
    }

    // Every line here is right-aligned: its last word ends within 1 mm of its cell's right edge.
    void rightAlignedLinesEndAtTheCellEdge()
    {
        const QList<Page> pages = pdfWords(m_layout);
        QCOMPARE(pages.size(), m_written.pages);
        int lines = 0;
        for (const Page &page : pages) {
            for (const Line &line : cellLines(page)) {
                const double gap = cellRight(line.constLast()) - line.constLast().xMax;
                QVERIFY2(gap >= 0 && gap <= Millimetre,
                         qPrintable(u"%1 ends %2 mm from its cell's edge"_s.arg(line.constLast().text)
                                        .arg(gap / Millimetre)));
                ++lines;
            }
        }
        QCOMPARE(lines, Items * 4);
    }

    // Hebrew, Latin, numbers, brackets and the currency: the glyphs stand left to right as the
    // bidirectional algorithm orders the logical text, so that a reader reads it in logical order.
    void mixedLinesReadInLogicalOrder_data()
    {
        QTest::addColumn<QString>("logical");
        QTest::newRow("note") << u"מחיר: 1,234.50 ש\"ח (IKEA-200)"_s;
        QTest::newRow("price") << u"מחיר נטו: 1,234.50 ש\"ח"_s;
        QTest::newRow("dollars") << u"מחיר נטו: 20.00 $"_s;
        QTest::newRow("key, markup caption") << u"פריט: IKEA-200"_s;
        QTest::newRow("name") << u"ארון IKEA (לבן) 2 דלתות"_s;
    }
    void mixedLinesReadInLogicalOrder()
    {
        QFETCH(QString, logical);
        const QString expected = visualOrder(logical).remove(u' ');
        QVERIFY(!expected.isEmpty());
        QStringList seen;
        for (const Line &line : cellLines(pdfWords(m_layout).constFirst())) {
            seen << QString();
            for (const Word &word : line)
                seen.last() += word.text;
        }
        QVERIFY2(seen.contains(expected),
                 qPrintable(u"no line reads %1; lines: %2"_s.arg(expected, seen.join(u" | "_s))));
    }

    // The photograph turned upright and scaled while decoding, the PNG's transparency on white,
    // the broken and the missing file an empty box; each picture decoded and stored once.
    void pictures()
    {
        QCOMPARE(m_written.picturesDecoded, 3);    // the photograph, the PNG, the broken file; each once
        QCOMPARE(m_written.picturesHeldAtMost, 2); // each let go after its last item
        // Four drawn (three items show the photograph), two stored, no transparency left.
        const auto [kinds, objects] = drawnPictures(m_layout);
        QCOMPARE(kinds, QStringList(4, u"image"_s));
        QCOMPARE(objects.size(), 2);

        // Extracted, in the items' order: the photograph upright (its left half blue) and no larger
        // than its box at 300 dpi; the PNG at its own size with its transparent half white.
        const QString prefix = m_folder.filePath(u"x"_s);
        QCOMPARE(run(u"pdfimages"_s, {u"-png"_s, m_layout, prefix}).first, 0);
        const QImage photo(prefix + u"-000.png"_s), flat(prefix + u"-002.png"_s);
        QVERIFY2(photo.width() < photo.height() && photo.height() < 1000,
                 qPrintable(u"%1 x %2"_s.arg(photo.width()).arg(photo.height())));
        QVERIFY(near(photo.pixel(photo.width() / 4, photo.height() / 2), qRgb(0, 0, 255)));
        QVERIFY(near(photo.pixel(photo.width() * 3 / 4, photo.height() / 2), qRgb(255, 0, 0)));
        QCOMPARE(flat.size(), QSize(300, 200));
        QVERIFY(near(flat.pixel(20, 100), qRgb(255, 255, 255)));
        QVERIFY(near(flat.pixel(280, 100), qRgb(0, 192, 0)));
    }

    // The picture beside the lines takes a column at the cell's right, and the lines end left of
    // it; without a picture among the lines, they reach the cell's edge.
    void pictureBesideTheLines_data()
    {
        QTest::addColumn<int>("firstField"); // the name comes second
        QTest::newRow("the picture") << 0;
        QTest::newRow("the key") << 1;
    }
    void pictureBesideTheLines()
    {
        QFETCH(int, firstField);
        OutputContext out;
        out.settings.pictureLocation = PictureLocation::BesideLines;
        out.settings.lines[0].field = firstField;
        out.settings.lines[1].field = 2;
        const QString pdf = m_folder.filePath(u"beside.pdf"_s);
        QVERIFY(write(out, pdf, itemsWithPictures(Pictures), Rows, Columns));
        const QList<Line> lines = cellLines(pdfWords(pdf).constFirst());
        QCOMPARE(lines.size(), Rows * Columns * (firstField == 0 ? 1 : 2));
        for (const Line &line : lines) {
            const double gap = cellRight(line.constLast()) - line.constLast().xMax;
            QVERIFY2(firstField == 0 ? gap > CellWidth / 4 : gap <= Millimetre,
                     qPrintable(line.constLast().text));
        }
    }

    // Many distinct pictures, each shown twice, half the catalog apart, so that all are kept at
    // once: every one decoded and stored once, drawn from where it was kept (a cache that moved
    // its pictures as it grew drew freed memory).
    void manyPicturesEachStoredOnce()
    {
        QStringList files;
        for (int i = 0; i < 128; ++i) {
            files << m_folder.filePath(u"many%1.png"_s.arg(i % 64));
            QImage image(40 + i % 64, 30, QImage::Format_RGB32);
            image.fill(QColor::fromHsv(i % 64 * 5, 200, 200));
            QVERIFY(i >= 64 || image.save(files.last()));
        }
        OutputContext out;
        const QString pdf = m_folder.filePath(u"many.pdf"_s);
        const Result<PdfWritten> written = write(out, pdf, itemsWithPictures(files), 2, 4);
        QVERIFY(written);
        QCOMPARE(written->picturesDecoded, 64);
        QCOMPARE(written->picturesHeldAtMost, 64);
        const auto [kinds, objects] = drawnPictures(pdf);
        QCOMPARE(kinds.size(), 128);
        QCOMPARE(objects.size(), 64);
    }

    // A stop, or a catalog without items, keeps the older file as it was and leaves nothing else.
    void olderFileStays_data()
    {
        QTest::addColumn<bool>("stop");
        QTest::newRow("stopped on page 5") << true;
        QTest::newRow("no items") << false;
    }
    void olderFileStays()
    {
        QFETCH(bool, stop);
        QTemporaryDir folder;
        const QString pdf = folder.filePath(u"catalog.pdf"_s);
        writeFile(pdf, "an older catalog");
        WorkRows rows = itemsWithPictures(Pictures);
        for (WorkItem &item : rows.items)
            item.include = stop;
        OutputContext out;
        out.user.onYield = [&out] { out.state.StopRequested = true; }; // at the fifth cell: a page an item
        const Result<PdfWritten> written = write(out, pdf, rows, 1, 1);
        QVERIFY(written);
        QCOMPARE(written->ending, stop ? PdfWritten::Ending::Stopped : PdfWritten::Ending::NoItems);
        QVERIFY(written->file.isEmpty());
        QCOMPARE(readFile(pdf), QByteArray("an older catalog"));
        QCOMPARE(QDir(folder.path()).entryList(QDir::Files | QDir::Hidden), QStringList{u"catalog.pdf"_s});
        QCOMPARE(out.user.fillWidth > 0, stop); // the bar stays where the run stopped
    }
};

QTEST_MAIN(PdfTest)

#include "PdfTest.moc"
