#include "PdfFixture.h"

#include <QProcess>
#include <QRegularExpression>
#include <QXmlStreamReader>

namespace zorbin::test {

bool keepTestFiles(const QString &folder)
{
    if (!qEnvironmentVariableIsSet("ZORBIN_KEEP_TEST_FILES"))
        return false;
    qInfo("keeping %s", qPrintable(folder));
    return true;
}

void applyCatalog(const TestCatalog &catalog, CatalogSettings &settings)
{
    settings.rows = catalog.rows;
    settings.columns = catalog.columns;
    settings.frameItems = catalog.frames;
    settings.topPercent = catalog.topPercent;
    settings.bottomPercent = catalog.bottomPercent;
    settings.topTitle = catalog.topTitle;
    settings.bottomTitle = catalog.bottomTitle;
    settings.priceList1.clear();
    settings.priceList1.setCurrentIndex(settings.priceList1.addEntry(QStringLiteral("מחיר מכירה"), 0));
    for (qsizetype i = 0; i < catalog.lines.size(); ++i) {
        const TestLine &line = catalog.lines.at(i);
        CellLine &cell = settings.lines[static_cast<std::size_t>(i)];
        cell.field = line.field;
        cell.caption = line.caption;
        cell.format.font = static_cast<std::uint8_t>(line.font);
        cell.format.size = static_cast<std::uint8_t>(line.size);
        cell.format.weight = static_cast<std::uint8_t>(line.weight);
        cell.format.align = static_cast<std::uint8_t>(line.align);
    }
}

ToolRun runTool(const QString &program, const QStringList &arguments)
{
    QProcess process;
    process.start(program, arguments);
    process.closeWriteChannel();
    if (!process.waitForFinished(120000))
        return {};
    return {process.exitStatus() == QProcess::NormalExit ? process.exitCode() : -1,
            process.readAllStandardOutput(), process.readAllStandardError()};
}

namespace {

// The rows of a tool's table after its two heading lines, split at white space.
QList<QStringList> tableRows(const QByteArray &output)
{
    QList<QStringList> rows;
    const QStringList lines = QString::fromUtf8(output).split(QLatin1Char('\n'), Qt::SkipEmptyParts);
    for (qsizetype i = 2; i < lines.size(); ++i)
        rows << lines.at(i).split(QRegularExpression(QStringLiteral("\\s+")), Qt::SkipEmptyParts);
    return rows;
}

} // namespace

QList<FontRow> pdfFonts(const QString &pdf)
{
    QList<FontRow> fonts;
    for (const QStringList &row : tableRows(runTool(QStringLiteral("pdffonts"), {pdf}).out)) {
        if (row.size() >= 7) // name ... emb sub uni object generation
            fonts << FontRow{row.constFirst(), row.at(row.size() - 5) == QLatin1String("yes")};
    }
    return fonts;
}

QList<ImageRow> pdfImages(const QString &pdf)
{
    QList<ImageRow> images;
    for (const QStringList &row :
         tableRows(runTool(QStringLiteral("pdfimages"), {QStringLiteral("-list"), pdf}).out)) {
        if (row.size() >= 11)
            images << ImageRow{row.at(0).toInt(), row.at(2), row.at(3).toInt(), row.at(4).toInt(),
                               row.at(10).toInt()};
    }
    return images;
}

int pdfPageCount(const QString &pdf)
{
    const QString info = QString::fromUtf8(runTool(QStringLiteral("pdfinfo"), {pdf}).out);
    const QRegularExpressionMatch match = QRegularExpression(QStringLiteral("Pages:\\s+(\\d+)")).match(info);
    return match.hasMatch() ? match.captured(1).toInt() : -1;
}

QList<PageWords> pdfWords(const QString &pdf)
{
    QList<PageWords> pages;
    QXmlStreamReader xml(
        runTool(QStringLiteral("pdftotext"), {QStringLiteral("-bbox-layout"), pdf, QStringLiteral("-")}).out);
    while (!xml.atEnd()) {
        if (xml.readNext() != QXmlStreamReader::StartElement)
            continue;
        const QXmlStreamAttributes attributes = xml.attributes();
        const auto number = [&attributes](const char *name) {
            return attributes.value(QLatin1String(name)).toDouble();
        };
        if (xml.name() == QLatin1String("page")) {
            pages << PageWords{number("width"), number("height"), {}};
        } else if (xml.name() == QLatin1String("word") && !pages.isEmpty()) {
            Word word{number("xMin"), number("yMin"), number("xMax"), number("yMax"), {}};
            word.text = xml.readElementText();
            pages.last().words << word;
        }
    }
    return pages;
}

} // namespace zorbin::test
