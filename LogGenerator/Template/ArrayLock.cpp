#include "LogGenerator/Template/ArrayLock.h"

#include <cstdint>

namespace spectrel {

namespace {
std::uint8_t nesting = 0;
}

std::recursive_mutex& ArrayLock::mutex()
{
    static std::recursive_mutex lock;
    return lock;
}

void ArrayLock::lockArray()
{
    mutex().lock();
    ++nesting;
}

void ArrayLock::unlockArray()
{
    if (--nesting == 0)
        mutex().unlock();
}

} // namespace spectrel
