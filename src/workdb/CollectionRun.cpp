#include "workdb/CollectionRun.h"

#include "model/CatalogSettings.h"
#include "model/RunContext.h"
#include "model/RunState.h"
#include "model/UserPort.h"
#include "workdb/CollectionLock.h"
#include "workdb/CollectionSteps.h"
#include "workdb/WorkDatabase.h"
#include "workdb/WorkDatabasePath.h"

namespace zorbin {

Status nothingChosen(const QString &what)
{
    return Status::fault(QStringLiteral("סומן לאסוף %1, אך לא נבחר ברשימה איזה. "
                                        "יש לבחור אותו בלשונית \"הגדרות נתונים\" או לבטל את הסימון.")
                             .arg(what));
}

std::span<const ChosenList> chosenLists()
{
    static const ChosenList lists[] = {
        {&CatalogSettings::collectPrice1, &CatalogSettings::priceList1, true, 1, u"סורק מחירון ראשי",
         u"מחירון ראשי"},
        {&CatalogSettings::collectPrice2, &CatalogSettings::priceList2, true, 2, u"סורק מחירון משני",
         u"מחירון משני"},
        {&CatalogSettings::collectNote1, &CatalogSettings::extraNote1, false, 1, u"סורק נתון נוסף 1",
         u"נתון נוסף 1"},
        {&CatalogSettings::collectNote2, &CatalogSettings::extraNote2, false, 2, u"סורק נתון נוסף 2",
         u"נתון נוסף 2"},
    };
    return lists;
}

Result<CollectionReport> BuildAndCollectData(RunContext &context)
{
    Result<std::unique_ptr<CollectionLock>> lock = CollectionLock::acquire(workDatabasePath());
    if (!lock)
        return lock.status();
    RunState &state = context.state;
    const CatalogSettings &settings = context.settings;

    context.user.showStatus(QStringLiteral("מאתחל בסיס נתונים זמני"));
    // The last collection's database goes first, so no run reads it as this collection's.
    state.WorkDBFile.clear();
    Result<QString> created = CreateWorkDB(context);
    if (!created)
        return created.status();
    state.WorkDBFile = created.value();
    const QString &db = state.WorkDBFile;
    // The stop request stays set once made, so every later step ends at its first progress point.
    auto report = [&state](Status failure) {
        return CollectionReport{std::move(failure), state.StopRequested};
    };

    context.user.showStatus(QStringLiteral("סורק את רשימת הפריטים"));
    if (Status items = FillDBItem7(context, db); !items)
        return report(items);

    context.user.showStatus(QStringLiteral("סורק קודי מיון"));
    if (Status groups = FillDBItemSort7(context, db); !groups)
        return report(groups);

    for (const ChosenList &chosen : chosenLists()) {
        if (!(settings.*chosen.collect))
            continue;
        context.user.showStatus(QString::fromUtf16(chosen.status));
        const std::optional<std::int32_t> number = (settings.*chosen.list).currentItemData();
        if (!number)
            return nothingChosen(QString::fromUtf16(chosen.name));
        const Status filled = chosen.price ? FillDBItemPrice(context, db, chosen.digit, *number)
                                           : FillDBItemExtraNote(context, db, chosen.digit, *number);
        if (!filled)
            return report(filled);
    }

    context.user.showStatus(QStringLiteral("סריקת הנתונים הסתיימה"));
    return report(Status::ok());
}

} // namespace zorbin
