#pragma once

#include "common/Status.h"

#include <QString>

namespace zorbin {

enum class MessageIcon { Critical, Question, Exclamation, Information };
enum class QuestionButtons { YesNo, YesNoCancel };
enum class Answer { Yes, No, Cancel };

// Everything the core says to the user or asks of the screen during a run. The desktop program
// answers with message boxes, its status line, progress bar and event loop; the command line
// prints to standard error and never waits for input; tests record the calls.
class UserPort
{
public:
    virtual ~UserPort() = default;

    // A modal question with the question icon.
    virtual Answer ask(const QString &text, const QString &title, QuestionButtons buttons) = 0;
    // A modal message with an OK button.
    virtual void tell(const QString &text, const QString &title, MessageIcon icon) = 0;
    // The status line (`Message1`).
    virtual void showStatus(const QString &text) = 0;
    // The progress bar: the frame's width is the full scale; the fill shows the current step.
    virtual int progressFrameWidth() const = 0;
    virtual int progressFillWidth() const = 0;
    virtual void setProgressFillWidth(int width) = 0;
    // Lets the host handle pending events (repaint, clicks), so that the stop button can be pressed.
    virtual void yield() = 0;
    // Shows a local file in a new browser window.
    virtual Status openBrowser(const QString &file) = 0;
    // A run starts (true) or ends (false). While a run yields, the host must not let the user
    // start another one or save the settings.
    virtual void setBusy(bool busy) { Q_UNUSED(busy); }
};

// The title of the fault message box.
inline const QString FaultTitle = QStringLiteral("תקלה");

} // namespace zorbin
