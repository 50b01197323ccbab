#include "web/SiteSections.h"

#include "workdb/WorkDatabase.h"

#include <QSqlError>
#include <algorithm>
#include <numeric>

namespace zorbin {

QString Section::anchor() const
{
    return group ? QStringLiteral("s-") + QString::number(*group) : QStringLiteral("s-none");
}

SectionPlan planSections(const std::vector<std::optional<qint64>> &groups,
                         const QHash<qint64, QString> &names)
{
    SectionPlan plan;
    plan.order.resize(groups.size());
    std::iota(plan.order.begin(), plan.order.end(), 0);
    // Nothing (no sort group) after every code; stable, so a section keeps the catalog's order.
    std::stable_sort(plan.order.begin(), plan.order.end(), [&](qint64 a, qint64 b) {
        const auto &left = groups[static_cast<std::size_t>(a)];
        const auto &right = groups[static_cast<std::size_t>(b)];
        if (left.has_value() != right.has_value())
            return left.has_value();
        return left.has_value() && *left < *right;
    });
    for (std::size_t n = 0; n < plan.order.size(); ++n) {
        const auto &group = groups[static_cast<std::size_t>(plan.order[n])];
        if (plan.sections.empty() || plan.sections.back().group != group) {
            Section section;
            section.group = group;
            section.first = static_cast<long long>(n);
            if (!group)
                section.title = QStringLiteral("ללא קבוצת מיון");
            else if (section.title = names.value(*group); section.title.trimmed().isEmpty())
                section.title = QStringLiteral("קבוצת מיון ") + QString::number(*group);
            plan.sections.push_back(section);
        }
        ++plan.sections.back().count;
    }
    return plan;
}

Result<QHash<qint64, QString>> readSortGroupNames(const QString &dbFile)
{
    auto database = WorkDatabase::open(dbFile);
    if (!database)
        return database.status();
    QHash<qint64, QString> names;
    {
        auto query = database.value()->select(QStringLiteral("SELECT ItemSort, SortName FROM tItemSort"));
        if (!query)
            return query.status();
        while (query->next()) {
            if (!query->value(0).isNull())
                names.insert(query->value(0).toLongLong(), query->value(1).toString());
        }
        if (query->lastError().isValid())
            return Status::fault(query->lastError().text());
    }
    return names;
}

} // namespace zorbin
