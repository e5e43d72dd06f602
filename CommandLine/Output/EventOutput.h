#pragma once

#include "Analysis/Analysis.h"
#include "Analysis/Events/Event.h"
#include "Analysis/Events/EventFinder.h"
#include "CommandLine/Output/OutputWriter.h"
#include "Monitor/DisplayState.h"

namespace spectrel {

/// Prints the events of a display, each on one line.
class EventOutput final : private EventListener {
public:
    /// Both are there for as long as this is.
    EventOutput(DisplayState& display, OutputWriter& output);

    EventFinder& finder()
    {
        return _finder;
    }
    /// No more messages come.
    void finish()
    {
        _finder.finish();
    }

private:
    void eventFound(const Event& event) override;

    OutputWriter& _output;
    Analysis _analysis;
    EventFinder _finder;
};

} // namespace spectrel
