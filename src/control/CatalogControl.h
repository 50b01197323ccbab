#pragma once

#include "common/Status.h"
#include "model/CatalogSettings.h"
#include "control/CatalogStages.h"
#include "model/RunContext.h"
#include "model/RunState.h"
#include "model/SettingsPersistence.h"
#include "model/ConnectionParams.h"

#include <functional>
#include <memory>

namespace zorbin {

class FileSystem;
class SettingsStore;
class UserPort;

// How a run ended.
struct RunOutcome
{
    enum class Ending {
        Declined, // the user did not confirm, or another run was in progress
        Shown,    // the output was written and opened (or, without a browser, written)
        NoItems,  // the catalog query had no rows: nothing to show
        Failed,   // a fault ended the run; the user has been told
    };
    Ending ending = Ending::Declined;
    QString file;        // the page that was (or would have been) shown
    QString description; // the fault's text when Failed
};

// The catalog control without its widgets: the settings record, the connection parameters and
// the run state, the start-up, the two runs and the stop request. The settings page (or the
// command line) owns one, binds to its records and forwards the button presses.
//
// Runs are synchronous; they yield to the host through the UserPort at their progress points.
// While one runs, another start is refused and the host is told to disable its buttons.
class CatalogControl
{
public:
    using StagesFactory = std::function<std::unique_ptr<CatalogStages>(RunContext &, SettingsStore &)>;

    // `user`, `store` and `files` must outlive the control. Without a factory the standard
    // stages (source, working database, output writers) are used.
    CatalogControl(UserPort &user, SettingsStore &store, FileSystem &files, StagesFactory stages = {});
    ~CatalogControl();

    CatalogSettings &settings() { return m_settings; }
    ConnectionParams &connection() { return m_connection; }
    RunState &runState() { return m_state; }
    RunContext &context() { return m_context; }
    SettingsStore &store() { return m_store; }
    SettingsPersistence &persistence() { return m_persistence; }
    CatalogStages &stages() { return *m_stages; }
    bool isRunning() const { return m_running; }

    // Start-up: each step runs even when an earlier one failed, and none shows a message.
    // The host then brings its item-range tab to the front.
    void UserControl_Initialize();

    // The save button.
    void CmdDef_Click();
    // The stop button: sets the stop request and yields once.
    void cmdStop_Click();

    // The catalog run: asks, collects unless the items were marked by hand, writes the
    // catalog and opens its first page.
    RunOutcome cmdRunMailing_Click();
    // The item-list run: asks when the items were marked by hand, writes and opens the list.
    RunOutcome CmdPreview_Click();

    // The two runs after their question, for front ends that confirm in their own way.
    RunOutcome produceCatalog();
    RunOutcome produceList(bool collect);
    // A collection run on its own (the item-selection button uses it).
    Status collect();

private:
    class BusyScope;

    RunOutcome CreateCatalog();
    RunOutcome fail(const Status &status);
    RunOutcome show(const QString &file);

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
