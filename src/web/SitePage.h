#pragma once

#include <QByteArray>
#include <vector>

namespace zorbin {

struct Section;
struct SiteLayout;
struct Thumbnail;

// The parts of a site page around its items, in UTF-8. Titles go in as typed (they may hold
// markup on purpose); section titles come from the working database and are escaped. Every
// reference is a bare file name of the site folder.

// From the document's start to where the items begin: the head, the top band with the titles
// and the logo (`logo` null for none), the search box, the place of the search results.
QByteArray pageStart(const SiteLayout &layout, long long page, const Thumbnail *logo);

// The list of the sections, each a link to its heading on the page where it starts.
QByteArray sectionList(const std::vector<Section> &sections, long long itemsPerPage);

// The start of a section on a page: its heading and the start of its grid.
QByteArray sectionStart(const Section &section);

// From after the items to the document's end: the links to the previous and next pages and to
// pages by number (the first, the last and those near this one), and the bottom band.
QByteArray pageEnd(const SiteLayout &layout, long long page, long long pageCount);

// The page (from 1) that shows the site's item at `place` (from 0).
long long pageOfItem(long long place, long long itemsPerPage);

} // namespace zorbin
