#include "card/WidgetUserPort.h"

#include "card/ProgressStrip.h"
#include "platform/Browser.h"

#include <QCoreApplication>
#include <QDesktopServices>
#include <QDir>
#include <QLabel>
#include <QMessageBox>
#include <QUrl>

namespace zorbin {
namespace {

QMessageBox::Icon boxIcon(MessageIcon icon)
{
    switch (icon) {
    case MessageIcon::Critical:
        return QMessageBox::Critical;
    case MessageIcon::Question:
        return QMessageBox::Question;
    case MessageIcon::Exclamation:
        return QMessageBox::Warning;
    case MessageIcon::Information:
        break;
    }
    return QMessageBox::Information;
}

} // namespace

void WidgetUserPort::attach(QWidget *owner, QLabel *statusLine, ProgressStrip *progress,
                            std::function<void(bool)> onBusy)
{
    m_owner = owner;
    m_statusLine = statusLine;
    m_progress = progress;
    m_onBusy = std::move(onBusy);
}

void WidgetUserPort::detach()
{
    attach(nullptr, nullptr, nullptr, {});
}

Answer WidgetUserPort::ask(const QString &text, const QString &title, QuestionButtons buttons)
{
    QMessageBox box(QMessageBox::Question, title, text, QMessageBox::Yes | QMessageBox::No, m_owner);
    if (buttons == QuestionButtons::YesNoCancel)
        box.setStandardButtons(QMessageBox::Yes | QMessageBox::No | QMessageBox::Cancel);
    box.setLayoutDirection(Qt::RightToLeft);
    box.setDefaultButton(QMessageBox::Yes);
    switch (box.exec()) {
    case QMessageBox::Yes:
        return Answer::Yes;
    case QMessageBox::No:
        return Answer::No;
    default:
        return Answer::Cancel;
    }
}

void WidgetUserPort::tell(const QString &text, const QString &title, MessageIcon icon)
{
    QMessageBox box(boxIcon(icon), title, text, QMessageBox::Ok, m_owner);
    box.setLayoutDirection(Qt::RightToLeft);
    box.exec();
}

void WidgetUserPort::showStatus(const QString &text)
{
    if (m_statusLine)
        m_statusLine->setText(text);
}

int WidgetUserPort::progressFrameWidth() const
{
    return m_progress ? m_progress->frameWidth() : 0;
}

int WidgetUserPort::progressFillWidth() const
{
    return m_progress ? m_progress->fillWidth() : 0;
}

void WidgetUserPort::setProgressFillWidth(int width)
{
    if (m_progress)
        m_progress->setFillWidth(width);
}

void WidgetUserPort::yield()
{
    if (m_events.due())
        QCoreApplication::processEvents();
}

Status WidgetUserPort::openBrowser(const QString &file)
{
    const Status opened = makeSystemBrowser()->openWindow(file);
    if (opened)
        return opened;
    // No browser program was found: the desktop may still know how to show the file.
    if (QDesktopServices::openUrl(QUrl::fromLocalFile(QDir::fromNativeSeparators(file))))
        return Status::ok();
    return opened;
}

void WidgetUserPort::setBusy(bool busy)
{
    if (m_onBusy)
        m_onBusy(busy);
}

} // namespace zorbin
