#pragma once

#include "model/UserPort.h"
#include "platform/EventPacer.h"

#include <functional>

class QLabel;
class QWidget;

namespace zorbin {

class ProgressStrip;

// The desktop program's answer to the core: right-to-left message boxes over the control, its
// status line and progress strip, the event loop for yielding, and a new browser window.
class WidgetUserPort final : public UserPort
{
public:
    // All widgets must outlive the port. `onBusy` enables and disables the control's buttons.
    WidgetUserPort(QWidget *owner, QLabel *statusLine, ProgressStrip *progress,
                   std::function<void(bool)> onBusy);

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
    QWidget *m_owner;
    QLabel *m_statusLine;
    ProgressStrip *m_progress;
    std::function<void(bool)> m_onBusy;
    EventPacer m_events;
};

} // namespace zorbin
