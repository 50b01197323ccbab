#pragma once

#include "common/Status.h"

#include <QString>

namespace zorbin {

struct RunContext;

// The collection run: a fresh working database, then items, sort groups, price lists and
// extra notes, with the step's text in the status line. Sets WorkDBFile.
Status BuildAndCollectData(RunContext &context);

// The fault of a run that is to collect a price list or an extra note (`what`, as the data tab
// names it) while its list has no entry selected.
Status nothingChosen(const QString &what);

} // namespace zorbin
