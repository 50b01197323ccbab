#pragma once

#include "common/Status.h"
#include "model/ChoiceList.h"
#include "model/ConnectionParams.h"

#include <QString>
#include <cstdint>

namespace zorbin {

class SettingsStore;

// The values of the connection dialog `frmLogon` and what its buttons do, without widgets: the
// dialog binds its widgets to one of these. Each opening of the dialog starts from a new form.
class LogonForm
{
public:
    LogonForm();
    LogonForm(const LogonForm &) = delete;
    LogonForm &operator=(const LogonForm &) = delete;

    // The dialog's widgets.
    QString txtConnServer;
    QString txtConnUID;
    QString txtConnPWD; // shown masked
    QString txtConnDatabase;
    ChoiceList CmbConnType; // "MS-SQL Server Via ODBC", "MS-SQL Server Via OLE-DB", "DAO 4.0 Via OLE-DB"
    QString LblMsg;         // the message line

    // The dialog opens: the four texts and the type (list index type - 1; none for type 0) from
    // the parameters. A type the list does not have leaves the list as it is.
    void Form_Load(const ConnectionParams &params);

    // The test: opens a connection with the form's values (not the parameters) and opens
    // "SELECT * FROM Accounts" without reading a row. `LblMsg` tells the outcome; a failure is
    // also returned, for the fault box. Nothing is saved.
    Status CmdCheck_Click();

    // OK: the parameters take the form's values (the type is the list index + 1, 0 for none)
    // and the five values are saved. The caller closes the dialog.
    void cmdOK_Click(ConnectionParams &params, SettingsStore &store);

    // Saves (1) or loads (2) the five values under the connection keys; each through
    // SetGetRegControlValue, a value that cannot be applied left as it was.
    void SetGetRegConnParams(std::uint8_t action, SettingsStore &store);

    // The connection string of the form's values.
    QString connectionString() const;
    // The kind the form's list selects: the list index + 1, none when no entry is selected.
    ConnectionKind connectionKind() const;

    static const QString RecommendTestText; // what `LblMsg` shows when the dialog opens
    static const QString TestSucceededText;
    static const QString TestFailedText;
    static const QString TestQuery;
};

} // namespace zorbin
