#pragma once

#include <QByteArray>

namespace zorbin {

struct SiteLayout;

// The site's stylesheet. The grid has the settings' columns on a wide screen, about half of
// them on a tablet (600 to 1023 pixels) and one on a phone (below 600), and nothing is wider
// than the screen. Each used cell line has its class (".L" + index) with its format, in the
// words the classic stylesheet uses. Printed, the pages are A4 with the settings' columns and
// without the search box and the links.
QByteArray siteStylesheet(const SiteLayout &layout);

// The columns of the grid on a tablet for a catalog of `columns` columns: half of them,
// rounded up, but two when there are two or more.
int tabletColumns(int columns);

} // namespace zorbin
