#pragma once

#include "Values/Value.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// A column of a table: a leaf of the display tree, and what stands above it. Or the columns of the serving cell.
struct TableColumn {
    std::string path;
    std::string name;
    bool isServingCell = false;
};

/// "PATH[=NAME],...", where "cells" stands for the columns of the serving cell: a column without a name is named after
/// its path. A backslash takes the special meaning from a comma, an equals sign or a backslash behind it. None when a
/// path is missing.
std::optional<std::vector<TableColumn>> parseTableColumns(std::string_view text);

/// The text of the leaf at a path as the display tree shows it; none when there is no leaf. Where leaves share the
/// path, the last one's, as in the tree.
std::optional<std::string_view> leafAtPath(const Value& display, std::string_view path);

} // namespace spectrel
