#pragma once

#include "control/CatalogControl.h"

#include <QWidget>

#include <memory>

class QLabel;
class QPushButton;
class QTabWidget;

namespace zorbin {

class ProgressStrip;
class WidgetUserPort;

// The settings control: six tabs bound to the control's settings record, the command buttons,
// the status line and the progress bar. It forwards the buttons to its CatalogControl.
class MainCard : public QWidget
{
    Q_OBJECT

public:
    // `store` must outlive the card. Without a factory the standard stages are used.
    explicit MainCard(SettingsStore &store, CatalogControl::StagesFactory stages = {}, QWidget *parent = nullptr);
    ~MainCard() override;

    CatalogControl &control() { return *m_control; }
    QTabWidget *tabs() const { return m_tabs; }

    // Index of each tab of `SSTab1`.
    enum Tab { PageSetupTab = 0, TitlesTab = 1, DataTab = 2, RangeTab = 3, AboutTab = 4, GeneralTab = 5 };

private:
    void buildLayout();
    void setBusy(bool busy);

    QTabWidget *m_tabs = nullptr;
    QPushButton *m_cmdRunMailing = nullptr;
    QPushButton *m_CmdPreview = nullptr;
    QPushButton *m_cmdStop = nullptr;
    QPushButton *m_CmdDef = nullptr;
    QLabel *m_Message1 = nullptr;
    ProgressStrip *m_progress = nullptr;
    std::unique_ptr<WidgetUserPort> m_user;
    std::unique_ptr<CatalogControl> m_control;
};

} // namespace zorbin
