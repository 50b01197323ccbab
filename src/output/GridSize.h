#pragma once

#include "common/Status.h"

namespace zorbin {

struct CatalogSettings;

// The grid of item cells on a catalog page.
struct GridSize
{
    int rows = 0;    // from 1
    int columns = 0; // from 1

    long long cellsPerPage() const { return static_cast<long long>(rows) * columns; }
};

// `txtRows` and `txtCols` as a grid. A text that is not a whole number above 0 fails with a
// message that names the setting, before anything is written.
Result<GridSize> readGridSize(const CatalogSettings &settings);

} // namespace zorbin
