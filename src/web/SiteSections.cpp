#include "web/SiteSections.h"

#include "workdb/WorkDatabase.h"

#include <QSqlError>
#include <map>

namespace zorbin {

QString Section::anchor() const
{
    return group ? QStringLiteral("s-") + QString::number(*group) : QStringLiteral("s-none");
}

std::vector<Section> planSections(const std::vector<std::optional<qint64>> &groups,
                                  const QHash<qint64, QString> &names)
{
    // Keyed so that the codes come in order and no sort group after them.
    std::map<std::pair<bool, qint64>, long long> counts;
    for (const std::optional<qint64> &group : groups)
        ++counts[{!group.has_value(), group.value_or(0)}];
    std::vector<Section> sections;
    long long first = 0;
    for (const auto &[key, count] : counts) {
        Section section;
        if (!key.first)
            section.group = key.second;
        section.first = first;
        section.count = count;
        if (!section.group)
            section.title = QStringLiteral("ללא קבוצת מיון");
        else if (section.title = names.value(key.second); section.title.trimmed().isEmpty())
            section.title = QStringLiteral("קבוצת מיון ") + QString::number(key.second);
        sections.push_back(section);
        first += count;
    }
    return sections;
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
