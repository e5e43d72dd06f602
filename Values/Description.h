#pragma once

#include "Values/Value.h"

#include <string>

namespace spectrel {

/// A value as one line for people: {"key": "text", "list": ["a"]}. Dictionaries keep their order; numbers, dates and
/// data are shown by kind and content (int 5, real 0.5, true, date 0, data 01ff); an absent value is "none".
std::string describe(const Value& value);

} // namespace spectrel
