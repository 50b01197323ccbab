#pragma once

namespace zorbin::bench {

// The process's peak resident memory in kB since start or the last resetPeakMemory()
// (Linux's VmHWM); -1 where it cannot be read.
long peakMemoryKb();
// Starts a new peak from the present use (Linux 4.0 and later); false when not possible.
bool resetPeakMemory();

} // namespace zorbin::bench
