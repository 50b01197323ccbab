#pragma once

#include "common/Status.h"

#include <QString>

namespace zorbin {

struct CatalogSettings;

// The item-range conditions of the settings page as SQL text for the WHERE clause of a query on
// the accounting database's `Items` table: a run of conditions, each introduced by " And ",
// always starting with " And Items.ItemKey <> '#' And Items.ItemKey <> '*'", then in this
// order the sort-group range (`ChkCatCode`), the filter pattern (`chkFilter`) and the key range
// (`ChkItemKey`), each only when its check box is ticked. Reads the record and nothing else.
//
// A sort-group bound that is not a whole number is refused with a message that names the field;
// apostrophes inside the key bounds and the filter pattern are doubled, so that no setting can
// change the query beyond its own condition.
Result<QString> BuildSourceDBCriteria(const CatalogSettings &settings);

} // namespace zorbin
