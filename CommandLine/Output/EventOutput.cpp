#include "CommandLine/Output/EventOutput.h"

#include "CommandLine/Output/EventJson.h"

#include <string>

namespace spectrel {

EventOutput::EventOutput(DisplayState& display, OutputWriter& output)
    : _output(output)
    , _analysis(display)
    , _finder(_analysis, *this)
{
}

void EventOutput::eventFound(const Event& event)
{
    std::string line;
    appendEventJson(event, line);
    _output.printLine(line);
}

} // namespace spectrel
