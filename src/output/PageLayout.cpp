#include "output/PageLayout.h"

#include "common/Numbers.h"
#include "model/CatalogSettings.h"
#include "output/CatalogQuery.h"
#include "output/FileNaming.h"

#include <limits>

namespace zorbin {
namespace {

// A typed number of the page settings: its whole value when it is a number, otherwise 0.
int numberOrZero(const QString &text)
{
    return static_cast<int>(
        toWholeNumber(text, std::numeric_limits<int>::min(), std::numeric_limits<int>::max()).value_or(0));
}

} // namespace

Result<PageLayout> PageLayout::read(const CatalogSettings &settings, const QString &imagesFolder)
{
    PageLayout layout;
    const auto grid = readGridSize(settings);
    if (!grid)
        return grid.status();
    layout.grid = grid.value();
    layout.imageHeight = numberOrZero(settings.txtImageH);
    layout.imageWidth = numberOrZero(settings.txtImageW);
    layout.filePerPage = settings.cmbPageSplit.currentIndex() == 1;
    layout.pictureBeside = settings.cmbPicLocation.currentIndex() == 1;
    layout.logoReference = layout.filePerPage && !settings.txtLogo.isEmpty()
                               ? ImageFileName(imagesFolder, settings.txtLogo)
                               : settings.txtLogo;
    layout.topPercent = numberOrZero(settings.txtTopPercent);
    layout.bottomPercent = numberOrZero(settings.txtBottomPercent);
    layout.topTitle = settings.txtTopTitle;
    layout.topTitle2 = settings.txtTopTitle2;
    layout.bottomTitle = settings.txtBottomTitle;
    const auto used = usedLineFields(settings);
    if (!used)
        return used.status();
    for (const LineField &line : used.value()) {
        if (line.field < 0 || line.field >= CatalogFieldCount)
            return Status::fault(
                QStringLiteral("שורה %1 בתא מסומנת בשדה %2, ואין שדה כזה (השדות הם 0 עד 8). יש "
                               "לגרור אל השורה שדה מרשימת השדות או לנקות אותה.")
                    .arg(line.index + 1)
                    .arg(line.field));
        const auto index = static_cast<std::size_t>(line.index);
        layout.lines.push_back({line.index, line.field, settings.lines[index].caption,
                                catalogFields()[static_cast<std::size_t>(line.field)].column});
    }
    return layout;
}

} // namespace zorbin
