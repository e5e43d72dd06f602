#pragma once

#include <algorithm>
#include <time.h>

namespace spectrel {

/// Seconds of processor time, the process's own and the system's for it: other programs on the machine do not count.
inline double processorSeconds()
{
    timespec now {};
    ::clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &now);
    return static_cast<double>(now.tv_sec) + static_cast<double>(now.tv_nsec) * 1e-9;
}

/// Seconds of processor time that the work takes, the best of a few runs: the floor that a benchmark in the same
/// process is held against.
template <typename Work> double bestSeconds(Work work, int runs = 7)
{
    double best = 1e9;
    for (int run = 0; run < runs; ++run) {
        const double start = processorSeconds();
        work();
        best = std::min(best, processorSeconds() - start);
    }
    return best;
}

} // namespace spectrel
