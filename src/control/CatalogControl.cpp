#include "control/CatalogControl.h"

#include "model/GridSize.h"
#include "model/UserPort.h"
#include "output/OutputFolder.h"
#include "platform/FileSystem.h"
#include "workdb/WorkDatabasePath.h"

#include <QFileInfo>

namespace zorbin {
namespace {

const QString CatalogQuestion = QStringLiteral("להתחיל בהכנת הקטלוג?");
const QString CatalogQuestionTitle = QStringLiteral("שאלה חשובה");
const QString RescanQuestion = QStringLiteral("לסרוק מחדש את הפריטים?");
const QString RescanQuestionTitle = QStringLiteral("שים לב");
const QString MarkingRescanQuestion = QStringLiteral("לסרוק מחדש את רשימת הפריטים?");
const QString MarkingRescanTitle = QStringLiteral("שימו לב");
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

CatalogControl::CatalogControl(UserPort &user, SettingsStore &store, FileSystem &files,
                               std::unique_ptr<CatalogStages> stages)
    : m_user(user), m_store(store),
      m_files(files), m_context{m_settings, m_connection, m_state, m_user, m_files},
      m_persistence(store, m_settings), m_stages(std::move(stages))
{}

CatalogControl::~CatalogControl() = default;

void CatalogControl::startUp()
{
    m_state.WorkDBFile.clear();
    m_stages->GetRegConnParams(m_context);
    m_stages->FillCmbExtraNote(m_context);
    m_stages->FillCmbPriceField(m_context);
    m_persistence.SetGetRegParams(LoadAction);
    m_persistence.GetSetFormLabDefs(LoadAction, StoreApp, StoreSection);
}

void CatalogControl::saveSettings()
{
    if (m_running)
        return;
    m_persistence.saveAll();
}

void CatalogControl::requestStop()
{
    m_state.StopRequested = true;
    m_user.yield();
}

void CatalogControl::useLastCollection()
{
    m_settings.useMarkedItems = true;
    const QString path = workDatabasePath();
    m_state.WorkDBFile = QFileInfo(path).isFile() ? path : QString();
}

RunOutcome CatalogControl::askAndMakeCatalog()
{
    if (m_running)
        return {};
    if (m_user.ask(CatalogQuestion, CatalogQuestionTitle, QuestionButtons::YesNo) != Answer::Yes)
        return {};
    return makeCatalog();
}

RunOutcome CatalogControl::askAndMakeList()
{
    if (m_running)
        return {};
    bool collectAnew = true;
    if (m_settings.useMarkedItems) {
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
    return makeList(collectAnew);
}

std::optional<RunOutcome> CatalogControl::collect(RunOutcome &outcome)
{
    const Result<CollectionReport> report = m_stages->BuildAndCollectData(m_context);
    if (!report)
        return fail(report.status());
    if (const Status &failure = report->stepFailure; !failure) {
        // The rows collected before the failed step still make a catalog; the user hears why
        // it is not complete.
        m_user.tell(failure.description(), FaultTitle, MessageIcon::Information);
        outcome = {RunOutcome::Ending::Partial, {}, failure.description()};
    } else if (report->stopped) {
        outcome.ending = RunOutcome::Ending::Stopped;
    }
    return std::nullopt;
}

RunOutcome CatalogControl::collectItems()
{
    if (m_running)
        return {};
    BusyScope busy(*this);
    m_state.StopRequested = false;
    RunOutcome outcome{RunOutcome::Ending::Complete, {}, {}};
    if (auto ended = collect(outcome))
        return *ended;
    return outcome;
}

RunOutcome CatalogControl::prepareMarking()
{
    if (m_running)
        return {};
    m_settings.useMarkedItems = true;
    const bool collectAnew =
        m_state.WorkDBFile.isEmpty() ||
        m_user.ask(MarkingRescanQuestion, MarkingRescanTitle, QuestionButtons::YesNo) == Answer::Yes;
    RunOutcome outcome{RunOutcome::Ending::Complete, {}, {}};
    if (collectAnew)
        outcome = collectItems();
    outcome.file = m_state.WorkDBFile;
    return outcome;
}

RunOutcome CatalogControl::makeCatalog()
{
    return makeCatalogWith([this](RunOutcome outcome) { return CreateCatalog(outcome); });
}

RunOutcome CatalogControl::askAndMakePdf()
{
    if (m_running)
        return {};
    if (m_user.ask(CatalogQuestion, CatalogQuestionTitle, QuestionButtons::YesNo) != Answer::Yes)
        return {};
    return makePdf(PdfPageSize::A4);
}

RunOutcome CatalogControl::makePdf(PdfPageSize pageSize, const QString &file)
{
    return makeCatalogWith(
        [this, pageSize, &file](RunOutcome outcome) { return writePdf(outcome, pageSize, file); });
}

RunOutcome CatalogControl::askAndMakeSite()
{
    if (m_running)
        return {};
    if (m_user.ask(CatalogQuestion, CatalogQuestionTitle, QuestionButtons::YesNo) != Answer::Yes)
        return {};
    return makeSite();
}

RunOutcome CatalogControl::makeSite(const QString &folder)
{
    return makeCatalogWith([this, &folder](RunOutcome outcome) { return writeSite(outcome, folder); });
}

RunOutcome CatalogControl::makeCatalogWith(const std::function<RunOutcome(RunOutcome)> &write)
{
    if (m_running)
        return {};
    // A grid the catalog cannot use is named before anything is collected or deleted.
    if (const auto grid = readGridSize(m_settings); !grid)
        return fail(grid.status());
    BusyScope busy(*this);
    // A stop pressed while idle must not cut this run short.
    m_state.StopRequested = false;
    RunOutcome outcome{RunOutcome::Ending::Complete, {}, {}};
    if (!m_settings.useMarkedItems) {
        if (auto ended = collect(outcome))
            return *ended;
    }
    m_state.StopRequested = false;
    if (m_state.WorkDBFile.isEmpty())
        return fail(Status::fault(NoWorkDatabaseText));
    return write(outcome);
}

RunOutcome CatalogControl::CreateCatalog(RunOutcome outcome)
{
    const QString folder = outputFolderOf(m_settings);
    if (const Status made = ensureFolder(m_files, folder); !made)
        return fail(made);
    if (const Status cleaned = cleanCatalogOutput(m_files, folder); !cleaned)
        return fail(cleaned);
    const QString images = imagesFolderOf(folder);
    if (m_settings.pageSplit == PageSplit::FilePerPage) {
        if (const Status copied = m_stages->CollectCatImages(m_context, images, m_state.WorkDBFile); !copied)
            return fail(copied);
    }
    auto page = m_stages->CreateCatHTML(m_context, folder + PagePrefixName, m_state.WorkDBFile, images);
    if (!page)
        return fail(page.status());
    if (const Status styled = m_stages->CreateCSS(m_context, folder, true); !styled)
        return fail(styled);
    if (page.value().isEmpty())
        return noItems(outcome);
    return show(page.value(), outcome);
}

Result<QString> CatalogControl::inOutputFolder(const QString &given, const QString &name)
{
    if (!given.isEmpty())
        return given;
    const QString folder = outputFolderOf(m_settings);
    if (const Status made = ensureFolder(m_files, folder); !made)
        return made;
    return folder + name;
}

RunOutcome CatalogControl::writePdf(RunOutcome outcome, PdfPageSize pageSize, const QString &file)
{
    const Result<QString> target = inOutputFolder(file, PdfFileName);
    if (!target)
        return fail(target.status());
    const Result<PdfWritten> written =
        m_stages->CreateCatPDF(m_context, {target.value(), m_state.WorkDBFile, pageSize});
    if (!written)
        return fail(written.status());
    switch (written->ending) {
    case PdfWritten::Ending::NoItems:
        return noItems(outcome);
    case PdfWritten::Ending::Stopped:
        return stopped(outcome);
    case PdfWritten::Ending::Written:
        break;
    }
    return show(written->file, outcome);
}

RunOutcome CatalogControl::writeSite(RunOutcome outcome, const QString &folder)
{
    const Result<QString> target = inOutputFolder(folder, SiteFolderName);
    if (!target)
        return fail(target.status());
    const Result<QString> first =
        m_stages->CreateCatSite(m_context, {target.value(), m_state.WorkDBFile, m_settings.webSections});
    if (!first)
        return fail(first.status());
    if (m_state.StopRequested)
        return stopped(outcome);
    if (first->isEmpty())
        return noItems(outcome);
    return show(first.value(), outcome);
}

RunOutcome CatalogControl::stopped(RunOutcome outcome)
{
    // Nothing half-written is shown; what an earlier run wrote stays as it was.
    if (outcome.ending == RunOutcome::Ending::Complete)
        outcome.ending = RunOutcome::Ending::Stopped;
    return outcome;
}

RunOutcome CatalogControl::noItems(RunOutcome outcome)
{
    m_user.tell(NoItemsText, NoItemsTitle, MessageIcon::Information);
    if (outcome.ending != RunOutcome::Ending::Partial)
        outcome = {RunOutcome::Ending::NoItems, {}, NoItemsText};
    return outcome;
}

RunOutcome CatalogControl::makeList(bool collectAnew)
{
    if (m_running)
        return {};
    BusyScope busy(*this);
    m_state.StopRequested = false;
    RunOutcome outcome{RunOutcome::Ending::Complete, {}, {}};
    if (collectAnew) {
        if (auto ended = collect(outcome))
            return *ended;
    }
    if (m_state.WorkDBFile.isEmpty())
        return fail(Status::fault(NoWorkDatabaseText));
    const QString folder = outputFolderOf(m_settings);
    if (const Status made = ensureFolder(m_files, folder); !made)
        return fail(made);
    const QString file = folder + ListPageName;
    if (const Status written = m_stages->CreateListHTML(m_context, file, m_state.WorkDBFile); !written)
        return fail(written);
    return show(file, outcome);
}

RunOutcome CatalogControl::fail(const Status &status)
{
    m_user.tell(status.description(), FaultTitle, MessageIcon::Critical);
    return {RunOutcome::Ending::Failed, {}, status.description()};
}

RunOutcome CatalogControl::show(const QString &file, RunOutcome outcome)
{
    // A stop during the writing leaves a shorter result, which is still shown.
    if (m_state.StopRequested && outcome.ending == RunOutcome::Ending::Complete)
        outcome.ending = RunOutcome::Ending::Stopped;
    if (const Status opened = m_user.openBrowser(file); !opened) {
        outcome = fail(opened);
        outcome.file = file;
        return outcome;
    }
    outcome.file = file;
    return outcome;
}

} // namespace zorbin
