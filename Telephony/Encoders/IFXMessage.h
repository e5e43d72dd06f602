#pragma once

#include "Platform/Clock.h"
#include "Telephony/Reports/IFXReport.h"
#include "Values/Bytes.h"
#include "Values/Value.h"

namespace spectrel {

/// The phone's whole state, labelled: texts, dictionaries and lists. Each list begins with a heading, which says what
/// its elements are and is not one of them.
Value ifxState(const IFXReport& report);

/// The state as the baseband sends it: a property list in the XML form. It carries no time.
Bytes ifxMessage(const IFXReport& report, Moment time);

} // namespace spectrel
