#include "workdb/CollectionSteps.h"

#include "model/CatalogSettings.h"
#include "model/RunContext.h"
#include "platform/Paths.h"
#include "workdb/CopyLoop.h"
#include "workdb/SourceStatements.h"
#include "workdb/WorkSchema.h"

namespace zorbin {
namespace {

const QString MissingText = QStringLiteral("?");
const QString Shekel = QStringLiteral("ש\"ח");

CopiedColumn asRead(const char *target, const char *source)
{
    return {QLatin1String(target), QLatin1String(source), {}};
}

CopiedColumn textOr(const char *target, const char *source, const QString &defaultText)
{
    return {QLatin1String(target), QLatin1String(source),
            [defaultText](const QVariant &value, const QString &) {
                return QVariant(TextOrDefault(value, defaultText));
            }};
}

CopiedColumn keyText()
{
    return {QStringLiteral("ItemKey"), QString(),
            [](const QVariant &, const QString &key) { return QVariant(key); }};
}

// The picture reference of picture source 1: the folder, a separator unless it ends in one (an
// empty folder included), the key and the extension, the two boxes read for every row.
CopiedColumn pictureByKey(const CatalogSettings &settings)
{
    return {QStringLiteral("ItemPic"), QString(),
            [&settings](const QVariant &, const QString &key) {
                QString folder = settings.pictureFolder;
                if (!folder.endsWith(pathSeparator()))
                    folder += pathSeparator();
                return QVariant(folder + key + settings.pictureExtension);
            },
            true};
}

} // namespace

QString TextOrDefault(const QVariant &value, const QString &defaultText)
{
    return value.isNull() ? defaultText : value.toString();
}

Status FillDBItem7(RunContext &context, const QString &pDBFile)
{
    const CatalogSettings &settings = context.settings;
    Result<QString> statement = buildItemStatement(settings);
    if (!statement)
        return statement.status();
    const bool pictureFromKey = settings.pictureSource == PictureSource::ItemKey;
    CopyPlan plan{statement.value(),
                  QStringLiteral("tItems"),
                  {keyText(),
                   textOr("ItemName", "ItemDesc", MissingText),
                   asRead("ItemSort", "SortGroup"),
                   asRead("Filter", "Filter"),
                   textOr("Unit", "SalesUnit", MissingText),
                   pictureFromKey ? pictureByKey(settings) : textOr("ItemPic", "PicFile", MissingText),
                   {QStringLiteral("Include"), QString(),
                    [](const QVariant &, const QString &) { return QVariant(WorkTrue); }},
                   asRead("SellPrice", "Price"),
                   textOr("SellCoin", "Currency", MissingText)},
                  true};
    return runCopyLoop(context, pDBFile, plan);
}

namespace {

// The price and note steps: a table of items' keys and their values, named by its digit.
Status fillKeyedTable(RunContext &context, const QString &pDBFile, const Result<QString> &statement,
                      const QString &table, std::vector<CopiedColumn> values)
{
    if (!statement)
        return statement.status();
    values.insert(values.begin(), keyText());
    return runCopyLoop(context, pDBFile, CopyPlan{statement.value(), table, std::move(values), true});
}

} // namespace

Status FillDBItemPrice(RunContext &context, const QString &pDBFile, std::int16_t pPriceID,
                       std::int32_t pPriceListID)
{
    return fillKeyedTable(context, pDBFile, buildPriceStatement(context.settings, pPriceListID),
                          QStringLiteral("tItemPrice") + QString::number(pPriceID),
                          {textOr("Coin", "CurrencyCode", Shekel), asRead("Price", "Price")});
}

Status FillDBItemExtraNote(RunContext &context, const QString &pDBFile, std::int16_t pNoteFieldID,
                           std::int32_t pExtraNoteID)
{
    return fillKeyedTable(context, pDBFile, buildExtraNoteStatement(context.settings, pExtraNoteID),
                          QStringLiteral("tExtraNote") + QString::number(pNoteFieldID),
                          {textOr("ExtraNote", "Note", MissingText)});
}

Status FillDBItemSort7(RunContext &context, const QString &pDBFile)
{
    // A Null or empty name leaves SortName Null.
    const CopiedColumn name{QStringLiteral("SortName"), QStringLiteral("SortCodeName"),
                            [](const QVariant &value, const QString &) {
                                const QString text = TextOrDefault(value, QString());
                                return text.isEmpty() ? QVariant() : QVariant(text);
                            }};
    CopyPlan plan{buildSortGroupStatement(),
                  QStringLiteral("tItemSort"),
                  {asRead("ItemSort", "ItemSortCode"), name},
                  false};
    return runCopyLoop(context, pDBFile, plan);
}

} // namespace zorbin
