#pragma once

#include <QString>

namespace zorbin {

inline const QString WorkDatabaseName = QStringLiteral("zorbindb.tmp");

// Where every collection creates the working database: the user's temporary folder, then
// "zorbindb.tmp". One per user; the next collection deletes and re-creates it.
QString workDatabasePath();

} // namespace zorbin
