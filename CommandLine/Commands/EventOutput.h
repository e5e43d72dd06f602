#pragma once

#include "Analysis/Analysis.h"
#include "Analysis/Events/Alarm.h"
#include "Analysis/Events/Event.h"
#include "Analysis/Events/EventFinder.h"
#include "Analysis/Events/Findings/Findings.h"
#include "Analysis/Events/Thresholds.h"
#include "CommandLine/Output/OutputWriter.h"
#include "CommandLine/Program/AlarmCommand.h"
#include "Monitor/DisplayState.h"

#include <deque>
#include <optional>
#include <string>
#include <vector>

namespace spectrel {

/// What a command was asked for beside its format.
struct EventOptions {
    std::vector<AlarmCondition> alarms;
    std::optional<std::string> alarmCommand; // of the shell
    std::optional<AlarmCondition> until; // ends the command
    Thresholds thresholds; // of findings

    /// Whether events are to be found also where they are not printed.
    bool hasAlarms() const
    {
        return !alarms.empty() || until;
    }
};

/// Prints the events of a display, each on one line, and raises alarms. With another format than `events` only alarms
/// are noticed: each is a line on standard error, with a bell where that is a terminal.
class EventOutput final : private EventListener, private AlarmListener {
public:
    /// All are there for as long as this is; the names may be null.
    EventOutput(DisplayState& display, const EventOptions& options, const OutputOptions& output, OutputWriter& writer,
        OperatorNames* operators);

    /// The live session was lost, or is there again.
    void sessionDidChange(bool isConnected, const std::string& reason, Moment time);
    void addBookmark(Moment time, const std::string& note);
    /// A refresh tick of a live session.
    void refresh(Moment time)
    {
        _analysis.refresh(time);
    }
    /// No more messages come.
    void finish();
    /// Whether the alarm that ends the command has been raised.
    bool isUntilMet() const
    {
        return _isUntilMet;
    }

private:
    void eventFound(const Event& event) override;
    void alarmRaised(const AlarmCondition& condition, const Event& event) override;
    void runCommand(const Event& event);

    const EventOptions& _options;
    const TimeForm _time;
    OutputWriter& _output;
    Analysis _analysis;
    std::optional<EventFinder> _finder; // where events are printed
    std::optional<Findings> _findings;
    std::deque<AlarmWatch> _alarms;
    std::optional<AlarmCommand> _command;
    bool _isUntilMet = false;
};

} // namespace spectrel
