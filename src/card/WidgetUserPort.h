#pragma once

#include "model/UserPort.h"
#include "platform/EventPacer.h"

#include <functional>

class QLabel;
class QWidget;

namespace zorbin {

class ProgressStrip;

// The desktop program's answer to the core: right-to-left message boxes over the settings page,
// its status line and progress strip, the event loop for yielding, and a new browser window.
//
// The program makes the port before the page that shows it, since the control it is given to
// outlives the page; the page attaches its widgets and detaches them when it goes. While no page
// is attached, messages have no parent window and the status and progress are not shown.
class WidgetUserPort final : public UserPort
{
public:
    WidgetUserPort() = default;

    // The widgets must stay until detach(). `onBusy` enables and disables the page's buttons.
    void attach(QWidget *owner, QLabel *statusLine, ProgressStrip *progress,
                std::function<void(bool)> onBusy);
    void detach();

    Answer ask(const QString &text, const QString &title, QuestionButtons buttons) override;
    void tell(const QString &text, const QString &title, MessageIcon icon) override;
    void showStatus(const QString &text) override;
    int progressFrameWidth() const override;
    int progressFillWidth() const override;
    void setProgressFillWidth(int width) override;
    void yield() override;
    Status openBrowser(const QString &file) override;
    void setBusy(bool busy) override;

private:
    QWidget *m_owner = nullptr;
    QLabel *m_statusLine = nullptr;
    ProgressStrip *m_progress = nullptr;
    std::function<void(bool)> m_onBusy;
    EventPacer m_events;
};

} // namespace zorbin
