#pragma once

#include "Monitor/SpectrelModelNode.h"

#include <cstddef>
#include <string>
#include <string_view>

namespace spectrel {

/// Appends the text with its control characters escaped as in C, so that it stays one harmless line.
void appendPlain(std::string_view text, std::string& out);

/// Appends one line of the indented tree: "NAME: VALUE", or "NAME" alone for an inner node (`value` null).
void appendTreeLine(std::string_view name, const std::string_view* value, std::size_t depth, std::string& out);

/// Appends the node with all below it, its own line first.
void appendNodeText(const SpectrelModelNode& node, std::string& out);

/// Appends all below the node, its children not indented; of a leaf its value. The root's text is that of
/// `decode --format tree`.
void appendTreeText(const SpectrelModelNode& node, std::string& out);

} // namespace spectrel
