#include "card/MainCard.h"

#include "card/CellLineEditor.h"
#include "card/FileChooser.h"
#include "card/ProgressStrip.h"
#include "card/SettingsBinder.h"
#include "card/WidgetUserPort.h"
#include "card/tabs/AboutTab.h"
#include "card/tabs/DataTab.h"
#include "card/tabs/GeneralTab.h"
#include "card/tabs/PageSetupTab.h"
#include "card/tabs/RangeTab.h"
#include "card/tabs/TitlesTab.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QTabWidget>
#include <QVBoxLayout>

namespace zorbin {

MainCard::MainCard(CatalogControl &control, WidgetUserPort &user, QWidget *parent)
    : QWidget(parent), m_control(control), m_user(user)
{
    setObjectName(QStringLiteral("MainCard"));
    setLayoutDirection(Qt::RightToLeft);

    m_Message1 = new QLabel(this);
    m_Message1->setObjectName(QStringLiteral("Message1"));
    m_Message1->setAccessibleName(QStringLiteral("שורת מצב"));
    m_progress = new ProgressStrip(this);
    m_user.attach(this, m_Message1, m_progress, [this](bool busy) { setBusy(busy); });
    m_binder = std::make_unique<SettingsBinder>(m_control.settings());
    m_context = std::make_unique<CardContext>(CardContext{m_control, *m_binder, &systemFileChooser()});

    buildTabs();
    auto *layout = new QVBoxLayout(this);
    layout->addWidget(m_tabs, 1);
    layout->addLayout(buildCommands());
    layout->addWidget(m_Message1);
    layout->addWidget(m_progress);

    m_control.startUp();
    m_binder->refresh();
    m_tabs->setCurrentIndex(RangePage);
}

MainCard::~MainCard()
{
    m_user.detach();
}

void MainCard::buildTabs()
{
    m_tabs = new QTabWidget(this);
    m_tabs->setObjectName(QStringLiteral("SSTab1"));
    m_tabs->setDocumentMode(false);
    m_pageSetupTab = new PageSetupTab(*m_context, m_tabs);
    m_titlesTab = new TitlesTab(*m_context, m_tabs);
    m_rangeTab = new RangeTab(*m_context, m_tabs);
    m_generalTab = new GeneralTab(*m_context, m_tabs);
    m_tabs->addTab(m_pageSetupTab, QStringLiteral("הגדרת עמוד בקטלוג"));
    m_tabs->addTab(m_titlesTab, QStringLiteral("כותרות לעמוד"));
    m_tabs->addTab(new DataTab(*m_context, m_tabs), QStringLiteral("הגדרות נתונים"));
    m_tabs->addTab(m_rangeTab, QStringLiteral("טווח הפריטים"));
    m_tabs->addTab(new AboutTab(m_tabs), QStringLiteral("אודות"));
    m_tabs->addTab(m_generalTab, QStringLiteral("כללי"));
    connect(m_tabs, &QTabWidget::currentChanged, this, [this](int index) {
        if (index == PageSetupPage)
            m_pageSetupTab->editor()->resetSelection();
    });
}

QLayout *MainCard::buildCommands()
{
    auto button = [this](const char *name, const QString &caption) {
        auto *created = new QPushButton(caption, this);
        created->setObjectName(QLatin1String(name));
        return created;
    };
    m_cmdRunMailing = button("cmdRunMailing", QStringLiteral("הצג קטלוג"));
    m_CmdPreview = button("CmdPreview", QStringLiteral("הצג רשימה"));
    m_cmdRunPdf = button("cmdRunPdf", QStringLiteral("הצג PDF"));
    m_cmdRunSite = button("cmdRunSite", QStringLiteral("הצג אתר"));
    m_cmdStop = button("cmdStop", QStringLiteral("עצור"));
    m_CmdDef = button("CmdDef", QStringLiteral("שמור הגדרות"));
    m_cmdRunMailing->setDefault(true);
    m_cmdStop->setEnabled(false);

    connect(m_cmdRunMailing, &QPushButton::clicked, this, &MainCard::cmdRunMailing_Click);
    connect(m_CmdPreview, &QPushButton::clicked, this, &MainCard::CmdPreview_Click);
    connect(m_cmdRunPdf, &QPushButton::clicked, this, &MainCard::cmdRunPdf_Click);
    connect(m_cmdRunSite, &QPushButton::clicked, this, &MainCard::cmdRunSite_Click);
    connect(m_cmdStop, &QPushButton::clicked, this, &MainCard::cmdStop_Click);
    connect(m_CmdDef, &QPushButton::clicked, this, &MainCard::CmdDef_Click);

    auto *buttons = new QHBoxLayout;
    buttons->addWidget(m_cmdRunMailing);
    buttons->addWidget(m_CmdPreview);
    buttons->addWidget(m_cmdRunPdf);
    buttons->addWidget(m_cmdRunSite);
    buttons->addWidget(m_cmdStop);
    buttons->addStretch();
    buttons->addWidget(m_CmdDef);
    return buttons;
}

void MainCard::cmdRunMailing_Click()
{
    m_control.askAndMakeCatalog();
}

void MainCard::CmdPreview_Click()
{
    m_control.askAndMakeList();
}

void MainCard::cmdRunPdf_Click()
{
    m_control.askAndMakePdf();
}

void MainCard::cmdRunSite_Click()
{
    m_control.askAndMakeSite();
}

void MainCard::cmdStop_Click()
{
    m_control.requestStop();
}

void MainCard::CmdDef_Click()
{
    m_control.saveSettings();
}

void MainCard::setFileChooser(FileChooser &chooser)
{
    m_context->files = &chooser;
}

void MainCard::showSettings()
{
    m_binder->refresh();
}

void MainCard::setBusy(bool busy)
{
    m_cmdRunMailing->setEnabled(!busy);
    m_CmdPreview->setEnabled(!busy);
    m_cmdRunPdf->setEnabled(!busy);
    m_cmdRunSite->setEnabled(!busy);
    m_CmdDef->setEnabled(!busy);
    m_cmdStop->setEnabled(busy);
    // The runs read the settings as they go: they stay as they were until the run ends.
    for (int i = 0; i < m_tabs->count(); ++i)
        m_tabs->widget(i)->setEnabled(!busy);
    if (!busy)
        m_binder->refresh();
    Q_EMIT busyChanged(busy);
}

} // namespace zorbin
