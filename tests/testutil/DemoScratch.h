#pragma once

#include "platform/SettingsStore.h"

#include <QTemporaryDir>
#include <memory>

namespace zorbin::test {

// The demo's settings copied into a scratch folder, with the output going to its "catalog"
// folder: where both programs' whole runs on the demo database start.
struct DemoScratch
{
    DemoScratch();

    // A file in the output folder.
    QString out(const QString &name) const;

    QTemporaryDir folder;
    QString settingsFile; // the copy of demo-settings.ini
    QString output;
    std::unique_ptr<SettingsStore> store;
};

// The key of the first item on a catalog page of the demo settings (the key line reads left to
// right); empty when the page has no item.
QString firstItemKey(const QString &page);
// The number of item rows on an item list page.
qsizetype listRows(const QString &page);

} // namespace zorbin::test
