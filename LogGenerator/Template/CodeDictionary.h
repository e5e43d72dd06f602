#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace spectrel {

class Base;

/// Section name → section. A section entered later under the same name replaces the earlier one.
using ClassDictionary = std::map<std::string, Base*, std::less<>>;

using Subscribers = std::vector<Base*>;

/// Log code → the sections subscribed to it, in the order in which they registered.
///
/// Keys are the codes' decimal texts, as "%d" of the 32-bit code; they keep the order of their first registration.
class CodeDictionary {
public:
    void subscribe(std::uint32_t code, Base& section);
    /// Null for a code that nobody registered.
    const Subscribers* subscribers(std::uint32_t code) const;
    /// All keys, as decimal texts.
    std::vector<std::string> allKeys() const;

private:
    std::vector<std::uint32_t> _codes;
    std::unordered_map<std::uint32_t, Subscribers> _subscribers;
};

} // namespace spectrel
