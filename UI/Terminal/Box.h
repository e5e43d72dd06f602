#pragma once

#include "UI/Terminal/Grid.h"

#include <cstddef>
#include <string>
#include <vector>

namespace spectrel {

/// The lines of a text that a box has room for on a screen so high.
std::size_t boxRoom(int height);

/// The lines broken between words where a box on a screen so wide has no room for them; what goes on stands below the
/// last column of the line, the one after two blanks or more. ASCII only.
std::vector<std::string> brokenForBox(const std::vector<std::string>& lines, int width);

/// Draws a framed box in the middle, over what is there, the first line bold. `top` is the first line in sight where
/// not all fit; the frame shows that there are more. The smallest screens show no frame.
void drawBox(Grid& grid, const std::vector<std::string>& lines, std::size_t top);

} // namespace spectrel
