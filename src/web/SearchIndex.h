#pragma once

#include <QByteArray>
#include <QStringView>

namespace zorbin {

class SiteFile;
struct Thumbnail;

// The search index of a site: a script file that sets `window.zorbinIndex` to an array with
// one entry per item in site order, [key, name, picture, width, height, page, item]: the
// picture's 1x file ("" for none) and size, the number of the page that shows the item and
// the item's place in the site (its article's id is "i" and that number). A script rather
// than JSON, because a page opened from disk may load a script but not fetch a file.

// The text as a JSON string, quotes included. Marks that could end a string or a script
// element are escaped; every other character is kept as it is.
void appendJsonString(QByteArray &out, QStringView text);

// An entry up to its picture's size: "[key,name,picture,width,height" (picture may be null).
QByteArray searchEntryStart(QStringView key, QStringView name, const Thumbnail *picture);

void writeSearchIndexStart(SiteFile &index);
// The entry begun by searchEntryStart, with its page and place; `first` for the first entry.
void writeSearchEntry(SiteFile &index, QByteArrayView start, long long page, long long item, bool first);
void writeSearchIndexEnd(SiteFile &index);

} // namespace zorbin
