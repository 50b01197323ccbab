#pragma once

#include <QString>

namespace zorbin {

class Windows1255Writer;
struct PageLayout;

// The fixed parts of a catalog page. Titles go in as the user typed them; file references are
// escaped for their attribute.

// "<HTML>" to "<BODY ...>": the title, the code page and the stylesheet link.
void writeDocumentHead(Windows1255Writer &page);
// The start of one page's outer table.
void writeOuterTableStart(Windows1255Writer &page);
// The top band: the two titles and the logo. Only when the layout's top percent is above 0.
void writeTopBand(Windows1255Writer &page, const PageLayout &layout);
// The bottom band: the bottom title and, in the file-per-page mode, the links to the previous
// and next page. Only when the layout's bottom percent is above 0. Pages count from 1.
void writeBottomBand(Windows1255Writer &page, const PageLayout &layout, const QString &pagePrefix,
                     long long pageNumber, long long pageCount);
// A grid cell after the last item.
void writeEmptyCellLines(Windows1255Writer &page);
// The end of one page's outer table.
void writeOuterTableEnd(Windows1255Writer &page);
// "</BODY>" and "</HTML>".
void writeDocumentEnd(Windows1255Writer &page);

} // namespace zorbin
