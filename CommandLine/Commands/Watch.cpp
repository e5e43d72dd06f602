#include "CommandLine/Commands/Watch.h"

#include "CommandLine/Output/CellOutput.h"
#include "CommandLine/Output/TableOutput.h"
#include "CommandLine/Program/CrashReport.h"
#include "CommandLine/Program/ErrorLine.h"
#include "CommandLine/Program/LiveServices.h"
#include "CommandLine/Program/ProviderNames.h"
#include "LogGenerator/LogGenerator.h"
#include "Monitor/SpectrelModel.h"
#include "Platform/Qt/TerminationSignals.h"

#include <cstdio>
#include <optional>

namespace spectrel {

namespace {

class Watching final : public SpectrelModelObserver {
public:
    Watching(const WatchOptions& options, const Context& context)
        : _options(options)
        , _live(context)
        , _output(stdout, options.output)
        , _model(_live.services(), &LogGenerator::generatorFromTechnology, *this, LiveServices::portPrefixFor("Watch"))
        , _journal(printsChanges(options.output.format) ? &_model.displayState().followChanges() : nullptr)
    {
        if (options.output.format == OutputFormat::Events || options.events.hasAlarms())
            _events.emplace(_model.displayState(), options.events, options.output, _output, &_operators);
        if (options.output.format == OutputFormat::Table)
            _table.emplace(_model.displayState(), _output, options.output, &_operators);
        if (printsCells(options.output.format))
            _cells.emplace(_model.displayState(), _output, options.output, &_operators);
    }
    ~Watching() override
    {
        Ending::remove();
    }

    int run()
    {
        Ending::install(_model.displayState(), _live.context(), {});
        const TerminationSignals terminationSignals([this](int) { _live.runLoop().quit(); });
        _live.runLoop().async([this] { _model.restartMonitor(); });
        if (_options.duration)
            _live.runLoop().after(*_options.duration, [this] { _live.runLoop().quit(); });
        _output.flush();
        _live.runLoop().run();
        finish();
        return _status;
    }

    void updateViewControllerFromModel() override
    {
        _model.topLevelNodes(); // builds the display, and the history entry of this refresh
        const Value& display = _model.displayState().display();
        _output.printDisplay(display);
        if (_options.output.format == OutputFormat::Tree)
            _output.printLine("");
        if (_journal)
            _output.printChanges(_refreshes, _live.clock().now(), display, *_journal);
        if (_table)
            _table->refresh(_live.clock().now());
        if (_cells)
            _cells->refresh(_live.clock().now());
        if (_events)
            _events->refresh(_live.clock().now());
        flush();
        if (++_refreshes == _options.count || (_events && _events->isUntilMet()))
            _live.runLoop().quit();
    }

    void sessionDidChange() override
    {
        if (_events) {
            _events->sessionDidChange(_model.isConnected(), _model.lostReason(), _live.clock().now());
            flush();
        }
        if (!_model.isConnected() && !_model.lostReason().empty())
            report("Connecting... (" + _model.lostReason() + ")");
    }

private:
    void flush()
    {
        if (_output.flush())
            return;
        report("standard output: cannot be written");
        _status = 1;
        _live.runLoop().quit();
    }

    void finish()
    {
        if (!_events)
            return;
        _events->finish();
        if (!_output.flush())
            _status = 1;
        if (_options.events.until && !_events->isUntilMet()) {
            report("the alarm '" + _options.events.until->text + "' was not raised");
            _status = 1;
        }
    }

    const WatchOptions& _options;
    LiveServices _live;
    OutputWriter _output;
    SpectrelModel _model;
    Journal* const _journal; // where changes are printed
    ProviderNames _operators;
    std::optional<CellOutput> _cells;
    std::optional<TableOutput> _table;
    std::optional<EventOutput> _events; // where events are printed or alarms raised
    std::uint64_t _refreshes = 0;
    int _status = 0;
};

} // namespace

int watch(const WatchOptions& options, const Context& context)
{
    return Watching(options, context).run();
}

} // namespace spectrel
