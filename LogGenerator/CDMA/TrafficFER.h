#pragma once

#include "Values/Dictionary.h"
#include "Values/Value.h"

namespace spectrel {

/// The average share of bad 1x traffic frames, 0 to 1, lives in the state while there is traffic.

/// Adds a frame to the average and shows it: "%.02f%%".
void updateTrafficFER(bool isFrameBad, Dictionary& state, const Value& lookup);
/// Shows the last average once more, marked "(old)", and forgets it; nothing when there is none.
void retireTrafficFER(Dictionary& state, const Value& lookup);

} // namespace spectrel
