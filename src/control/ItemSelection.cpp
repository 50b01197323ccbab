#include "control/ItemSelection.h"

#include "workdb/WorkDatabase.h"

#include <QSqlError>
#include <QSqlQuery>

namespace zorbin {
namespace {

// How the working database stores a Boolean.
constexpr int StoredTrue = -1;
constexpr int StoredFalse = 0;

} // namespace

QString BuildItemListSQL(bool onlyMarked)
{
    QString sql = QStringLiteral("SELECT ItemKey, ItemName, Include");
    sql += QStringLiteral(" FROM tItems");
    sql += QStringLiteral(" WHERE (1 > 0)");
    if (onlyMarked)
        sql += QStringLiteral(" And Include = True");
    sql += QStringLiteral(" ORDER BY tItems.Include, tItems.Itemkey");
    return sql;
}

Result<std::unique_ptr<MarkedItems>> MarkedItems::open(const QString &workDbFile)
{
    auto opened = WorkDatabase::open(workDbFile);
    if (!opened)
        return opened.status();
    return std::unique_ptr<MarkedItems>(new MarkedItems(std::move(opened).value()));
}

MarkedItems::MarkedItems(std::unique_ptr<WorkDatabase> database) : m_database(std::move(database)) {}

MarkedItems::~MarkedItems() = default;

Result<QVector<SelectableItem>> MarkedItems::read(bool onlyMarked)
{
    WorkDatabase &database = *m_database;
    auto query = database.select(BuildItemListSQL(onlyMarked));
    if (!query)
        return query.status();
    QVector<SelectableItem> items;
    while (query->next())
        items.push_back(
            {query->value(0).toString(), query->value(1).toString(), query->value(2).toInt() != StoredFalse});
    if (query->lastError().isValid())
        return Status::fault(query->lastError().text());
    return items;
}

Status MarkedItems::write(const QStringList &keys, bool include)
{
    WorkDatabase &database = *m_database;
    const bool batch = keys.size() > 1 && !database.inTransaction();
    if (batch) {
        if (const Status begun = database.begin(); !begun)
            return begun;
    }
    QSqlQuery update(database.database());
    Status outcome;
    if (!update.prepare(QStringLiteral("UPDATE tItems SET Include = ? WHERE ItemKey = ?"))) {
        outcome = Status::fault(update.lastError().text());
    } else {
        for (const QString &key : keys) {
            update.bindValue(0, include ? StoredTrue : StoredFalse);
            update.bindValue(1, key);
            if (!update.exec()) {
                outcome = Status::fault(update.lastError().text());
                break;
            }
        }
    }
    update.finish();
    if (batch) {
        // What was written before a failure stays written, as each mark is its own change.
        if (const Status committed = database.commit(); !committed && outcome)
            return committed;
    }
    return outcome;
}

int findItemRow(const QVector<SelectableItem> &items, ItemSearchColumn column, const QString &text)
{
    if (text.isEmpty())
        return -1;
    for (int row = 0; row < items.size(); ++row) {
        const SelectableItem &item = items.at(row);
        const QString &cell = column == ItemSearchColumn::Key ? item.key : item.name;
        if (cell.startsWith(text, Qt::CaseInsensitive))
            return row;
    }
    return -1;
}

} // namespace zorbin
