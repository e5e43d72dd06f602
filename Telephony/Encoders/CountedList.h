#pragma once

#include <algorithm>
#include <cstdint>
#include <span>
#include <vector>

namespace spectrel {

/// As many of a list as an 8-bit count can hold, the first 255.
template <typename Element> std::span<const Element> counted(std::span<const Element> list)
{
    return list.first(std::min<std::size_t>(list.size(), 255));
}

template <typename Element> std::span<const Element> counted(const std::vector<Element>& list)
{
    return counted(std::span(list));
}

/// Its count, as a field is written.
template <typename Element> std::uint32_t count(std::span<const Element> list)
{
    return static_cast<std::uint32_t>(list.size());
}

} // namespace spectrel
