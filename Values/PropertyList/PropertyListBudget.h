#pragma once

#include "Values/PropertyList/PropertyList.h"

#include <cstddef>

namespace spectrel {

/// What is left of the limits while one list is read.
class PropertyListBudget {
public:
    /// False when the list holds one value too many.
    bool takeValue()
    {
        return _values++ < PropertyListLimits::Values;
    }
    /// False when texts and data together grow too large.
    bool takeBytes(std::size_t count)
    {
        if (count > _bytesLeft)
            return false;
        _bytesLeft -= count;
        return true;
    }

private:
    std::size_t _values = 0;
    std::size_t _bytesLeft = PropertyListLimits::ExpandedBytes;
};

} // namespace spectrel
