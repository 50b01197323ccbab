#include "model/ProgressMeter.h"

#include "common/Numbers.h"
#include "model/RunState.h"
#include "model/UserPort.h"

#include <algorithm>

namespace zorbin {

ProgressMeter::ProgressMeter(UserPort &user, const RunState &state) : m_user(user), m_state(state) {}

void ProgressMeter::reset()
{
    m_user.setProgressFillWidth(0);
}

bool ProgressMeter::point(std::int64_t done, std::int64_t total)
{
    const std::int64_t scale = std::max<std::int64_t>(total, 1);
    // The product first, so that an exact half (5 of 8 on a frame of 100) stays exact.
    const double width = static_cast<double>(done * m_user.progressFrameWidth()) / static_cast<double>(scale);
    m_user.setProgressFillWidth(static_cast<int>(roundHalfEven(width)));
    m_user.yield();
    return m_state.StopRequested;
}

bool ProgressMeter::tick(std::int64_t done, std::int64_t total)
{
    if (done % Cadence != 0)
        return false;
    return point(done, total);
}

} // namespace zorbin
