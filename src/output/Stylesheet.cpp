#include "output/Stylesheet.h"

#include "model/CatalogSettings.h"
#include "model/GridSize.h"
#include "model/RunContext.h"
#include "output/CatalogQuery.h"
#include "output/OutputFolder.h"
#include "platform/FileSystem.h"
#include "platform/Paths.h"
#include "platform/ValueFormat.h"
#include "platform/Windows1255Writer.h"

#include <array>

namespace zorbin {
namespace {

// The words of the format bytes; an index the editor does not offer writes the first word.
QString wordOf(const std::array<QString, 3> &words, std::uint8_t index)
{
    return index < words.size() ? words[index] : words[0];
}

QString fontWord(std::uint8_t index)
{
    static const std::array<QString, 3> words = {QStringLiteral("Arial (Hebrew)"), QStringLiteral("David"),
                                                 QStringLiteral("Miriam")};
    return wordOf(words, index);
}

QString weightWord(std::uint8_t index)
{
    static const std::array<QString, 3> words = {QStringLiteral("Normal"), QStringLiteral("Bolder"),
                                                 QStringLiteral("Bold")};
    return wordOf(words, index);
}

QString alignWord(std::uint8_t index)
{
    static const std::array<QString, 3> words = {QStringLiteral("Right"), QStringLiteral("Center"),
                                                 QStringLiteral("Left")};
    return wordOf(words, index);
}

void writeLineClass(Windows1255Writer &css, int index, const CellFormat &format)
{
    css.write(QStringLiteral(".L") + QString::number(index) + QStringLiteral(" {font-family:") +
              fontWord(format.font) + QStringLiteral("; font-weight:") + weightWord(format.weight) +
              QStringLiteral("; font-size:") + QString::number(format.size) + QStringLiteral("pt") +
              QStringLiteral("; text-align:") + alignWord(format.align));
    if (format.italic == 1)
        css.writeLine(u"; font-style: Italic");
    if (format.underline == 1)
        css.writeLine(u"; text-decoration: underline");
    css.writeLine(u"; color:black;}");
}

} // namespace

Status CreateCSS(RunContext &context, const QString &outputFolder, bool replace)
{
    const CatalogSettings &settings = context.settings;
    const auto grid = readGridSize(settings);
    if (!grid)
        return grid.status();
    const QString height =
        QStringLiteral("height:") + formatOneDecimal(100.0 / grid->rows) + QStringLiteral("%");
    const QString width =
        QStringLiteral("width:") + formatOneDecimal(100.0 / grid->columns) + QStringLiteral("%");

    const QString path = withTrailingSeparator(outputFolder) + StylesheetName;
    if (!replace && context.files.fileExists(path))
        return Status::ok();
    auto created = Windows1255Writer::create(context.files, path);
    if (!created)
        return created.status();
    Windows1255Writer &css = *created.value();
    css.writeLine(u"@charset 'windows-1255';");
    css.writeLine(u"/* author: tarnik */");
    css.writeLine(
        u"body {background:white ;margin-top:10; margin-left:10; margin-right:10; vertical-align:top;}");
    css.writeLine(
        u"TABLE {padding: 0; border-spacing: 0; border-collapse: collapse; border: none; direction: rtl}");
    css.writeLine(u"TR {vertical-align: middle}");
    css.writeLine(u"TD {font-family:Arial; font-weight:Normal; font-size:9pt; color:black;}");
    css.writeLine(u".Top1 {font-family:Arial; font-weight:Normal; font-size:12pt; color:black;}");
    css.writeLine(u".Top2 {font-family:Arial; font-weight:Normal; font-size:11pt; color:black;}");
    css.writeLine(u".Bot1 {font-family:Arial; font-weight:Normal; font-size:11pt; color:black;}");
    for (const LineField &line : usedLineFields(settings))
        writeLineClass(css, line.index, settings.lines[static_cast<std::size_t>(line.index)].format);
    css.write(QStringLiteral(" .D1 {") + width + QStringLiteral("; ") + height +
              QStringLiteral("; text-align: center"));
    if (settings.frameItems)
        css.write(u"; border: thin solid; border-collapse: collapse");
    css.writeLine(u"}");
    return css.close();
}

} // namespace zorbin
