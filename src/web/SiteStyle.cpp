#include "web/SiteStyle.h"

#include "web/SiteLayout.h"

#include <algorithm>

namespace zorbin {
namespace {

// The fonts of the classic stylesheet, then the same faces as Debian names them (culmus) and
// a generic family, so that a machine without the first still shows a like face.
QByteArray fontFamily(LineLook::Font font)
{
    switch (font) {
    case LineLook::Font::David:
        return "David, \"David CLM\", serif";
    case LineLook::Font::Miriam:
        return "Miriam, \"Miriam CLM\", sans-serif";
    case LineLook::Font::Arial:
        break;
    }
    return "\"Arial (Hebrew)\", Arial, \"Liberation Sans\", \"DejaVu Sans\", sans-serif";
}

QByteArray fontWeight(LineLook::Weight weight)
{
    switch (weight) {
    case LineLook::Weight::Bolder:
        return "bolder";
    case LineLook::Weight::Bold:
        return "bold";
    case LineLook::Weight::Normal:
        break;
    }
    return "normal";
}

QByteArray textAlign(LineLook::Align align)
{
    switch (align) {
    case LineLook::Align::Center:
        return "center";
    case LineLook::Align::Left:
        return "left";
    case LineLook::Align::Right:
        break;
    }
    return "right";
}

QByteArray lineClass(const SiteLine &line)
{
    const LineLook &look = line.look;
    QByteArray css = ".L" + QByteArray::number(line.index) + " {font-family: " + fontFamily(look.font) +
                     "; font-weight: " + fontWeight(look.weight) +
                     "; font-size: " + QByteArray::number(look.points) +
                     "pt; text-align: " + textAlign(look.align);
    if (look.italic)
        css += "; font-style: italic";
    if (look.underline)
        css += "; text-decoration: underline";
    return css + "; color: black}\n";
}

QByteArray gridColumns(int columns)
{
    return ".grid {grid-template-columns: repeat(" + QByteArray::number(columns) + ", minmax(0, 1fr))}\n";
}

constexpr char BaseRules[] = R"css(*, *::before, *::after {box-sizing: border-box}
html {-webkit-text-size-adjust: 100%}
body {margin: 0 auto; max-width: 1400px; padding: 8px 12px; background: white; color: black;
  font-family: Arial, "Liberation Sans", "DejaVu Sans", sans-serif; font-size: 12px; overflow-wrap: anywhere}
img {max-width: 100%; height: auto}
[hidden] {display: none !important}
.top {display: flex; flex-wrap: wrap; align-items: center; justify-content: space-between; gap: 8px;
  padding-bottom: 8px; border-bottom: 1px solid #ccc}
.top .logo {display: block}
.Top1 {font-size: 12pt; font-weight: normal; margin: 0}
.Top2 {font-size: 11pt; margin: 0}
.Bot1 {font-size: 11pt; text-align: center; margin: 16px 0 8px}
.search {margin: 12px 0}
.search input {width: 100%; max-width: 420px; font: inherit; font-size: 16px; padding: 6px 8px}
.found {margin: 8px 0}
.sections ul {list-style: none; margin: 8px 0; padding: 0; display: flex; flex-wrap: wrap; gap: 4px 16px}
.sections .count {color: #666}
.group > h2 {font-size: 14pt; margin: 16px 0 8px; padding-bottom: 2px; border-bottom: 2px solid #ddd}
.grid {display: grid; gap: 12px; align-items: start}
.item {min-width: 0; padding: 8px; text-align: center}
.item .pic img {display: block; margin: 0 auto}
.result a {color: inherit; text-decoration: none}
.pages {display: flex; flex-wrap: wrap; justify-content: center; gap: 4px; margin: 16px 0}
.pages a, .pages span {min-width: 2.2em; padding: 4px 8px; border: 1px solid #ccc; text-align: center}
.pages .current {font-weight: bold; background: #eee}
.pages .gap {border: none}
)css";

} // namespace

int tabletColumns(int columns)
{
    return std::max(std::min(columns, 2), (columns + 1) / 2);
}

QByteArray siteStylesheet(const SiteLayout &layout)
{
    QByteArray css = "@charset \"utf-8\";\n";
    css += BaseRules;
    if (layout.frames)
        css += ".item {border: thin solid black}\n";
    if (layout.pictureBeside) {
        // The picture in the first column (the right one, right to left) beside all the lines.
        const QByteArray lines = QByteArray::number(std::max<std::size_t>(layout.lines.size() - 1, 1));
        css += ".item {display: grid; grid-template-columns: auto minmax(0, 1fr); column-gap: 8px; "
               "align-items: start}\n";
        css += ".item .pic {grid-column: 1; grid-row: 1 / span " + lines + "}\n";
        css += ".item > :not(.pic) {grid-column: 2}\n";
    }
    for (const SiteLine &line : layout.lines)
        css += lineClass(line);
    css += gridColumns(layout.columns);
    css += "@media screen and (max-width: 1023px) {" + gridColumns(tabletColumns(layout.columns)) + "}\n";
    css += "@media screen and (max-width: 599px) {" + gridColumns(1) + "}\n";
    css += "@media print {\n@page {size: A4; margin: 12mm}\nbody {max-width: none; padding: 0}\n"
           ".search, .sections, .pages, #results, .found {display: none !important}\n"
           ".item {break-inside: avoid}\n}\n";
    return css;
}

} // namespace zorbin
