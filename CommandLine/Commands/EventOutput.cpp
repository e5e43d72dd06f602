#include "CommandLine/Commands/EventOutput.h"

#include "CommandLine/Output/EventJson.h"
#include "CommandLine/Program/ErrorLine.h"

#include <cstdio>
#include <unistd.h>

namespace spectrel {

EventOutput::EventOutput(DisplayState& display, const EventOptions& options, const OutputOptions& output,
    OutputWriter& writer, OperatorNames* operators)
    : _options(options)
    , _time(output.time)
    , _output(writer)
    , _analysis(display, operators)
{
    EventListener& events = *this;
    AlarmListener& alarms = *this;
    if (output.format == OutputFormat::Events) {
        _finder.emplace(_analysis, events);
        _findings.emplace(_analysis, *_finder, options.thresholds);
    }
    for (const AlarmCondition& condition : options.alarms)
        _alarms.emplace_back(condition, _analysis, alarms);
    if (options.until)
        _alarms.emplace_back(*options.until, _analysis, alarms);
    if (options.alarmCommand)
        _command.emplace(*options.alarmCommand);
}

void EventOutput::sessionDidChange(bool isConnected, const std::string& reason, Moment time)
{
    if (_finder)
        _finder->sessionDidChange(isConnected, reason, time);
}

void EventOutput::addBookmark(Moment time, const std::string& note)
{
    if (_finder)
        _finder->addBookmark(time, note);
}

void EventOutput::finish()
{
    if (!_finder)
        return;
    _finder->finish();
    _findings->finish();
}

void EventOutput::eventFound(const Event& event)
{
    std::string line;
    appendEventJson(event, _time, line);
    _output.printLine(line);
    if (_findings)
        _findings->eventFound(event);
}

void EventOutput::alarmRaised(const AlarmCondition& condition, const Event& event)
{
    if (_options.until && condition.text == _options.until->text)
        _isUntilMet = true;
    if (_finder)
        _finder->add(event);
    else
        report(event.text);
    if (::isatty(STDERR_FILENO) != 0)
        std::fputc('\a', stderr);
    runCommand(event);
}

void EventOutput::runCommand(const Event& event)
{
    if (!_command)
        return;
    std::string line;
    appendEventJson(event, _time, line);
    if (const Outcome started = _command->run(line); !started)
        report("the alarm's command cannot be run: " + started.failure().text);
}

} // namespace spectrel
