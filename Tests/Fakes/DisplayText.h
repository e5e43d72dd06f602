#pragma once

#include "Values/Description.h"

namespace spectrel {

/// A value as one short text for comparisons.
inline std::string displayText(const Value& value)
{
    return describe(value);
}

} // namespace spectrel
