#include "Analysis/Analysis.h"

#include "Analysis/DisplayReading.h"
#include "Analysis/ReportBuilder.h"

#include <algorithm>
#include <optional>

namespace spectrel {

/// What is known of the display, and the report made of it.
class Analysis::State {
public:
    State(DisplayState& display, OperatorNames* operators)
        : _display(display)
        , _operators(operators)
    {
    }

    AnalysedChanges apply(const AppliedMessage& message, const Journal& journal)
    {
        const AnalysedChanges replaced = followGenerator();
        _report.n = message.number + 1;
        _report.time = message.time;
        _isReportBuilt = false;
        if (!_reading)
            return replaced;
        AnalysedChanges changes = _reading->apply(message, journal, _display.display());
        changes.serving |= replaced.serving;
        changes.surroundings |= replaced.surroundings;
        return changes;
    }
    const Cell* serving() const
    {
        return _reading ? _reading->serving() : nullptr;
    }
    bool isOutOfService() const
    {
        return _reading && _reading->isOutOfService();
    }
    const CellReport& report()
    {
        if (!_isReportBuilt && _reading)
            buildReport(*_reading, _display.display(), _report);
        _isReportBuilt = true;
        return _report;
    }
    void setTime(Moment time)
    {
        _report.time = time;
    }
    const std::string& pathOf(const Origin& origin) const
    {
        return _paths.pathOf(origin.path);
    }
    DisplayState& display()
    {
        return _display;
    }

private:
    /// Another technology's display has another meaning; a new generator of the same class goes on with the old one's.
    AnalysedChanges followGenerator()
    {
        const LogGenerator* const generator = _display.generator();
        if (generator == _generator)
            return {};
        _generator = generator;
        const CellTable* const table = generator ? cellTableOf(generator->className()) : nullptr;
        if (_reading && table == &_reading->table())
            return {};
        const bool hadServing = serving();
        _reading.reset();
        if (table)
            _reading.emplace(*table, _paths, _operators);
        const auto [n, time] = std::pair(_report.n, _report.time);
        _report = {};
        _report.n = n;
        _report.time = time;
        return {.serving = hadServing, .surroundings = hadServing};
    }

    DisplayState& _display;
    OperatorNames* _operators;
    PathTable _paths;
    const LogGenerator* _generator = nullptr;
    std::optional<DisplayReading> _reading;
    CellReport _report;
    bool _isReportBuilt = false;
};

Analysis::Analysis(DisplayState& display, OperatorNames* operators)
    : _state(std::make_unique<State>(display, operators))
{
    display.addReader(*this);
}

Analysis::~Analysis()
{
    _state->display().removeReader(*this);
}

void Analysis::addListener(AnalysisListener& listener)
{
    _listeners.push_back(&listener);
}

void Analysis::removeListener(AnalysisListener& listener)
{
    std::erase(_listeners, &listener);
}

void Analysis::messageApplied(const AppliedMessage& message, const Journal& journal)
{
    const AnalysedChanges changes = _state->apply(message, journal);
    for (AnalysisListener* const listener : _listeners)
        listener->messageAnalysed(message, journal, *this, changes);
}

void Analysis::refresh(Moment time)
{
    _state->setTime(time);
    for (AnalysisListener* const listener : _listeners)
        listener->refreshed(_state->report(), *this);
}

const Cell* Analysis::serving() const
{
    return _state->serving();
}

bool Analysis::isOutOfService() const
{
    return _state->isOutOfService();
}

const CellReport& Analysis::report() const
{
    return _state->report();
}

const std::string& Analysis::pathOf(const Origin& origin) const
{
    return _state->pathOf(origin);
}

} // namespace spectrel
