#include "StepClock.h"

#include <QCoreApplication>
#include <cstdio>

namespace zorbin::bench {

void StepClock::start()
{
    m_steps.clear();
    m_messages = 0;
    m_yields = 0;
    m_eventRounds = 0;
    m_yieldNanoseconds = 0;
    m_clock.start();
    m_stepStart = m_clock.nsecsElapsed();
}

void StepClock::closeStep()
{
    const qint64 now = m_clock.nsecsElapsed();
    if (!m_steps.empty())
        m_steps.back().seconds = static_cast<double>(now - m_stepStart) / 1e9;
    m_stepStart = now;
}

void StepClock::finish()
{
    closeStep();
}

void StepClock::tell(const QString &text, const QString &title, MessageIcon)
{
    ++m_messages;
    std::fprintf(stderr, "%s: %s\n", qPrintable(title), qPrintable(text));
}

void StepClock::showStatus(const QString &text)
{
    closeStep();
    m_steps.push_back({text, 0});
}

void StepClock::yield()
{
    ++m_yields;
    const qint64 before = m_clock.nsecsElapsed();
    if (!m_events.due())
        return;
    QCoreApplication::processEvents();
    ++m_eventRounds;
    m_yieldNanoseconds += m_clock.nsecsElapsed() - before;
}

} // namespace zorbin::bench
