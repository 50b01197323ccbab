#include "source/ChoiceLists.h"

#include "common/Numbers.h"
#include "model/CatalogSettings.h"
#include "source/ConnectionString.h"
#include "source/SourceConnection.h"

#include <QSqlRecord>
#include <cstdint>
#include <functional>
#include <limits>
#include <optional>

namespace zorbin {
namespace {

const QString SalesPriceEntry = QStringLiteral("מחיר מכירה");

// One named, numbered row of a names table; nothing when the row cannot be read.
struct NamedNumber
{
    QString name;
    std::int32_t number = 0;
};

std::optional<std::int32_t> toInt32(const QVariant &value)
{
    if (value.isNull())
        return std::nullopt;
    const auto whole = toWholeNumber(value.toString(), std::numeric_limits<std::int32_t>::min(),
                                     std::numeric_limits<std::int32_t>::max());
    if (!whole)
        return std::nullopt;
    return static_cast<std::int32_t>(*whole);
}

// Runs `sql` and hands each row with a non-empty name to `add`; `start` runs once, before the
// first row, only when there is one. Stops silently at the first failure.
void fillFromNames(const ConnectionParams &connection, const QString &sql, const QString &numberColumn,
                   const QString &nameColumn, const std::function<void()> &start,
                   const std::function<void(const NamedNumber &)> &add)
{
    auto source = SourceConnection::open(BuildConnString(connection));
    if (!source)
        return;
    auto rows = source.value()->select(sql);
    if (!rows)
        return;
    QSqlQuery &query = rows.value();
    if (!query.next())
        return; // no rows (or a failure): the lists keep what they held
    start();
    // A missing column fails here, after the lists were emptied, as reading the first row would.
    const int numberField = query.record().indexOf(numberColumn);
    const int nameField = query.record().indexOf(nameColumn);
    if (numberField < 0 || nameField < 0)
        return;
    do {
        const QString name = TrimOrEmpty(query.value(nameField));
        if (name.isEmpty())
            continue;
        const auto number = toInt32(query.value(numberField));
        if (!number)
            return;
        add({name, *number});
    } while (query.next());
}

} // namespace

QString TrimOrEmpty(const QVariant &value)
{
    if (value.isNull())
        return {};
    return value.toString().trimmed();
}

void FillCmbExtraNote(const ConnectionParams &connection, CatalogSettings &settings)
{
    const QString sql = QStringLiteral("SELECT NoteID, NoteName") + QStringLiteral(" FROM ExtraNoteNames") +
                        QStringLiteral(" Where ItemFlag = 1") + QStringLiteral(" Order By NoteID");
    ChoiceList *lists[] = {&settings.pictureNote, &settings.extraNote1, &settings.extraNote2};
    fillFromNames(
        connection, sql, QStringLiteral("NoteID"), QStringLiteral("NoteName"),
        [&] {
            for (ChoiceList *list : lists)
                list->clear();
        },
        [&](const NamedNumber &note) {
            for (ChoiceList *list : lists)
                list->addEntry(note.name, note.number);
        });
}

void FillCmbPriceField(const ConnectionParams &connection, CatalogSettings &settings)
{
    ChoiceList *lists[] = {&settings.priceList1, &settings.priceList2};
    fillFromNames(
        connection, QStringLiteral("SELECT * FROM PriceListNames"), QStringLiteral("PriceListID"),
        QStringLiteral("PriceListName"),
        [&] {
            for (ChoiceList *list : lists) {
                list->clear();
                list->addEntry(SalesPriceEntry, 0);
            }
        },
        [&](const NamedNumber &priceList) {
            for (ChoiceList *list : lists)
                list->addEntry(priceList.name, priceList.number);
        });
}

} // namespace zorbin
