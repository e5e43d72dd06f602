#pragma once

#include <algorithm>
#include <chrono>

namespace spectrel {

/// Seconds that the work takes, the best of a few runs: the floor that a benchmark in the same process is held against.
template <typename Work> double bestSeconds(Work work, int runs = 7)
{
    double best = 1e9;
    for (int run = 0; run < runs; ++run) {
        const auto start = std::chrono::steady_clock::now();
        work();
        best = std::min(best, std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count());
    }
    return best;
}

} // namespace spectrel
