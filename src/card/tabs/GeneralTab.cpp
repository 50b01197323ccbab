#include "card/tabs/GeneralTab.h"

#include "card/CardContext.h"
#include "card/FolderField.h"
#include "card/SettingsBinder.h"
#include "card/tabs/TabBuilding.h"
#include "control/CatalogControl.h"
#include "dialogs/LogonDialog.h"

#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLineEdit>
#include <QPushButton>
#include <QVBoxLayout>

namespace zorbin {

using tabs::named;

GeneralTab::GeneralTab(CardContext &context, QWidget *parent) : QWidget(parent), m_context(context)
{
    setObjectName(QStringLiteral("GeneralTab"));
    auto *outputGroup = new QGroupBox(QStringLiteral("פלט"), this);
    auto *folder = named<QLineEdit>(QStringLiteral("txtPagingPath"), outputGroup);
    context.binder.text(folder, QStringLiteral("PagingPath"));
    tabs::showLeftToRight(folder);
    folder->setPlaceholderText(QStringLiteral("ריק: המחיצה הזמנית של המשתמש"));
    auto *folderField =
        new FolderField(folder, QStringLiteral("cmdPagingPath"), QStringLiteral("בחירת מחיצת היעד לקטלוג"),
                        false, context, outputGroup);
    auto *outputLayout = new QGridLayout(outputGroup);
    tabs::addFieldRow(outputLayout, 0, QStringLiteral("מחיצת יעד לקטלוג:"), folder, folderField);
    outputLayout->setColumnStretch(1, 1);

    auto *sourceGroup = new QGroupBox(QStringLiteral("מקור הנתונים"), this);
    auto *connectButton = named<QPushButton>(QStringLiteral("CmdConnect"),
                                             QStringLiteral("הגדרות התחברות לויזקאונט"), sourceGroup);
    connect(connectButton, &QPushButton::clicked, this, &GeneralTab::CmdConnect_Click);
    auto *sourceLayout = new QHBoxLayout(sourceGroup);
    sourceLayout->addWidget(connectButton);
    sourceLayout->addStretch();

    auto *layout = new QVBoxLayout(this);
    layout->addWidget(outputGroup);
    layout->addWidget(sourceGroup);
    layout->addStretch();
}

void GeneralTab::CmdConnect_Click()
{
    // The dialog starts from the control's parameters each time; OK replaces and saves them.
    frmLogon dialog(m_context.control.store(), m_context.control.connection(), window());
    // Wide enough for a server folder or a database file name of some length.
    dialog.resize(dialog.sizeHint().expandedTo(QSize(520, 0)));
    dialog.exec();
}

} // namespace zorbin
