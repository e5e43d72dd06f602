#include "Sections/LTE/IdleNeighbourRecord.h"

#include "LogGenerator/Template/ArrayOutOfBoundsException.h"

namespace spectrel {

std::size_t IdleNeighbourRecord::neighbour(std::size_t index) const
{
    constexpr std::size_t FirstEntry = 21;
    constexpr std::size_t EntrySize = 20;
    if (index > _last)
        throw ArrayOutOfBoundsException();
    return FirstEntry + EntrySize * index;
}

} // namespace spectrel
