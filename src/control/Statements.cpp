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

    for (const ChosenList &chosen : chosenLists()) {
        if (!(settings.*chosen.collect))
            continue;
        const auto number = chosenNumber(settings.*chosen.list, QString::fromUtf16(chosen.name));
        if (!number)
            return number.status();
        const auto statement = chosen.price ? buildPriceStatement(settings, number.value())
                                            : buildExtraNoteStatement(settings, number.value());
        if (!statement)
            return statement.status();
        statements.emplace_back((chosen.price ? QStringLiteral("price") : QStringLiteral("note")) +
                                    QString::number(chosen.digit),
                                statement.value());
    }

    statements.emplace_back(QStringLiteral("catalog"), BuildFinalSQL(settings));
    return statements;
}

} // namespace zorbin
