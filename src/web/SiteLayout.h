#pragma once

#include "common/Status.h"

#include <QSize>
#include <QString>
#include <vector>

namespace zorbin {

struct CatalogSettings;

// How one cell line's text looks, in the words of a stylesheet (see SiteStyle).
struct LineLook
{
    enum class Font { Arial, David, Miriam };
    enum class Weight { Normal, Bolder, Bold };
    enum class Align { Right, Center, Left };

    Font font = Font::Arial;
    int points = 9; // font size in points
    Weight weight = Weight::Normal;
    bool italic = false;
    bool underline = false;
    Align align = Align::Right;
};

// One cell line that shows a field.
struct SiteLine
{
    int index = 0;   // 0 to 8: the line's place in the item and its class ("L" + index)
    int field = 0;   // the catalog field (0 the picture, 4 and 5 prices)
    QString caption; // as typed, markup included; empty for none
    QString column;  // the catalog query's column that carries the field
    LineLook look;
};

// Everything the web catalog reads from the settings, read once when a run starts. This is
// the only place that knows the settings record: the rest of the site works on this.
struct SiteLayout
{
    int rows = 0;               // items per page are rows x columns, both from 1
    int columns = 0;            // items side by side on a wide screen
    QSize pictureBox;           // pixels, each side above 0: a side set to 0 or less is 300
    bool pictureBeside = false; // the picture right of the lines instead of in its line's place
    bool frames = false;        // a frame around every item
    QString logo;               // the logo picture's path; empty for none
    bool topBand = false;       // the titles and logo above the items
    bool bottomBand = false;    // the bottom title below them
    QString topTitle;           // titles as typed (they may hold markup on purpose)
    QString topTitle2;
    QString bottomTitle;
    std::vector<SiteLine> lines; // the used lines in index order

    long long itemsPerPage() const { return static_cast<long long>(rows) * columns; }

    // Fails, with the classic catalog's words, before anything is written when the grid is
    // not a positive size or a used line names no field.
    static Result<SiteLayout> read(const CatalogSettings &settings);
};

} // namespace zorbin
