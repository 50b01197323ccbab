#pragma once

#include "common/Status.h"

#include <QString>
#include <vector>

namespace zorbin {

struct CatalogSettings;

// The one statement from which the pages, the picture copying and the item list read the
// catalog items, in catalog order. Each function reads the settings at the moment of the call
// and changes nothing.
//
// The statement is written in the working database's dialect with Boolean literals ("True");
// WorkDatabase::select translates them for the engine.

// The select list and the FROM clause: the three fixed columns (ItemKey, ItemName, ItemSort),
// then one piece per used cell line in line order for the columns that line needs (ItemPic,
// SortName, Price1/Coin1, Price2/Coin2, Unit, ExtraNote1, ExtraNote2). A field that several
// lines show is selected once.
QString BuildSelect(const CatalogSettings &settings);

// " ORDER BY " + sort field + " " + direction. A sort field list without a selection sorts by
// item key, its first entry, so that the statement stays valid; a direction list without a
// selection leaves the direction empty (the engine then sorts ascending).
QString BuildOrderBy(const CatalogSettings &settings);

// BuildSelect + " WHERE tItems.Include = True" (+ the picture conditions when only items with
// a picture are wanted) + BuildOrderBy.
QString BuildFinalSQL(const CatalogSettings &settings);

// A cell line that shows a field.
struct LineField
{
    int index = 0; // 0 to 8
    int field = 0; // the CatalogField number, 0 to 8
};

// The used cell lines in index order.
std::vector<LineField> usedLineFields(const CatalogSettings &settings);

} // namespace zorbin
