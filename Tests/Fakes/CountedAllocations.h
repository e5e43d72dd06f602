#pragma once

#include <cstddef>

namespace spectrel {

/// How often the program has asked for memory so far. Counted in programs that have CountedAllocations.cpp among their
/// own sources.
std::size_t allocationCount();

} // namespace spectrel
