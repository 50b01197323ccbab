#pragma once

#include "common/Status.h"

#include <QString>

namespace zorbin::test {

// Damage done to a working database, as a damaged or foreign file can hold it: what the
// schema and the collection never write.

// Replaces the first price list by the table or view that `sql` creates.
Status replacePriceList(const QString &path, const QString &sql);

// Makes the engine fail ("integer overflow") when a statement that shows the first price
// reaches the item `itemKey`: the rows before it read well, the read of its row fails.
Status breakReadingAt(const QString &path, const QString &itemKey);

// Interrupts the statements running on every open working database, as a failing disk makes
// a read fail: the next row each of them reads fails ("interrupted").
void interruptWorkDatabases();

} // namespace zorbin::test
