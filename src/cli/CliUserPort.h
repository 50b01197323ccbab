#pragma once

#include "model/UserPort.h"

#include <QTextStream>

namespace zorbin {

class Browser;

// The command line's answer to the core: messages and status texts go to standard error,
// nothing waits for input, and the browser opens only when asked for.
class CliUserPort final : public UserPort
{
public:
    // `browser` null: a page to show is only reported, not opened.
    explicit CliUserPort(Browser *browser);

    Answer ask(const QString &text, const QString &title, QuestionButtons buttons) override;
    void tell(const QString &text, const QString &title, MessageIcon icon) override;
    void showStatus(const QString &text) override;
    int progressFrameWidth() const override { return 100; }
    int progressFillWidth() const override { return m_fill; }
    void setProgressFillWidth(int width) override { m_fill = width; }
    void yield() override {}
    Status openBrowser(const QString &file) override;

private:
    QTextStream m_err;
    Browser *m_browser;
    int m_fill = 0;
};

} // namespace zorbin
