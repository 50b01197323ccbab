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

namespace {

// A price list or extra note that the run collects when its check box is ticked.
struct ChosenList
{
    CheckValue CatalogSettings::*use;
    ChoiceList CatalogSettings::*list;
    void (*fill)(RunContext &, const QString &, std::int16_t, std::int32_t);
    std::int16_t digit;
    const char16_t *status;
    const char16_t *name;
};

// In the order of the run, which does not depend on the settings.
const ChosenList ChosenLists[] = {
    {&CatalogSettings::chkUsePriceField, &CatalogSettings::cmbPriceField, &FillDBItemPrice, 1,
     u"סורק מחירון ראשי", u"מחירון ראשי"},
    {&CatalogSettings::ChkUsePriceField2, &CatalogSettings::cmbPriceField2, &FillDBItemPrice, 2,
     u"סורק מחירון משני", u"מחירון משני"},
    {&CatalogSettings::ChkUseExtraNote1, &CatalogSettings::cmbExtraNote1, &FillDBItemExtraNote, 1,
     u"סורק נתון נוסף 1", u"נתון נוסף 1"},
    {&CatalogSettings::ChkUseExtraNote2, &CatalogSettings::cmbExtraNote2, &FillDBItemExtraNote, 2,
     u"סורק נתון נוסף 2", u"נתון נוסף 2"},
};

} // namespace

Status BuildAndCollectData(RunContext &context)
{
    Result<std::unique_ptr<CollectionLock>> lock = CollectionLock::acquire(workDatabasePath());
    if (!lock)
        return lock.status();
    RunState &state = context.state;
    CatalogSettings &settings = context.settings;
    state.CollectFailed = false;

    context.user.showStatus(QStringLiteral("מאתחל בסיס נתונים זמני"));
    state.WorkDBFile = CreateWorkDB(context);

    context.user.showStatus(QStringLiteral("סורק את רשימת הפריטים"));
    FillDBItem7(context, state.WorkDBFile);
    if (state.CollectFailed)
        return Status::ok();

    context.user.showStatus(QStringLiteral("סורק קודי מיון"));
    FillDBItemSort7(context, state.WorkDBFile);
    if (state.CollectFailed)
        return Status::ok();

    for (const ChosenList &chosen : ChosenLists) {
        if (!isTicked(settings.*chosen.use))
            continue;
        context.user.showStatus(QString::fromUtf16(chosen.status));
        const std::optional<std::int32_t> number = (settings.*chosen.list).currentItemData();
        if (!number)
            return nothingChosen(QString::fromUtf16(chosen.name));
        chosen.fill(context, state.WorkDBFile, chosen.digit, *number);
        if (state.CollectFailed)
            return Status::ok();
    }

    context.user.showStatus(QStringLiteral("סריקת הנתונים הסתיימה"));
    return Status::ok();
}

} // namespace zorbin
