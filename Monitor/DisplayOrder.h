#pragma once

#include "Values/Dictionary.h"

#include <algorithm>
#include <string_view>
#include <vector>

namespace spectrel {

/// The marker that orders a dictionary's children by key; never a child itself.
inline constexpr std::string_view SortedMarker = "_sorted";

/// The name under which a key of a sorted dictionary is shown: the second of exactly two parts, the whole key
/// otherwise.
inline std::string_view sortedKeyName(std::string_view key)
{
    const std::size_t separator = key.find(';');
    const bool hasTwoParts =
        separator != std::string_view::npos && key.find(';', separator + 1) == std::string_view::npos;
    return hasTwoParts ? key.substr(separator + 1) : key;
}

/// Calls `visit(name, value)` for each child of a display dictionary, in the order and under the name in which it is
/// shown. Without the marker the order is the dictionary's own.
template <typename Visit> void forEachDisplayChild(const Dictionary& dictionary, Visit visit)
{
    if (!dictionary.contains(SortedMarker)) {
        for (const auto& [key, value] : dictionary.entries())
            visit(std::string_view(key), value);
        return;
    }
    std::vector<const Dictionary::Entry*> sorted;
    sorted.reserve(dictionary.count());
    for (const auto& entry : dictionary.entries()) {
        if (entry.key != SortedMarker)
            sorted.push_back(&entry);
    }
    std::ranges::sort(sorted, [](const auto* left, const auto* right) { return left->key < right->key; });
    for (const auto* entry : sorted)
        visit(sortedKeyName(entry->key), entry->value);
}

} // namespace spectrel
