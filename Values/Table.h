#pragma once

#include <algorithm>
#include <ranges>

namespace spectrel {

/// The first row of a small constant table whose `member` is `key`; null when there is none. For tables of a dozen
/// rows: looks at one after the other, so that the rows stand in the order that reads best.
template <std::ranges::contiguous_range Table, typename Key, typename Row, typename Member>
constexpr const Row* findRow(const Table& table, const Key& key, Member Row::*member)
{
    const auto found = std::ranges::find(table, key, member);
    return found == std::ranges::end(table) ? nullptr : &*found;
}

} // namespace spectrel
