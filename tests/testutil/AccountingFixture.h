#pragma once

#include "common/Status.h"
#include "model/ConnectionParams.h"

#include <QString>
#include <QStringList>
#include <memory>

// Accounting databases for tests: copies of the demo database and small SQLite files with the
// accounting tables, reached through connection type 3 (a database file) as a user would.
namespace zorbin {
class SettingsStore;
}

namespace zorbin::test {

// The demo accounting database built with the project (make-demo-db.sh).
QString demoDatabasePath();
// The demo's settings file (demo-settings.ini).
QString demoSettingsPath();

// Copies the demo database into `folder` under `name`; returns the copy's path. The test fails
// when the demo was not built.
QString copyDemoDatabase(const QString &folder, const QString &name = QStringLiteral("accounting.db"));

// Creates a SQLite file at `path` (replacing one there) with the accounting tables of
// demo/accounting-schema.sql, all empty, then runs `statements` on it.
Status makeAccountingFile(const QString &path, const QStringList &statements = {});

// Copies the demo's settings (demo-settings.ini) into `folder` and opens a store on the copy.
std::unique_ptr<SettingsStore> copyDemoSettings(const QString &folder);

// Connection parameters of type 3 for a database file: the folder as the server, the file name
// as the database.
ConnectionParams fileConnection(const QString &path);

} // namespace zorbin::test
