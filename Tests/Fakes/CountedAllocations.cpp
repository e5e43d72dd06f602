#include "Tests/Fakes/CountedAllocations.h"

#include <cstdlib>
#include <new>

namespace {
std::size_t allocations = 0;
}

std::size_t spectrel::allocationCount()
{
    return allocations;
}

void* operator new(std::size_t size)
{
    ++allocations;
    if (void* const memory = std::malloc(size ? size : 1))
        return memory;
    throw std::bad_alloc();
}
void operator delete(void* memory) noexcept
{
    std::free(memory);
}
void operator delete(void* memory, std::size_t) noexcept
{
    std::free(memory);
}
