// Fonts, grid, alignment and the order of mixed Hebrew and Latin lines, read back from the PDF
// with poppler's tools.
#include "PdfFixture.h"
#include "pdf/CatalogPdf.h"
#include "testutil/TestMain.h"
#include "testutil/WorkDatabaseFixture.h"

#include <QMap>
#include <QRegularExpression>
#include <QSet>
#include <QTemporaryDir>
#include <QTest>
#include <algorithm>
#include <cmath>
#include <unicode/ubidi.h>
#include <vector>

using namespace zorbin;
using namespace zorbin::test;

namespace {

constexpr double Millimetre = 72 / 25.4;

// The visual order, left to right, of a line typed in logical order, by ICU's implementation of
// the Unicode bidirectional algorithm in a right-to-left paragraph, with mirrored brackets.
QString visualOrder(const QString &logical)
{
    UErrorCode error = U_ZERO_ERROR;
    UBiDi *bidi = ubidi_open();
    ubidi_setPara(bidi, reinterpret_cast<const UChar *>(logical.utf16()),
                  static_cast<int32_t>(logical.size()), UBIDI_RTL, nullptr, &error);
    std::vector<UChar> visual(static_cast<std::size_t>(logical.size()) * 2 + 1);
    const int32_t length = ubidi_writeReordered(bidi, visual.data(), static_cast<int32_t>(visual.size()),
                                                UBIDI_DO_MIRRORING | UBIDI_REMOVE_BIDI_CONTROLS, &error);
    ubidi_close(bidi);
    return U_SUCCESS(error) ? QString::fromUtf16(reinterpret_cast<const char16_t *>(visual.data()), length)
                            : QString();
}

QString withoutSpaces(QString text)
{
    return text.remove(QLatin1Char(' '));
}

} // namespace

class PdfLayoutTest : public QObject
{
    Q_OBJECT

    QTemporaryDir m_folder;
    QString m_pdf;
    TestCatalog m_catalog;
    const int m_items = 8;
    int m_pages = 0;

    // The text lines of the grid cells of a page: words grouped by cell (column 0 at the right)
    // and by their vertical middle (faces differ in height), each line's words from left to right.
    QList<QList<std::pair<int, Word>>> cellLines(const PageWords &page) const
    {
        const double margin = 10 * Millimetre;
        const double printable = page.height - 2 * margin;
        const double top = margin + printable * m_catalog.topPercent / 100;
        const double height = printable * (100 - m_catalog.topPercent - m_catalog.bottomPercent) / 100;
        const double width = (page.width - 2 * margin) / m_catalog.columns;
        QMap<int, QList<Word>> cells;
        for (const Word &word : page.words) {
            const double middleY = (word.yMin + word.yMax) / 2;
            if (middleY < top || middleY > top + height)
                continue; // a band
            const int row = static_cast<int>((middleY - top) / (height / m_catalog.rows));
            const int column = static_cast<int>((page.width - margin - (word.xMin + word.xMax) / 2) / width);
            cells[row * m_catalog.columns + column] << word;
        }
        QList<QList<std::pair<int, Word>>> lines;
        for (auto cell = cells.begin(); cell != cells.end(); ++cell) {
            QList<Word> &words = cell.value();
            const auto middle = [](const Word &word) { return (word.yMin + word.yMax) / 2; };
            std::sort(words.begin(), words.end(),
                      [&](const Word &a, const Word &b) { return middle(a) < middle(b); });
            for (qsizetype i = 0; i < words.size(); ++i) {
                const Word &word = words.at(i);
                if (i == 0 ||
                    middle(word) - middle(lines.last().constFirst().second) > 0.4 * (word.yMax - word.yMin))
                    lines.append(QList<std::pair<int, Word>>{});
                lines.last() << std::pair(cell.key(), word);
            }
            for (qsizetype n = lines.size() - 1; n >= 0 && lines.at(n).constFirst().first == cell.key(); --n)
                std::sort(lines[n].begin(), lines[n].end(),
                          [](const auto &a, const auto &b) { return a.second.xMin < b.second.xMin; });
        }
        return lines;
    }

private Q_SLOTS:
    void initTestCase()
    {
        QVERIFY(m_folder.isValid());
        m_folder.setAutoRemove(!keepTestFiles(m_folder.path()));
        const QString database = m_folder.filePath(QStringLiteral("work.db"));
        WorkRows rows;
        for (int i = 1; i <= m_items; ++i) {
            WorkItem item(i == 1 ? QStringLiteral("IKEA-200") : QStringLiteral("K%1").arg(i));
            item.name = i == 1 ? QStringLiteral("ארון IKEA (לבן) 2 דלתות") : QStringLiteral("פריט %1").arg(i);
            item.price = i == 1 ? 1234.5 : 10.0 * i;
            item.coin = i == 1 ? QStringLiteral("ש\"ח") : QStringLiteral("$");
            rows.items << item;
        }
        rows.other[QStringLiteral("tExtraNote1")] = {
            {QStringLiteral("IKEA-200"), QStringLiteral("1,234.50 ש\"ח (IKEA-200)")}};
        QVERIFY(makeWorkDatabase(database, rows));
        m_catalog.lines = {{2, {}, 1, 11, 2, 0},                            // name: David, bold
                           {1, QStringLiteral("<i>פריט:</i>"), 2, 9, 0, 0}, // key: Miriam; markup
                           {4, QStringLiteral("מחיר נטו:"), 0, 10, 1, 0},   // price: Arial, bolder
                           {7, QStringLiteral("מחיר:"), 0, 9, 0, 0}};       // a note
        PdfRig rig;
        applyCatalog(m_catalog, rig.settings);
        m_pdf = m_folder.filePath(QStringLiteral("layout.pdf"));
        const Result<PdfWritten> written = CreateCatPDF(rig.context, {m_pdf, database, PdfPageSize::A4});
        QVERIFY2(written, qPrintable(written.status().description()));
        QCOMPARE(written->ending, PdfWritten::Ending::Written);
        QCOMPARE(written->file, m_pdf);
        m_pages = static_cast<int>(written->pages);
        QCOMPARE(rig.user.fillWidth, 0); // a run that ends puts the bar back
    }

    // Every face the lines name is there and embedded, and nothing but them and the fallback.
    void fontsAreEmbedded()
    {
        QSet<QString> families;
        for (const FontRow &font : pdfFonts(m_pdf)) {
            QVERIFY2(font.embedded, qPrintable(font.name));
            const QRegularExpressionMatch match =
                QRegularExpression(
                    QStringLiteral("^(\\w+\\+)?(LiberationSans|DavidCLM|MiriamCLM|DejaVuSans)"))
                    .match(font.name);
            QVERIFY2(match.hasMatch(), qPrintable(font.name));
            families << match.captured(2);
        }
        QVERIFY(families.contains(QStringLiteral("LiberationSans")));
        QVERIFY(families.contains(QStringLiteral("DavidCLM")));
        QVERIFY(families.contains(QStringLiteral("MiriamCLM")));
    }

    void pagesHoldRowsTimesColumns()
    {
        const int perPage = m_catalog.rows * m_catalog.columns;
        QCOMPARE(m_pages, (m_items + perPage - 1) / perPage);
        QCOMPARE(pdfPageCount(m_pdf), m_pages);
    }

    // Every line here is right-aligned: its last word ends within 1 mm of its cell's right edge.
    void rightAlignedLinesEndAtTheCellEdge()
    {
        const QList<PageWords> pages = pdfWords(m_pdf);
        QCOMPARE(static_cast<int>(pages.size()), m_pages);
        int lines = 0;
        for (const PageWords &page : pages) {
            const double width = (page.width - 20 * Millimetre) / m_catalog.columns;
            for (const auto &line : cellLines(page)) {
                const int column = line.constFirst().first % m_catalog.columns;
                const double right = page.width - 10 * Millimetre - column * width;
                const Word &last = line.constLast().second;
                const double gap = right - last.xMax;
                QVERIFY2(gap >= 0 && gap <= Millimetre,
                         qPrintable(QStringLiteral("%1 ends %2 mm from its cell's edge")
                                        .arg(last.text)
                                        .arg(gap / Millimetre)));
                ++lines;
            }
        }
        QCOMPARE(lines, m_items * 4);
    }

    // Hebrew, Latin, numbers, brackets and the currency: the glyphs stand left to right as the
    // bidirectional algorithm orders the logical text, so that a reader reads it in logical order.
    void mixedLinesReadInLogicalOrder_data()
    {
        QTest::addColumn<QString>("logical");
        QTest::newRow("note") << QStringLiteral("מחיר: 1,234.50 ש\"ח (IKEA-200)");
        QTest::newRow("price") << QStringLiteral("מחיר נטו: 1,234.50 ש\"ח");
        QTest::newRow("dollars") << QStringLiteral("מחיר נטו: 20.00 $");
        QTest::newRow("key, markup caption") << QStringLiteral("פריט: IKEA-200");
        QTest::newRow("name") << QStringLiteral("ארון IKEA (לבן) 2 דלתות");
    }
    void mixedLinesReadInLogicalOrder()
    {
        QFETCH(QString, logical);
        const QString expected = withoutSpaces(visualOrder(logical));
        QVERIFY(!expected.isEmpty());
        QStringList seen;
        for (const auto &line : cellLines(pdfWords(m_pdf).constFirst())) {
            QString visual;
            for (const auto &word : line)
                visual += word.second.text;
            if (visual == expected)
                return;
            seen << visual;
        }
        QFAIL(qPrintable(
            QStringLiteral("no line reads %1; lines: %2").arg(expected, seen.join(QStringLiteral(" | ")))));
    }
};

ZORBIN_TEST_CLASS(PdfLayoutTest)
#include "PdfLayoutTest.moc"
