#pragma once

#include "Monitor/PathChoice.h"
#include "Values/Value.h"

#include <string>

namespace spectrel {

/// Of a display only the chosen leaves are printed, and the nodes above them; where all are chosen, every node.

/// Appends the display tree, indented, one line a node, for people. Control characters are shown escaped.
void appendTree(const Value& display, std::string& out, const PathChoice& paths = {});

/// Appends the display as one JSON value on one line, without a line end: dictionary → object with its children in the
/// order and under the names that the tree shows, list → array (of the chosen elements), text → string, anything else →
/// "(unknown)".
void appendJson(const Value& display, std::string& out, const PathChoice& paths = {});

} // namespace spectrel
