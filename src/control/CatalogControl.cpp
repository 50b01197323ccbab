#include "control/CatalogControl.h"

#include "output/OutputFolder.h"
#include "model/SettingsValidation.h"
#include "control/StandardStages.h"
#include "model/UserPort.h"
#include "platform/FileSystem.h"

namespace zorbin {
namespace {

const QString CatalogQuestion = QStringLiteral("להתחיל בהכנת הקטלוג?");
const QString CatalogQuestionTitle = QStringLiteral("שאלה חשובה");
const QString RescanQuestion = QStringLiteral("לסרוק מחדש את הפריטים?");
const QString RescanQuestionTitle = QStringLiteral("שים לב");
const QString NoItemsText = QStringLiteral(
    "אין בקטלוג פריטים: אף פריט אינו עונה על ההגדרות שנבחרו. יש לבדוק את טווח הפריטים ואת הפריטים המסומנים.");
const QString NoItemsTitle = QStringLiteral("הקטלוג ריק");
const QString NoWorkDatabaseText = QStringLiteral(
    "עדיין לא נאספו פריטים: יש ללחוץ על \"בחירת פריטים...\" או לבטל את הסימון של בחירת הפריטים, ואז לנסות שוב.");

} // namespace

// Marks a run in progress for its whole length, whichever way it ends.
class CatalogControl::BusyScope
{
public:
    explicit BusyScope(CatalogControl &control) : m_control(control)
    {
        m_control.m_running = true;
        m_control.m_user.setBusy(true);
    }
    ~BusyScope()
    {
        m_control.m_running = false;
        m_control.m_user.setBusy(false);
    }
    BusyScope(const BusyScope &) = delete;
    BusyScope &operator=(const BusyScope &) = delete;

private:
    CatalogControl &m_control;
};

CatalogControl::CatalogControl(UserPort &user, SettingsStore &store, FileSystem &files, StagesFactory stages)
    : m_user(user), m_store(store),
      m_files(files), m_context{m_settings, m_connection, m_state, m_user, m_files},
      m_persistence(store, m_settings)
{
    m_stages = stages ? stages(m_context, m_store) : makeStandardStages(m_context, m_store);
}

CatalogControl::~CatalogControl() = default;

void CatalogControl::UserControl_Initialize()
{
    m_state.WorkDBFile.clear();
    m_stages->GetRegConnParams();
    m_stages->FillCmbExtraNote();
    m_stages->FillCmbPriceField();
    m_persistence.SetGetRegParams(LoadAction);
    m_persistence.GetSetFormLabDefs(LoadAction, StoreApp, StoreSection);
}

void CatalogControl::CmdDef_Click()
{
    if (m_running)
        return;
    m_persistence.CmdDef_Click();
}

void CatalogControl::cmdStop_Click()
{
    m_state.StopRequested = true;
    m_user.yield();
}

RunOutcome CatalogControl::cmdRunMailing_Click()
{
    if (m_running)
        return {};
    if (m_user.ask(CatalogQuestion, CatalogQuestionTitle, QuestionButtons::YesNo) != Answer::Yes)
        return {};
    return produceCatalog();
}

RunOutcome CatalogControl::CmdPreview_Click()
{
    if (m_running)
        return {};
    bool collectAnew = true;
    if (isTicked(m_settings.ChkSelectAccount)) {
        switch (m_user.ask(RescanQuestion, RescanQuestionTitle, QuestionButtons::YesNoCancel)) {
        case Answer::Yes:
            break;
        case Answer::No:
            collectAnew = false;
            break;
        case Answer::Cancel:
            return {};
        }
    }
    return produceList(collectAnew);
}

Status CatalogControl::collect()
{
    if (m_running)
        return Status::ok();
    BusyScope busy(*this);
    m_state.StopRequested = false;
    return m_stages->BuildAndCollectData();
}

RunOutcome CatalogControl::produceCatalog()
{
    if (m_running)
        return {};
    // A number the pages cannot use is named before anything is collected or deleted.
    if (const Status valid = validateNumericSettings(m_settings); !valid)
        return fail(valid);
    BusyScope busy(*this);
    // A stop pressed while idle must not cut this run short.
    m_state.StopRequested = false;
    if (!isTicked(m_settings.ChkSelectAccount)) {
        if (const Status collected = m_stages->BuildAndCollectData(); !collected)
            return fail(collected);
    }
    m_state.StopRequested = false;
    return CreateCatalog();
}

RunOutcome CatalogControl::CreateCatalog()
{
    if (m_state.WorkDBFile.isEmpty())
        return fail(Status::fault(NoWorkDatabaseText));
    const QString folder = outputFolderOf(m_settings);
    if (const Status made = ensureFolder(m_files, folder); !made)
        return fail(made);
    if (const Status cleaned = cleanCatalogOutput(m_files, folder); !cleaned)
        return fail(cleaned);
    const QString images = imagesFolderOf(folder);
    if (m_settings.cmbPageSplit.currentIndex() == 1) {
        if (const Status copied = m_stages->CollectCatImages(images, m_state.WorkDBFile); !copied)
            return fail(copied);
    }
    auto page = m_stages->CreateCatHTML(folder + PagePrefixName, m_state.WorkDBFile, images);
    if (!page)
        return fail(page.status());
    if (const Status styled = m_stages->CreateCSS(folder, true); !styled)
        return fail(styled);
    if (page.value().isEmpty()) {
        m_user.tell(NoItemsText, NoItemsTitle, MessageIcon::Information);
        return {RunOutcome::Ending::NoItems, {}, NoItemsText};
    }
    return show(page.value());
}

RunOutcome CatalogControl::produceList(bool collectAnew)
{
    if (m_running)
        return {};
    BusyScope busy(*this);
    m_state.StopRequested = false;
    if (collectAnew) {
        if (const Status collected = m_stages->BuildAndCollectData(); !collected)
            return fail(collected);
    }
    if (m_state.WorkDBFile.isEmpty())
        return fail(Status::fault(NoWorkDatabaseText));
    const QString folder = outputFolderOf(m_settings);
    if (const Status made = ensureFolder(m_files, folder); !made)
        return fail(made);
    const QString file = folder + ListPageName;
    if (const Status written = m_stages->CreateListHTML(file, m_state.WorkDBFile); !written)
        return fail(written);
    return show(file);
}

RunOutcome CatalogControl::fail(const Status &status)
{
    m_user.tell(status.description(), FaultTitle, MessageIcon::Critical);
    return {RunOutcome::Ending::Failed, {}, status.description()};
}

RunOutcome CatalogControl::show(const QString &file)
{
    if (const Status opened = m_user.openBrowser(file); !opened) {
        RunOutcome outcome = fail(opened);
        outcome.file = file;
        return outcome;
    }
    return {RunOutcome::Ending::Shown, file, {}};
}

} // namespace zorbin
