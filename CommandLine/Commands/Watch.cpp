#include "CommandLine/Commands/Watch.h"

#include "CommandLine/Program/CrashReport.h"
#include "CommandLine/Program/ErrorLine.h"
#include "CommandLine/Program/LiveServices.h"
#include "LogGenerator/LogGenerator.h"
#include "Monitor/SpectrelModel.h"
#include "Platform/Qt/PatientOutput.h"
#include "Platform/Qt/TerminationSignals.h"

#include <string>

namespace spectrel {

namespace {

class Watching final : public SpectrelModelObserver {
public:
    Watching(const WatchOptions& options, PatientOutput& reader, LiveServices& live)
        : _options(options)
        , _live(live)
        , _reader(reader)
        , _output(reader.stream(), options.format)
        , _model(_live.services(), &LogGenerator::generatorFromTechnology, *this, LiveServices::portPrefixFor("Watch"))
        , _journal(printsChanges(options.format) ? &_model.displayState().followChanges() : nullptr)
    {
    }
    ~Watching() override
    {
        Ending::remove();
    }

    int run()
    {
        Ending::install(_model.displayState(), {});
        bool isAskedToEnd = false;
        const TerminationSignals terminationSignals([&](int) {
            isAskedToEnd = true;
            _live.runLoop().quit();
        });
        _reader.setChangeHandler([this] { readerDidChange(); });
        _live.runLoop().async([this] { _model.restartMonitor(); });
        if (_options.duration)
            _live.runLoop().after(*_options.duration, [this] { _live.runLoop().quit(); });
        _output.flush();
        _live.runLoop().run();
        _reader.setChangeHandler({});
        const auto taken = _reader.finish(_live.runLoop(), [&isAskedToEnd] { return isAskedToEnd; });
        if (!taken && _status == 0)
            fail(taken.failure().text);
        return _status;
    }

    void updateViewControllerFromModel() override
    {
        _model.topLevelNodes(); // builds the display, and the history entry of this refresh
        const Value& display = _model.displayState().display();
        _output.printDisplay(display);
        if (_options.format == OutputFormat::Tree)
            _output.printLine("");
        if (_journal)
            _output.printChanges(_refreshes, Clock::installed().now(), display, *_journal);
        if (!_output.flush())
            return fail("cannot be written");
        _model.setHeld(_reader.waiting() > PatientOutput::Plenty);
        if (++_refreshes == _options.count)
            _live.runLoop().quit();
    }

    void sessionDidChange() override
    {
        if (!_model.isConnected() && !_model.lostReason().empty())
            report("Connecting... (" + _model.lostReason() + ")");
    }

private:
    void fail(const std::string& why)
    {
        report("standard output: " + why);
        _status = 1;
        _live.runLoop().quit();
    }
    void readerDidChange()
    {
        if (_reader.failure() && _status == 0)
            fail("cannot be written");
        else
            _model.setHeld(false);
    }

    const WatchOptions& _options;
    LiveServices& _live;
    PatientOutput& _reader;
    OutputWriter _output;
    SpectrelModel _model;
    Journal* const _journal; // where changes are printed
    std::uint64_t _refreshes = 0;
    int _status = 0;
};

} // namespace

int watch(const WatchOptions& options)
{
    LiveServices live;
    const auto output = PatientOutput::open("-");
    if (!output) {
        report(output.failure().of("standard output").text);
        return 1;
    }
    return Watching(options, **output, live).run();
}

} // namespace spectrel
