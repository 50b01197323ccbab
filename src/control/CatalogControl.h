#pragma once

#include "common/Status.h"
#include "control/CatalogStages.h"
#include "control/RunOutcome.h"
#include "model/CatalogSettings.h"
#include "model/ConnectionParams.h"
#include "model/RunContext.h"
#include "model/RunState.h"
#include "model/SettingsPersistence.h"

#include <functional>
#include <memory>

namespace zorbin {

class FileSystem;
class SettingsStore;
class UserPort;

// The catalog control without its widgets: the options, the connection parameters and the run
// state, the start-up, the runs and the stop request. The control alone decides, for every
// failure of a stage, whether the run warns and goes on or ends, and tells the user; the front
// ends (the settings page, the command line) forward the user's commands and read the outcome.
//
// Runs are synchronous; they yield to the host through the UserPort at their progress points.
// While one runs, another start is refused and the host is told to disable its buttons.
class CatalogControl
{
public:
    // `user`, `store` and `files` must outlive the control.
    CatalogControl(UserPort &user, SettingsStore &store, FileSystem &files,
                   std::unique_ptr<CatalogStages> stages);
    ~CatalogControl();
    CatalogControl(const CatalogControl &) = delete;
    CatalogControl &operator=(const CatalogControl &) = delete;

    CatalogSettings &settings() { return m_settings; }
    ConnectionParams &connection() { return m_connection; }
    RunState &runState() { return m_state; }
    RunContext &context() { return m_context; }
    SettingsStore &store() { return m_store; }
    SettingsPersistence &persistence() { return m_persistence; }
    bool isRunning() const { return m_running; }

    // Start-up: the connection, the lists from the accounting database, the stored options.
    // Each step runs even when an earlier one failed, and none shows a message.
    void startUp();
    // Writes the options and the line formats to the store.
    void saveSettings();
    // Sets the stop request and yields once; the step that runs ends at its next progress point.
    void requestStop();
    // The items marked by hand in the working database the last collection left (the command
    // line's --use-marked); no collection runs before the output.
    void useLastCollection();

    // The catalog: asks, then makeCatalog().
    RunOutcome askAndMakeCatalog();
    // The item list: asks whether to collect again when the items are marked by hand, then makeList().
    RunOutcome askAndMakeList();

    // Collects unless the items are marked by hand, writes the catalog and opens its first page.
    RunOutcome makeCatalog();
    // The catalog as a PDF: asks, then makePdf() on A4 paper into the output folder.
    RunOutcome askAndMakePdf();
    // Collects unless the items are marked by hand, writes the catalog as a PDF into `file`
    // (empty: PdfFileName in the output folder) and opens it.
    RunOutcome makePdf(PdfPageSize pageSize, const QString &file = {});
    // The web catalog: asks, then makeSite() into the output folder.
    RunOutcome askAndMakeSite();
    // Collects unless the items are marked by hand, writes the web catalog into `folder`
    // (empty: SiteFolderName in the output folder) and opens its first page.
    RunOutcome makeSite(const QString &folder = {});
    // Collects when asked to, writes the item list and opens it.
    RunOutcome makeList(bool collectAnew);
    // A collection on its own.
    RunOutcome collectItems();
    // Before the user marks items by hand: from now on the runs use the marked items; the items
    // are collected when no collection ran yet or the user asks to collect them again. The
    // outcome's file is the working database to mark the items in (empty when there is none).
    RunOutcome prepareMarking();

private:
    class BusyScope;

    // The collection of a run: nothing when it may go on (a failed step was told and noted in
    // `outcome`), the outcome that ends the run otherwise.
    std::optional<RunOutcome> collect(RunOutcome &outcome);
    // The road every form of the catalog takes: the grid checked before anything is touched,
    // the items collected unless they are marked by hand, the stop request cleared, and then
    // `write`, given the outcome so far, with the working database there.
    RunOutcome makeCatalogWith(const std::function<RunOutcome(RunOutcome)> &write);
    RunOutcome CreateCatalog(RunOutcome outcome);
    RunOutcome writePdf(RunOutcome outcome, PdfPageSize pageSize, const QString &file);
    RunOutcome writeSite(RunOutcome outcome, const QString &folder);
    // `given`, or `name` in the output folder, which is made when it is missing.
    Result<QString> inOutputFolder(const QString &given, const QString &name);
    // Ends a run whose writer was stopped: nothing new is shown.
    RunOutcome stopped(RunOutcome outcome);
    // The catalog query had no rows: the user is told, and nothing is shown.
    RunOutcome noItems(RunOutcome outcome);
    RunOutcome fail(const Status &status);
    RunOutcome show(const QString &file, RunOutcome outcome);

    UserPort &m_user;
    SettingsStore &m_store;
    FileSystem &m_files;
    CatalogSettings m_settings;
    ConnectionParams m_connection;
    RunState m_state;
    RunContext m_context;
    SettingsPersistence m_persistence;
    std::unique_ptr<CatalogStages> m_stages;
    bool m_running = false;
};

} // namespace zorbin
