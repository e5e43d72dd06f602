#pragma once

#include "Platform/Clock.h"
#include "Values/Bytes.h"
#include "Values/Value.h"

namespace spectrel {

class IFXWorld;

/// The phone's whole state, labelled: texts, dictionaries and lists. Each list begins with a heading, which says what
/// its elements are and is not one of them.
Value ifxState(const IFXWorld& world);

/// The state as the baseband sends it: a property list in the XML form. It tells no time.
Bytes ifxReport(const IFXWorld& world, Moment time);

} // namespace spectrel
