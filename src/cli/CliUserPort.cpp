#include "cli/CliUserPort.h"

#include "platform/Browser.h"

#include <cstdio>

namespace zorbin {

CliUserPort::CliUserPort(Browser *browser) : m_err(stderr), m_browser(browser) {}

Answer CliUserPort::ask(const QString &text, const QString &title, QuestionButtons buttons)
{
    // Each subcommand is itself the confirmation of its run: the command line never asks.
    Q_UNUSED(buttons);
    m_err << title << ": " << text << " -> yes\n";
    m_err.flush();
    return Answer::Yes;
}

void CliUserPort::tell(const QString &text, const QString &title, MessageIcon icon)
{
    Q_UNUSED(icon);
    m_err << title << ": " << text << '\n';
    m_err.flush();
}

void CliUserPort::showStatus(const QString &text)
{
    if (text.isEmpty())
        return;
    m_err << text << '\n';
    m_err.flush();
}

Status CliUserPort::openBrowser(const QString &file)
{
    return m_browser ? m_browser->openWindow(file) : Status::ok();
}

} // namespace zorbin
