#pragma once

#include "Values/Value.h"

#include <string>

namespace spectrel {

/// Appends the display tree, indented, one line a node, for people. Control characters are shown escaped.
void appendTree(const Value& display, std::string& out);

/// Appends the display as one JSON value on one line, without a line end: dictionary → object with its children in the
/// order and under the names that the tree shows, list → array, text → string, anything else → "(unknown)".
void appendJson(const Value& display, std::string& out);

} // namespace spectrel
