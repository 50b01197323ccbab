#pragma once

#include "model/UserPort.h"

#include <QList>
#include <QStringList>
#include <functional>

namespace zorbin::test {

// A UserPort that records what the core said and asked, answers questions from a queue
// (Yes when the queue is empty), and runs a hook at each yield, where a test can press stop.
class RecordingUserPort final : public UserPort
{
public:
    struct Message
    {
        QString text;
        MessageIcon icon;
    };

    Answer ask(const QString &text, const QString &, QuestionButtons buttons) override
    {
        questions << text;
        questionButtons << buttons;
        return answers.isEmpty() ? Answer::Yes : answers.takeFirst();
    }
    void tell(const QString &text, const QString &, MessageIcon icon) override
    {
        messages << Message{text, icon};
    }
    void showStatus(const QString &text) override { statuses << text; }
    int progressFrameWidth() const override { return frameWidth; }
    int progressFillWidth() const override { return fillWidth; }
    void setProgressFillWidth(int width) override { widths << (fillWidth = width); }
    void yield() override
    {
        ++yields;
        if (onYield)
            onYield();
    }
    Status openBrowser(const QString &file) override
    {
        browsed << file;
        return browserResult;
    }
    void setBusy(bool busy) override { busyChanges << busy; }

    QList<Answer> answers;
    QStringList questions;
    QList<QuestionButtons> questionButtons;
    QList<Message> messages;
    QStringList statuses;
    int frameWidth = 1000;
    int fillWidth = 0;
    QList<int> widths;
    int yields = 0;
    std::function<void()> onYield;
    QStringList browsed;
    Status browserResult;
    QList<bool> busyChanges;
};

} // namespace zorbin::test
