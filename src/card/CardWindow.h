#pragma once

#include "control/CatalogControl.h"

#include <QMainWindow>

namespace zorbin {

class MainCard;
class WidgetUserPort;

// The desktop program's main window: it hosts the settings control.
//
// Closing the window while a run is in progress would pull the control away from under the run
// (the run yields to the event loop at its progress points): the close presses stop instead, and
// the window closes as soon as the run has ended.
class CardWindow : public QMainWindow
{
    Q_OBJECT

public:
    // `control` and `user` (the port the control was made with) must outlive the window.
    CardWindow(CatalogControl &control, WidgetUserPort &user, QWidget *parent = nullptr);

    MainCard *card() const { return m_card; }

protected:
    void closeEvent(QCloseEvent *event) override;

private:
    MainCard *m_card;
    bool m_closeAfterRun = false;
};

} // namespace zorbin
