#include "output/CatalogQuery.h"

#include "model/CatalogSettings.h"

#include <QStringList>

namespace zorbin {
namespace {

// Price list entry 0 is the item's own price, which the item step collects into tItems.
QString priceColumns(int list, int priceListIndex)
{
    const QString n = QString::number(list);
    if (priceListIndex == 0)
        return QStringLiteral(", tItems.SellPrice As Price%1, tItems.SellCoin As Coin%1").arg(n);
    const QString table = QStringLiteral("tItemPrice") + n;
    return QStringLiteral(", (Select Price From ") + table + QStringLiteral(" Where ") + table +
           QStringLiteral(".ItemKey = tItems.ItemKey)") + QStringLiteral(" As Price") + n +
           QStringLiteral(", (Select Coin From ") + table + QStringLiteral(" Where ") + table +
           QStringLiteral(".ItemKey = tItems.ItemKey)") + QStringLiteral(" As Coin") + n;
}

QString extraNoteColumn(int note)
{
    const QString n = QString::number(note);
    const QString table = QStringLiteral("tExtraNote") + n;
    return QStringLiteral(", (Select ExtraNote From ") + table + QStringLiteral(" Where ") + table +
           QStringLiteral(".ItemKey = tItems.ItemKey)") + QStringLiteral(" As ExtraNote") + n;
}

// The select-list piece of one field; the empty text for the fields that are always present
// and for numbers that name no field.
QString columnsOfField(int field, const CatalogSettings &settings)
{
    switch (field) {
    case 0:
        return QStringLiteral(", tItems.ItemPic");
    case 3:
        return QStringLiteral(", (Select SortName From tItemSort") +
               QStringLiteral(" Where tItemSort.ItemSort = tItems.ItemSort)") +
               QStringLiteral(" As SortName");
    case 4:
        return priceColumns(1, settings.priceList1.currentIndex());
    case 5:
        return priceColumns(2, settings.priceList2.currentIndex());
    case 6:
        return QStringLiteral(", tItems.Unit");
    case 7:
        return extraNoteColumn(1);
    case 8:
        return extraNoteColumn(2);
    default:
        return {};
    }
}

} // namespace

std::vector<LineField> usedLineFields(const CatalogSettings &settings)
{
    std::vector<LineField> used;
    for (int i = 0; i < CellLineCount; ++i) {
        if (const std::optional<int> field = settings.lines[static_cast<std::size_t>(i)].field)
            used.push_back({i, *field});
    }
    return used;
}

QString BuildSelect(const CatalogSettings &settings)
{
    QString select = QStringLiteral("SELECT tItems.ItemKey, tItems.ItemName, tItems.ItemSort");
    QStringList pieces;
    for (const LineField &line : usedLineFields(settings)) {
        const QString piece = columnsOfField(line.field, settings);
        // Two lines may show one field; one copy of its columns serves both.
        if (!piece.isEmpty() && !pieces.contains(piece))
            pieces << piece;
    }
    select += pieces.join(QString());
    select += QStringLiteral(" FROM tItems");
    return select;
}

QString BuildOrderBy(const CatalogSettings &settings)
{
    QString field;
    switch (settings.sortKey.value_or(SortKey::ItemKey)) {
    case SortKey::ItemKey:
        field = QStringLiteral("tItems.ItemKey");
        break;
    case SortKey::ItemName:
        field = QStringLiteral("tItems.ItemName");
        break;
    case SortKey::SortCode:
        field = QStringLiteral("tItems.ItemSort");
        break;
    }
    QString direction;
    if (settings.sortDirection)
        direction = *settings.sortDirection == SortDirection::Descending ? QStringLiteral("DESC")
                                                                         : QStringLiteral("ASC");
    return QStringLiteral(" ORDER BY ") + field + QStringLiteral(" ") + direction;
}

QString BuildFinalSQL(const CatalogSettings &settings)
{
    QString sql = BuildSelect(settings) + QStringLiteral(" WHERE tItems.Include = True");
    if (settings.onlyWithPicture)
        sql +=
            QStringLiteral(" And tItems.ItemPic <> '?'") + QStringLiteral(" And Not tItems.ItemPic Is Null");
    return sql + BuildOrderBy(settings);
}

} // namespace zorbin
