#pragma once

#include <QElapsedTimer>

namespace zorbin {

// Decides when a long run's yield really hands the event loop its pending events. The runs
// yield at every fifth row, tens of thousands of times a second; handling the events that often
// costs more than the rows themselves, while a window repainted a hundred times a second and a
// stop button answered within a hundredth of a second look and feel the same to a person.
class EventPacer
{
public:
    static constexpr int DefaultIntervalMs = 10;

    explicit EventPacer(int intervalMs = DefaultIntervalMs) : m_intervalNs(qint64(intervalMs) * 1000000) {}

    // True at the first call and whenever the interval has passed since the last true.
    bool due()
    {
        if (m_clock.isValid() && m_clock.nsecsElapsed() < m_intervalNs)
            return false;
        m_clock.start();
        return true;
    }

private:
    const qint64 m_intervalNs;
    QElapsedTimer m_clock;
};

} // namespace zorbin
