#pragma once

#include "dialogs/LogonForm.h"

#include <QDialog>

class QComboBox;
class QLabel;
class QLineEdit;
class QPushButton;

namespace zorbin {

class SettingsStore;
struct ConnectionParams;

// The connection dialog: the five connection values, a test of them and OK/Cancel. It opens on
// the control's parameters; OK replaces them and saves them to the store; Cancel changes
// nothing. The test uses the values typed in the dialog and saves nothing; a failed test shows
// the fault in a message box and leaves the dialog open.
//
// `store` and `params` must outlive the dialog. Widgets carry their system names as object names
// (txtConnServer, CmdCheck, LblMsg, ...).
class frmLogon : public QDialog
{
    Q_OBJECT

public:
    frmLogon(SettingsStore &store, ConnectionParams &params, QWidget *parent = nullptr);
    ~frmLogon() override;

    // The form the widgets show, for tests and for the handlers.
    LogonForm &form() { return m_form; }

    void Form_Load();
    void CmdCheck_Click();
    void cmdOK_Click();
    void cmdCancel_Click();

private:
    void buildLayout();
    void showForm();    // form -> widgets
    void takeWidgets(); // widgets -> form

    SettingsStore &m_store;
    ConnectionParams &m_params;
    LogonForm m_form;
    QLineEdit *m_txtConnServer = nullptr;
    QLineEdit *m_txtConnUID = nullptr;
    QLineEdit *m_txtConnPWD = nullptr;
    QLineEdit *m_txtConnDatabase = nullptr;
    QComboBox *m_CmbConnType = nullptr;
    QLabel *m_LblMsg = nullptr;
    QPushButton *m_CmdCheck = nullptr;
    QPushButton *m_cmdOK = nullptr;
    QPushButton *m_cmdCancel = nullptr;
};

} // namespace zorbin
