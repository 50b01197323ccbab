#pragma once

#include "common/Status.h"

#include <QDate>
#include <QString>

namespace zorbin {

struct RunContext;

// Writes the plain item list page `fileName` (replacing a file of that name): one row per
// catalog item, in catalog order, with its name and key, under today's date. A stop ends the
// list early as a whole page.
Status CreateListHTML(RunContext &context, const QString &fileName, const QString &dbFile);

// The same with a given date in its heading.
Status writeListPage(RunContext &context, const QString &fileName, const QString &dbFile, const QDate &today);

} // namespace zorbin
