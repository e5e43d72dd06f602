#include "CommandLine/Commands/Watch.h"

#include "CommandLine/Program/CrashReport.h"
#include "CommandLine/Program/ErrorLine.h"
#include "CommandLine/Program/LiveServices.h"
#include "LogGenerator/LogGenerator.h"
#include "Monitor/SpectrelModel.h"
#include "Platform/Qt/TerminationSignals.h"

#include <cstdio>

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
        _output.printRow(_live.clock().now(), display);
        if (!_output.flush()) {
            report("standard output: cannot be written");
            _status = 1;
            _live.runLoop().quit();
        }
        if (++_refreshes == _options.count)
            _live.runLoop().quit();
    }

    void sessionDidChange() override
    {
        if (!_model.isConnected() && !_model.lostReason().empty())
            report("Connecting... (" + _model.lostReason() + ")");
    }

private:
    const WatchOptions& _options;
    LiveServices _live;
    OutputWriter _output;
    SpectrelModel _model;
    Journal* const _journal; // where changes are printed
    std::uint64_t _refreshes = 0;
    int _status = 0;
};

} // namespace

int watch(const WatchOptions& options, const Context& context)
{
    return Watching(options, context).run();
}

} // namespace spectrel
