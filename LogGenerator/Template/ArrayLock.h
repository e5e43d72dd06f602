#pragma once

#include <mutex>

namespace spectrel {

/// The process-wide recursive lock around every wholesale change of a displayed list and around the tree's walk of one.
class ArrayLock {
public:
    static void lockArray();
    /// Releases the lock once, and only when the nesting counter (8 bits, of all threads) returns to 0. Nested locking
    /// therefore leaves it held by its thread after the outermost call; kept on purpose. All users are on one thread.
    static void unlockArray();

    /// The lock itself, for asking whether it is free.
    static std::recursive_mutex& mutex();
};

} // namespace spectrel
