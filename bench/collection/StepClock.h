#pragma once

#include "model/UserPort.h"
#include "platform/EventPacer.h"

#include <QElapsedTimer>
#include <QStringList>
#include <vector>

namespace zorbin::bench {

// A UserPort for timing a collection run: every status text starts a new step, whose length
// runs to the next text (the last to finish()). Messages go to standard error; yields let
// Qt handle its events, paced as the desktop program paces them.
class StepClock final : public UserPort
{
public:
    struct Step
    {
        QString text;
        double seconds = 0;
    };

    void start();
    void finish();
    const std::vector<Step> &steps() const { return m_steps; }
    int messageCount() const { return m_messages; }
    // The progress points and the time spent at them letting Qt handle its events.
    int yields() const { return m_yields; }
    int eventRounds() const { return m_eventRounds; }
    double yieldSeconds() const { return static_cast<double>(m_yieldNanoseconds) / 1e9; }

    Answer ask(const QString &, const QString &, QuestionButtons) override { return Answer::Yes; }
    void tell(const QString &text, const QString &title, MessageIcon icon) override;
    void showStatus(const QString &text) override;
    int progressFrameWidth() const override { return 1000; }
    int progressFillWidth() const override { return m_fill; }
    void setProgressFillWidth(int width) override { m_fill = width; }
    void yield() override;
    Status openBrowser(const QString &) override { return Status::ok(); }

private:
    void closeStep();

    QElapsedTimer m_clock;
    qint64 m_stepStart = 0;
    std::vector<Step> m_steps;
    int m_fill = 0;
    int m_messages = 0;
    int m_yields = 0;
    int m_eventRounds = 0;
    EventPacer m_events; // as the desktop program paces them
    qint64 m_yieldNanoseconds = 0;
};

} // namespace zorbin::bench
