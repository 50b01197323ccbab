#include "web/SiteLayout.h"

#include "model/CatalogSettings.h"
#include "output/PageLayout.h"

namespace zorbin {
namespace {

// A picture box side that was left empty or 0: the site still needs a size to make thumbnails.
constexpr int DefaultBoxSide = 300;

int boxSide(int side)
{
    return side > 0 ? side : DefaultBoxSide;
}

// The format bytes as the classic stylesheet reads them: an index the editor does not offer
// is its first word.
template <typename Word> Word wordOf(std::uint8_t index, std::initializer_list<Word> words)
{
    return index < words.size() ? words.begin()[index] : *words.begin();
}

LineLook lookOf(const CellFormat &format)
{
    using Look = LineLook;
    Look look;
    look.font = wordOf(format.font, {Look::Font::Arial, Look::Font::David, Look::Font::Miriam});
    look.points = format.size;
    look.weight = wordOf(format.weight, {Look::Weight::Normal, Look::Weight::Bolder, Look::Weight::Bold});
    look.italic = format.italic == 1;
    look.underline = format.underline == 1;
    look.align = wordOf(format.align, {Look::Align::Right, Look::Align::Center, Look::Align::Left});
    return look;
}

} // namespace

Result<SiteLayout> SiteLayout::read(const CatalogSettings &settings)
{
    // The pages' own reading of the grid, box and lines, so that both catalogs agree on them.
    const auto page = PageLayout::read(settings, QString());
    if (!page)
        return page.status();
    SiteLayout layout;
    layout.rows = page->grid.rows;
    layout.columns = page->grid.columns;
    layout.pictureBox = QSize(boxSide(page->imageWidth), boxSide(page->imageHeight));
    layout.pictureBeside = page->pictureBeside;
    layout.frames = settings.frameItems;
    layout.logo = settings.logo;
    layout.topBand = page->topPercent > 0;
    layout.bottomBand = page->bottomPercent > 0;
    layout.topTitle = page->topTitle;
    layout.topTitle2 = page->topTitle2;
    layout.bottomTitle = page->bottomTitle;
    for (const UsedLine &line : page->lines)
        layout.lines.push_back({line.index, line.field, line.caption, line.column,
                                lookOf(settings.lines[static_cast<std::size_t>(line.index)].format)});
    return layout;
}

} // namespace zorbin
