#include "workdb/SourceStatements.h"

#include "model/CatalogSettings.h"
#include "source/SourceCriteria.h"

namespace zorbin {

Result<QString> buildItemStatement(const CatalogSettings &settings)
{
    const PictureSource pictureSource = settings.pictureSource.value_or(PictureSource::FileField);
    std::int32_t noteNumber = 0;
    if (pictureSource == PictureSource::ExtraNote) {
        const std::optional<std::int32_t> chosen = settings.pictureNote.currentItemData();
        if (!chosen)
            return Status::fault(QStringLiteral("התמונות נלקחות מתוך נתון נוסף, אך לא נבחר איזה נתון נוסף. "
                                                "יש לבחור אותו בלשונית \"הגדרות נתונים\"."));
        noteNumber = *chosen;
    }
    Result<QString> criteria = BuildSourceDBCriteria(settings);
    if (!criteria)
        return criteria.status();

    QString sql = QStringLiteral("SELECT Items.ItemKey, Items.SortGroup, Items.Filter, Items.SalesUnit");
    sql += QStringLiteral(", Items.Price, Items.Currency");
    sql += settings.itemName == ItemNameSource::Foreign ? QStringLiteral(", Items.ForignName As ItemDesc")
                                                        : QStringLiteral(", Items.ItemName As ItemDesc");
    if (pictureSource == PictureSource::FileField)
        sql += QStringLiteral(", Items.ExFile As PicFile");
    else if (pictureSource == PictureSource::ExtraNote)
        sql += QStringLiteral(", ExtraNotes.Note As PicFile");
    sql += QStringLiteral(" FROM Items");
    if (pictureSource == PictureSource::ExtraNote)
        sql += QStringLiteral(", ExtraNotes");
    sql += QStringLiteral(" WHERE Not (ItemKey Is Null)");
    if (pictureSource == PictureSource::ExtraNote) {
        sql += QStringLiteral(" And ExtraNotes.ItemFlag = 1");
        sql += QStringLiteral(" And ExtraNotes.KeF = Items.ItemKey");
        sql += QStringLiteral(" And ExtraNotes.NoteID = ") + QString::number(noteNumber);
    }
    return sql + criteria.value();
}

Result<QString> buildPriceStatement(const CatalogSettings &settings, std::int32_t priceListId)
{
    Result<QString> criteria = BuildSourceDBCriteria(settings);
    if (!criteria)
        return criteria.status();
    return QStringLiteral("SELECT Items.ItemKey, PriceListsLastDateWithSub.Price") +
           QStringLiteral(", PriceListsLastDateWithSub.CurrencyCode") +
           QStringLiteral(" FROM Items, PriceListsLastDateWithSub") +
           QStringLiteral(" Where PriceListsLastDateWithSub.ItemKey = Items.ItemKey") +
           QStringLiteral(" And PriceListsLastDateWithSub.PriceListNumber = ") +
           QString::number(priceListId) + criteria.value();
}

Result<QString> buildExtraNoteStatement(const CatalogSettings &settings, std::int32_t extraNoteId)
{
    Result<QString> criteria = BuildSourceDBCriteria(settings);
    if (!criteria)
        return criteria.status();
    return QStringLiteral("SELECT Items.ItemKey, ExtraNotes.Note") +
           QStringLiteral(" FROM Items, ExtraNotes") + QStringLiteral(" Where ExtraNotes.ItemFlag = 1") +
           QStringLiteral(" And ExtraNotes.KeF = Items.ItemKey") +
           QStringLiteral(" And ExtraNotes.NoteID = ") + QString::number(extraNoteId) + criteria.value();
}

QString buildSortGroupStatement()
{
    return QStringLiteral("SELECT ItemSortCode, SortCodeName") + QStringLiteral(" FROM ItemSortNames") +
           QStringLiteral(" WHERE Not (ItemSortCode Is Null)");
}

} // namespace zorbin
