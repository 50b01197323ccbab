#pragma once

#include "common/Status.h"

#include <QString>
#include <optional>

namespace zorbin {

struct CatalogSettings;

// The grid of item cells on a catalog page.
struct GridSize
{
    int rows = 0;    // from 1
    int columns = 0; // from 1

    long long cellsPerPage() const { return static_cast<long long>(rows) * columns; }
};

// The most cells a page may have: a grid larger than that makes pages no browser or printer can
// show, and a run of a few items would still write or draw every empty cell.
inline constexpr long long MaxCellsPerPage = 100000;

// Which count of the grid a problem is about.
enum class GridCount { Rows, Columns };

// What is wrong with one count of the grid as the user typed or the store held it (empty when
// the box holds no whole number), in a sentence that names the field and its tab and says what
// to type; nothing when it can make a catalog.
std::optional<QString> gridCountProblem(GridCount count, const std::optional<int> &value);

// The grid of the options. Rows or columns that are not a whole number of at least 1, or a grid
// of more than MaxCellsPerPage cells, fail with the message that names the field, before
// anything is collected or written.
Result<GridSize> readGridSize(const CatalogSettings &settings);

} // namespace zorbin
