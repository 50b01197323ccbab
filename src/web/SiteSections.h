#pragma once

#include "common/Status.h"

#include <QHash>
#include <QString>
#include <optional>
#include <vector>

namespace zorbin {

// The items of one sort group, under one heading.
struct Section
{
    std::optional<qint64> group; // the sort code; nothing for the items without a sort group
    QString title;               // the group's name, as stored (not escaped)
    long long first = 0;         // the place of its first item in the site, from 0
    long long count = 0;         // its items, at least one

    // The id of its heading in a page: "s-" and the code, or "s-none".
    QString anchor() const;
};

// The sections of the catalog's items in site order: in sort-code order, the items without a
// sort group last. `groups[i]` is the sort group of the catalog's item i (its items keep the
// catalog's order inside their section); `names` the names of the sort groups. A group without
// a name (none stored, or blanks) is titled by its code.
std::vector<Section> planSections(const std::vector<std::optional<qint64>> &groups,
                                  const QHash<qint64, QString> &names);

// The sort groups' names of the working database (tItemSort): code to name, a null name as
// the empty text. Fails with the engine's description.
Result<QHash<qint64, QString>> readSortGroupNames(const QString &dbFile);

} // namespace zorbin
