#pragma once

#include "Analysis/Cell.h"

#include <deque>
#include <string>
#include <string_view>
#include <unordered_map>

namespace spectrel {

/// The paths that answers come from, each under one number for as long as the table lives. It grows with the number of
/// different paths, not with time.
class PathTable {
public:
    PathNumber numberOf(std::string_view path);
    /// Empty for 0.
    const std::string& pathOf(PathNumber number) const;

private:
    std::deque<std::string> _paths; // where they stay
    std::unordered_map<std::string_view, PathNumber> _numbers;
};

} // namespace spectrel
