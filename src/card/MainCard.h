#pragma once

#include "card/CardContext.h"
#include "control/CatalogControl.h"

#include <QWidget>
#include <memory>

class QLabel;
class QPushButton;
class QTabWidget;

namespace zorbin {

class FileChooser;
class PageSetupTab;
class ProgressStrip;
class RangeTab;
class SettingsBinder;
class TitlesTab;
class GeneralTab;
class WidgetUserPort;

// The settings control: six tabs bound to the control's options, the command buttons, the
// status line and the progress bar. Its buttons are the control's commands.
//
// Created, it attaches its status line and progress bar to `user`, has the control start up
// (the connection, the lists from the accounting database, the stored options), shows the
// options, and opens on the item-range tab. While a run is in progress the run buttons, the save
// button and the settings are disabled and only the stop button works.
class MainCard : public QWidget
{
    Q_OBJECT

public:
    // `control` and `user` (the port the control was made with) must outlive the card.
    MainCard(CatalogControl &control, WidgetUserPort &user, QWidget *parent = nullptr);
    ~MainCard() override;

    CatalogControl &control() { return m_control; }
    QTabWidget *tabs() const { return m_tabs; }
    PageSetupTab *pageSetupTab() const { return m_pageSetupTab; }
    TitlesTab *titlesTab() const { return m_titlesTab; }
    RangeTab *rangeTab() const { return m_rangeTab; }
    GeneralTab *generalTab() const { return m_generalTab; }

    // Replaces the file dialogs (a test answers them); `chooser` must outlive the card.
    void setFileChooser(FileChooser &chooser);
    // The widgets show the settings record again (after the core changed it).
    void showSettings();
    bool isRunning() const { return m_control.isRunning(); }

    // Index of each tab of `SSTab1`.
    enum TabIndex {
        PageSetupPage = 0,
        TitlesPage = 1,
        DataPage = 2,
        RangePage = 3,
        AboutPage = 4,
        GeneralPage = 5
    };

Q_SIGNALS:
    // A run started (true) or ended (false).
    void busyChanged(bool busy);

private Q_SLOTS:
    void cmdRunMailing_Click();
    void CmdPreview_Click();
    void cmdRunPdf_Click();
    void cmdRunSite_Click();
    void cmdStop_Click();
    void CmdDef_Click();

private:
    void buildTabs();
    QLayout *buildCommands();
    void setBusy(bool busy);

    QTabWidget *m_tabs = nullptr;
    PageSetupTab *m_pageSetupTab = nullptr;
    TitlesTab *m_titlesTab = nullptr;
    RangeTab *m_rangeTab = nullptr;
    GeneralTab *m_generalTab = nullptr;
    QPushButton *m_cmdRunMailing = nullptr;
    QPushButton *m_CmdPreview = nullptr;
    QPushButton *m_cmdRunPdf = nullptr;
    QPushButton *m_cmdRunSite = nullptr;
    QPushButton *m_cmdStop = nullptr;
    QPushButton *m_CmdDef = nullptr;
    QLabel *m_Message1 = nullptr;
    ProgressStrip *m_progress = nullptr;
    CatalogControl &m_control;
    WidgetUserPort &m_user;
    std::unique_ptr<SettingsBinder> m_binder;
    std::unique_ptr<CardContext> m_context;
};

} // namespace zorbin
