#pragma once

#include "Analysis/Events/Event.h"
#include "CommandLine/Output/TimeForm.h"

#include <string>

namespace spectrel {

/// Appends an event as one JSON object on one line, without a line end. Keys that the event has nothing for are left
/// out.
void appendEventJson(const Event& event, TimeForm form, std::string& out);

} // namespace spectrel
