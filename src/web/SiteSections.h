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

// The site's order of the items: the sections in sort-code order, the items without a sort
// group last, and inside each section the items in the catalog's order.
struct SectionPlan
{
    std::vector<qint64> order;     // order[n] is the catalog place (from 0) of the site's item n
    std::vector<Section> sections; // in site order
};

// `groups[i]` is the sort group of the catalog's item i; `names` the names of the sort groups.
// A group without a name (none stored, or an empty one) is titled by its code.
SectionPlan planSections(const std::vector<std::optional<qint64>> &groups,
                         const QHash<qint64, QString> &names);

// The sort groups' names of the working database (tItemSort): code to name, a null name as
// the empty text. Fails with the engine's description.
Result<QHash<qint64, QString>> readSortGroupNames(const QString &dbFile);

} // namespace zorbin
