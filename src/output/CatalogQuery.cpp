#include "output/CatalogQuery.h"

#include "common/Numbers.h"
#include "model/CatalogSettings.h"

#include <QStringList>
#include <limits>

namespace zorbin {
namespace {

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
        return priceColumns(1, settings.cmbPriceField.currentIndex());
    case 5:
        return priceColumns(2, settings.cmbPriceField2.currentIndex());
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

Result<std::vector<LineField>> usedLineFields(const CatalogSettings &settings)
{
    std::vector<LineField> used;
    for (int i = 0; i < CellLineCount; ++i) {
        const CellLine &line = settings.lines[static_cast<std::size_t>(i)];
        if (!line.isUsed())
            continue;
        const auto number =
            toWholeNumber(line.tag, std::numeric_limits<int>::min(), std::numeric_limits<int>::max());
        if (!number)
            return Status::fault(QStringLiteral("שורה %1 בתא מסומנת בשדה \"%2\", שאינו מספר שדה. יש לגרור אל "
                                                "השורה שדה מרשימת השדות או לנקות אותה.")
                                     .arg(i + 1)
                                     .arg(line.tag));
        used.push_back({i, static_cast<int>(*number)});
    }
    return used;
}

Result<QString> BuildSelect(const CatalogSettings &settings)
{
    const auto lines = usedLineFields(settings);
    if (!lines)
        return lines.status();
    QString select = QStringLiteral("SELECT tItems.ItemKey, tItems.ItemName, tItems.ItemSort");
    QStringList pieces;
    for (const LineField &line : lines.value()) {
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
    switch (settings.CmbSortBy.currentIndex()) {
    case 1:
        field = QStringLiteral("tItems.ItemName");
        break;
    case 2:
        field = QStringLiteral("tItems.ItemSort");
        break;
    default:
        field = QStringLiteral("tItems.ItemKey");
        break;
    }
    QString direction;
    switch (settings.CmbSortDir.currentIndex()) {
    case 0:
        direction = QStringLiteral("ASC");
        break;
    case 1:
        direction = QStringLiteral("DESC");
        break;
    default:
        break;
    }
    return QStringLiteral(" ORDER BY ") + field + QStringLiteral(" ") + direction;
}

Result<QString> BuildFinalSQL(const CatalogSettings &settings)
{
    auto select = BuildSelect(settings);
    if (!select)
        return select.status();
    QString sql = std::move(select).value() + QStringLiteral(" WHERE tItems.Include = True");
    if (isTicked(settings.ChkOnlyWithPic))
        sql +=
            QStringLiteral(" And tItems.ItemPic <> '?'") + QStringLiteral(" And Not tItems.ItemPic Is Null");
    return sql + BuildOrderBy(settings);
}

} // namespace zorbin
