#include "output/PageLayout.h"

#include "model/CatalogSettings.h"
#include "output/CatalogQuery.h"
#include "output/FileNaming.h"

namespace zorbin {

Result<PageLayout> PageLayout::read(const CatalogSettings &settings, const QString &imagesFolder)
{
    PageLayout layout;
    const auto grid = readGridSize(settings);
    if (!grid)
        return grid.status();
    layout.grid = grid.value();
    layout.imageHeight = settings.pictureHeight.value_or(0);
    layout.imageWidth = settings.pictureWidth.value_or(0);
    layout.filePerPage = settings.pageSplit == PageSplit::FilePerPage;
    layout.pictureBeside = settings.pictureLocation == PictureLocation::BesideLines;
    layout.logoReference = layout.filePerPage && !settings.logo.isEmpty()
                               ? ImageFileName(imagesFolder, settings.logo)
                               : settings.logo;
    layout.topPercent = settings.topPercent.value_or(0);
    layout.bottomPercent = settings.bottomPercent.value_or(0);
    layout.topTitle = settings.topTitle;
    layout.topTitle2 = settings.topTitle2;
    layout.bottomTitle = settings.bottomTitle;
    for (const LineField &line : usedLineFields(settings)) {
        const auto index = static_cast<std::size_t>(line.index);
        layout.lines.push_back({line.index, line.field, settings.lines[index].caption,
                                catalogFields()[static_cast<std::size_t>(line.field)].column});
    }
    return layout;
}

} // namespace zorbin
