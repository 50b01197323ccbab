#pragma once

#include <cstdint>

namespace zorbin {

struct RunState;
class UserPort;

// The progress protocol that every long step follows: the bar starts at 0; at each progress
// point it shows done / total of the frame (rounded half to even), the host handles its
// events, and the step learns whether the user asked to stop; a step that ends normally or by
// a stop puts the bar back to 0, while a step that fails leaves it where it was.
class ProgressMeter
{
public:
    // Most steps have a progress point after every fifth row.
    static constexpr std::int64_t Cadence = 5;

    ProgressMeter(UserPort &user, const RunState &state);

    void reset();
    // A progress point. Returns true when a stop was requested.
    bool point(std::int64_t done, std::int64_t total);
    // A progress point after every Cadence-th row: `done` rows so far. Returns true when the
    // step must stop; off the cadence it does nothing and returns false.
    bool tick(std::int64_t done, std::int64_t total);

private:
    UserPort &m_user;
    const RunState &m_state;
};

} // namespace zorbin
