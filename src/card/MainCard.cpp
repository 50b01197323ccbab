#include "card/MainCard.h"

#include "card/ProgressStrip.h"
#include "card/WidgetUserPort.h"
#include "platform/FileSystem.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QTabWidget>
#include <QVBoxLayout>

namespace zorbin {

MainCard::MainCard(SettingsStore &store, CatalogControl::StagesFactory stages, QWidget *parent) : QWidget(parent)
{
    setObjectName(QStringLiteral("MainCard"));
    setLayoutDirection(Qt::RightToLeft);
    buildLayout();
    m_user = std::make_unique<WidgetUserPort>(this, m_Message1, m_progress, [this](bool busy) { setBusy(busy); });
    m_control = std::make_unique<CatalogControl>(*m_user, store, localFileSystem(), std::move(stages));
    m_control->UserControl_Initialize();
    m_tabs->setCurrentIndex(RangeTab);
}

MainCard::~MainCard() = default;

void MainCard::buildLayout()
{
    m_tabs = new QTabWidget(this);
    m_tabs->setObjectName(QStringLiteral("SSTab1"));
    const QStringList captions = {
        QStringLiteral("הגדרת עמוד בקטלוג"), QStringLiteral("כותרות לעמוד"), QStringLiteral("הגדרות נתונים"),
        QStringLiteral("טווח הפריטים"),      QStringLiteral("אודות"),        QStringLiteral("כללי"),
    };
    for (const QString &caption : captions)
        m_tabs->addTab(new QWidget(m_tabs), caption);

    auto button = [this](const char *name, const QString &caption) {
        auto *created = new QPushButton(caption, this);
        created->setObjectName(QLatin1String(name));
        return created;
    };
    m_cmdRunMailing = button("cmdRunMailing", QStringLiteral("הצג קטלוג"));
    m_CmdPreview = button("CmdPreview", QStringLiteral("הצג רשימה"));
    m_cmdStop = button("cmdStop", QStringLiteral("עצור"));
    m_CmdDef = button("CmdDef", QStringLiteral("שמור הגדרות"));
    m_cmdStop->setEnabled(false);

    m_Message1 = new QLabel(this);
    m_Message1->setObjectName(QStringLiteral("Message1"));
    m_progress = new ProgressStrip(this);

    auto *buttons = new QHBoxLayout;
    buttons->addWidget(m_cmdRunMailing);
    buttons->addWidget(m_CmdPreview);
    buttons->addWidget(m_cmdStop);
    buttons->addStretch();
    buttons->addWidget(m_CmdDef);

    auto *layout = new QVBoxLayout(this);
    layout->addWidget(m_tabs, 1);
    layout->addLayout(buttons);
    layout->addWidget(m_Message1);
    layout->addWidget(m_progress);

    connect(m_cmdRunMailing, &QPushButton::clicked, this, [this] { m_control->cmdRunMailing_Click(); });
    connect(m_CmdPreview, &QPushButton::clicked, this, [this] { m_control->CmdPreview_Click(); });
    connect(m_cmdStop, &QPushButton::clicked, this, [this] { m_control->cmdStop_Click(); });
    connect(m_CmdDef, &QPushButton::clicked, this, [this] { m_control->CmdDef_Click(); });
}

void MainCard::setBusy(bool busy)
{
    m_cmdRunMailing->setEnabled(!busy);
    m_CmdPreview->setEnabled(!busy);
    m_CmdDef->setEnabled(!busy);
    m_cmdStop->setEnabled(busy);
}

} // namespace zorbin
