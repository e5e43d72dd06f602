#pragma once

#include "Values/Value.h"

#include <string>

namespace spectrel {

/// A value in one line of its own exact form, the one that PropertyListCorpus.py writes, too: numbers as "i-5", reals
/// as the bits of their double "r3ff0000000000000", dates as whole seconds since 2001 "t763", texts and data in
/// hexadecimal "s6162" and "d00ff", "T" and "F", lists "[a,b]" and dictionaries "{key:value,...}" in their order.
std::string valueText(const Value& value);

} // namespace spectrel
