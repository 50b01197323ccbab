#pragma once

#include "model/ChoiceList.h"
#include "model/ConnectionParams.h"

#include <QList>
#include <QPair>
#include <QString>

// What the demo accounting database holds, as the source module reads it, and checks that run the
// same way on every way of reaching it (a file, the SQLite ODBC driver, a PostgreSQL server).
namespace zorbin::test {

using Entries = QList<QPair<QString, int>>;

Entries entriesOf(const ChoiceList &list);

// The note kinds and price lists of the demo, as the lists show them.
Entries demoNoteEntries();
Entries demoPriceListEntries();

// The demo's items that the catalog selects with no range settings: every key but "#", "*" and
// Null, a key held twice counted twice.
int demoSelectedItemRows();

// The five lists fill from the database that `params` reach.
void checkListsFillFromDemo(const ConnectionParams &params);
// The connection dialog's test succeeds with these values, and nothing is saved.
void checkLogonTestSucceeds(const ConnectionParams &params);
// The item query of a catalog run (standard name, picture from the file field, no range
// settings) reads the demo's items, with Hebrew texts and Nulls intact.
void checkItemQueryReadsDemo(const ConnectionParams &params);

} // namespace zorbin::test
