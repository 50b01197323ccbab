#include "control/Statements.h"

#include "model/CatalogSettings.h"
#include "model/RunContext.h"
#include "output/CatalogQuery.h"
#include "source/ConnectionString.h"
#include "workdb/CollectionRun.h"
#include "workdb/SourceStatements.h"

namespace zorbin {
namespace {

// The number of the entry chosen in a list whose step the settings enable; the collection's
// own fault when nothing is chosen.
Result<std::int32_t> chosenNumber(const ChoiceList &list, const QString &what)
{
    if (const auto number = list.currentItemData())
        return *number;
    return nothingChosen(what);
}

} // namespace

Result<std::vector<std::pair<QString, QString>>> runStatements(RunContext &context)
{
    const CatalogSettings &settings = context.settings;
    std::vector<std::pair<QString, QString>> statements;
    statements.emplace_back(QStringLiteral("connection"),
                            maskConnStringPassword(BuildConnString(context.connection)));

    const auto items = buildItemStatement(settings);
    if (!items)
        return items.status();
    statements.emplace_back(QStringLiteral("items"), items.value());
    statements.emplace_back(QStringLiteral("sort-groups"), buildSortGroupStatement());

    struct Step
    {
        const char *label;
        CheckValue use;
        const ChoiceList &list;
        const char16_t *what;
        bool price;
    };
    const Step steps[] = {
        {"price1", settings.chkUsePriceField, settings.cmbPriceField, u"מחירון ראשי", true},
        {"price2", settings.ChkUsePriceField2, settings.cmbPriceField2, u"מחירון משני", true},
        {"note1", settings.ChkUseExtraNote1, settings.cmbExtraNote1, u"נתון נוסף 1", false},
        {"note2", settings.ChkUseExtraNote2, settings.cmbExtraNote2, u"נתון נוסף 2", false},
    };
    for (const Step &step : steps) {
        if (!isTicked(step.use))
            continue;
        const auto number = chosenNumber(step.list, QString::fromUtf16(step.what));
        if (!number)
            return number.status();
        const auto statement = step.price ? buildPriceStatement(settings, number.value())
                                          : buildExtraNoteStatement(settings, number.value());
        if (!statement)
            return statement.status();
        statements.emplace_back(QLatin1String(step.label), statement.value());
    }

    const auto catalog = BuildFinalSQL(settings);
    if (!catalog)
        return catalog.status();
    statements.emplace_back(QStringLiteral("catalog"), catalog.value());
    return statements;
}

} // namespace zorbin
