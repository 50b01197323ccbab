#pragma once

#include "common/Status.h"
#include "model/GridSize.h"

#include <QString>
#include <vector>

namespace zorbin {

struct CatalogSettings;

// One cell line that shows a field.
struct UsedLine
{
    int index = 0;   // 0 to 8, the line's place in the cell and its class ("L" + index)
    int field = 0;   // the CatalogField number (0 the picture, 4 and 5 prices)
    QString caption; // as the user typed it; empty for no caption cell
    QString column;  // the catalog query's column that carries the field
};

// What the page writer reads from the settings, read once when a run starts so that every
// page of one catalog follows the same settings.
struct PageLayout
{
    GridSize grid;
    int imageWidth = 0; // the picture box in pixels; size attributes only when both are above 0
    int imageHeight = 0;
    bool filePerPage = false;   // cmbPageSplit 1; 0 or no selection is one file
    bool pictureBeside = false; // cmbPicLocation 1: the picture cell spans every line
    QString logoReference;      // the logo as the pages refer to it; empty for none
    int topPercent = 0;         // band heights in percent; 0 or less leaves the band out
    int bottomPercent = 0;
    QString topTitle; // titles as typed (they may hold markup on purpose)
    QString topTitle2;
    QString bottomTitle;
    std::vector<UsedLine> lines; // the used lines in index order

    bool pictureSizes() const { return imageWidth > 0 && imageHeight > 0; }

    // Fails before anything is written when the grid is not a positive size or a used line's
    // tag names no field.
    static Result<PageLayout> read(const CatalogSettings &settings, const QString &imagesFolder);
};

} // namespace zorbin
