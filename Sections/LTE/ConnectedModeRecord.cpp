#include "Sections/LTE/ConnectedModeRecord.h"

#include "LogGenerator/Template/ArrayOutOfBoundsException.h"

namespace spectrel {

namespace {
constexpr std::size_t FirstEntry = 29;
constexpr std::size_t MeasuredEntrySize = 6;
constexpr std::size_t DetectedEntrySize = 2;
} // namespace

std::size_t ConnectedModeRecord::measuredNeighbour(std::size_t index) const
{
    if (index >= _measured)
        throw ArrayOutOfBoundsException();
    return FirstEntry + MeasuredEntrySize * index;
}

std::size_t ConnectedModeRecord::detectedCell(std::size_t index) const
{
    if (index >= _detected)
        throw ArrayOutOfBoundsException();
    return FirstEntry + MeasuredEntrySize * _measured + DetectedEntrySize * index;
}

} // namespace spectrel
