#include "dialogs/LogonDialog.h"

#include "model/ConnectionParams.h"
#include "model/UserPort.h"

#include <QApplication>
#include <QComboBox>
#include <QFormLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QMessageBox>
#include <QPushButton>
#include <QVBoxLayout>

namespace zorbin {
namespace {

QLineEdit *lineEdit(const QString &name, QWidget *parent)
{
    auto *edit = new QLineEdit(parent);
    edit->setObjectName(name);
    return edit;
}

QPushButton *button(const QString &name, const QString &caption, QWidget *parent)
{
    auto *push = new QPushButton(caption, parent);
    push->setObjectName(name);
    push->setAutoDefault(false);
    return push;
}

} // namespace

frmLogon::frmLogon(SettingsStore &store, ConnectionParams &params, QWidget *parent)
    : QDialog(parent), m_store(store), m_params(params)
{
    buildLayout();
    Form_Load();
}

frmLogon::~frmLogon() = default;

void frmLogon::buildLayout()
{
    setObjectName(QStringLiteral("frmLogon"));
    setWindowTitle(QStringLiteral("הגדרות התחברות לויזקאונט חלונות"));
    setLayoutDirection(Qt::RightToLeft);
    setModal(true);

    auto *frame = new QGroupBox(QStringLiteral("ערכי התחברות"), this);
    m_txtConnServer = lineEdit(QStringLiteral("txtConnServer"), frame);
    m_txtConnUID = lineEdit(QStringLiteral("txtConnUID"), frame);
    m_txtConnPWD = lineEdit(QStringLiteral("txtConnPWD"), frame);
    m_txtConnPWD->setEchoMode(QLineEdit::Password);
    // Every typed character shows as "*", whatever the style's own masking character.
    m_txtConnPWD->setStyleSheet(QStringLiteral("lineedit-password-character: 42"));
    m_txtConnDatabase = lineEdit(QStringLiteral("txtConnDatabase"), frame);
    m_CmbConnType = new QComboBox(frame);
    m_CmbConnType->setObjectName(QStringLiteral("CmbConnType"));
    m_CmbConnType->setModel(&m_form.CmbConnType);

    auto *fields = new QFormLayout(frame);
    fields->addRow(QStringLiteral("שרת נתונים:"), m_txtConnServer);
    fields->addRow(QStringLiteral("משתמש:"), m_txtConnUID);
    fields->addRow(QStringLiteral("סיסמה:"), m_txtConnPWD);
    fields->addRow(QStringLiteral("בסיס נתונים:"), m_txtConnDatabase);
    fields->addRow(QStringLiteral("סוג בסיס הנתונים:"), m_CmbConnType);

    m_LblMsg = new QLabel(this);
    m_LblMsg->setObjectName(QStringLiteral("LblMsg"));
    m_LblMsg->setWordWrap(true);

    m_CmdCheck = button(QStringLiteral("CmdCheck"), QStringLiteral("בדיקה"), this);
    m_cmdOK = button(QStringLiteral("cmdOK"), QStringLiteral("אישור"), this);
    m_cmdCancel = button(QStringLiteral("cmdCancel"), QStringLiteral("ביטול"), this);
    auto *buttons = new QHBoxLayout;
    buttons->addWidget(m_CmdCheck);
    buttons->addStretch();
    buttons->addWidget(m_cmdOK);
    buttons->addWidget(m_cmdCancel);

    auto *layout = new QVBoxLayout(this);
    layout->addWidget(frame);
    layout->addWidget(m_LblMsg);
    layout->addLayout(buttons);

    connect(m_CmdCheck, &QPushButton::clicked, this, &frmLogon::CmdCheck_Click);
    connect(m_cmdOK, &QPushButton::clicked, this, &frmLogon::cmdOK_Click);
    connect(m_cmdCancel, &QPushButton::clicked, this, &frmLogon::cmdCancel_Click);
}

void frmLogon::showForm()
{
    m_txtConnServer->setText(m_form.txtConnServer);
    m_txtConnUID->setText(m_form.txtConnUID);
    m_txtConnPWD->setText(m_form.txtConnPWD);
    m_txtConnDatabase->setText(m_form.txtConnDatabase);
    m_CmbConnType->setCurrentIndex(m_form.CmbConnType.currentIndex());
    m_LblMsg->setText(m_form.LblMsg);
}

void frmLogon::takeWidgets()
{
    m_form.txtConnServer = m_txtConnServer->text();
    m_form.txtConnUID = m_txtConnUID->text();
    m_form.txtConnPWD = m_txtConnPWD->text();
    m_form.txtConnDatabase = m_txtConnDatabase->text();
    m_form.CmbConnType.setCurrentIndex(m_CmbConnType->currentIndex());
}

void frmLogon::Form_Load()
{
    m_form.Form_Load(m_params);
    showForm();
}

void frmLogon::CmdCheck_Click()
{
    takeWidgets();
    QApplication::setOverrideCursor(Qt::WaitCursor);
    const Status outcome = m_form.CmdCheck_Click();
    QApplication::restoreOverrideCursor();
    m_LblMsg->setText(m_form.LblMsg);
    if (outcome)
        return;
    QMessageBox box(QMessageBox::Critical, FaultTitle, outcome.description(), QMessageBox::Ok, this);
    box.setLayoutDirection(Qt::RightToLeft);
    box.exec();
}

void frmLogon::cmdOK_Click()
{
    takeWidgets();
    m_form.cmdOK_Click(m_params, m_store);
    accept();
}

void frmLogon::cmdCancel_Click()
{
    reject();
}

} // namespace zorbin
