#include "CommandLine/Commands/Record.h"

#include "CommandLine/Program/ErrorLine.h"
#include "CommandLine/Program/LiveServices.h"
#include "CommandLine/Program/RecorderPort.h"
#include "LogGenerator/LogGenerator.h"
#include "Monitor/Session.h"
#include "Platform/Qt/TerminationSignals.h"
#include "Records/Beside/Marks.h"
#include "Records/Recording.h"

#include <filesystem>
#include <memory>
#include <string>

namespace spectrel {

namespace {

/// Messages reach the file at the latest this long after they came.
constexpr std::chrono::milliseconds FlushDelay {500};

class Recorder final : public SessionSink {
public:
    Recorder(const RecordOptions& options, const Context& context)
        : _options(options)
        , _live(context)
        , _files(options.files, _live.clock())
        , _session(_live.services(), *this, LiveServices::portPrefixFor("Record"))
        , _marks(_live.services().ports, LiveServices::portPrefixFor("Record"),
              {[this] { return recording(); }, [this](const std::string& note) { return mark(note); }})
    {
    }

    int run()
    {
        if (const auto prepared = _files.prepare(); !prepared) {
            fail(prepared.failure().text);
            return _status;
        }
        const TerminationSignals terminationSignals([this](int) { _live.runLoop().quit(); });
        _live.runLoop().async([this] { _session.restart(); });
        if (_options.duration)
            _live.runLoop().after(*_options.duration, [this] { _live.runLoop().quit(); });
        _live.runLoop().run();
        _session.destroyPorts();
        flush();
        if (_files.count() == 0 && _status == 0)
            fail(RecordingFiles::spoken(_options.files.target) + ": nothing was recorded, for no session was opened");
        else if (_status == 0)
            report(RecordingFiles::spoken(_files.path()) + ": " + std::to_string(_messages) + " messages"
                + (_files.count() > 1 ? " in " + std::to_string(_files.count()) + " files, this one being the last"
                                      : ""));
        return _status;
    }

    void useTechnology(const Value& technology) override
    {
        _generator = LogGenerator::generatorFromTechnology(technology, _live.context());
    }
    LogGenerator* generator() override
    {
        return _generator.get();
    }
    void receive(ByteView body) override
    {
        if (const auto technology = technologyOfConstant(_session.technology());
            technology && _status == 0 && _messages != _options.count)
            write(*technology, body);
    }
    void sessionDidChange() override
    {
        if (_session.isConnected())
            begin();
        else if (!_session.loss().text.empty())
            report("Connecting... (" + _session.loss().text + ")");
    }

private:
    void fail(const std::string& line)
    {
        report(line);
        _status = 1;
        _live.runLoop().quit();
    }

    /// The file is there from the session's start on, before the first message.
    void begin()
    {
        const auto technology = technologyOfConstant(_session.technology());
        if (!technology || _status != 0)
            return;
        if (const auto begun = _files.begin(*technology); !begun)
            fail(begun.failure().text);
    }

    void write(Technology technology, ByteView body)
    {
        const std::size_t before = _files.count();
        if (const auto written = _files.write(technology, body); !written)
            return fail(written.failure().text);
        if (before > 0 && _files.count() > before)
            report("recording into " + _files.path());
        if (!_flushIsDue) {
            _flushIsDue = true;
            _live.runLoop().after(FlushDelay, [this] { flush(); });
        }
        if (++_messages == _options.count)
            _live.runLoop().quit();
    }

    /// The file that is being written, for whoever asks from another folder.
    Result<std::string> recording() const
    {
        if (_options.files.target == "-")
            return Failure {"standard output is recorded to, beside which no bookmark can stand"};
        if (_files.count() == 0)
            return Failure {"the recorder has no file yet, for no session is open"};
        std::error_code error;
        const auto path = std::filesystem::absolute(_files.path(), error);
        return error ? _files.path() : path.string();
    }

    Result<std::string> mark(const std::string& note) const
    {
        const auto file = recording();
        if (!file)
            return file;
        if (auto appended = appendMark(*file, {_live.clock().now(), note}); !appended)
            return appended.failure();
        return file;
    }

    void flush()
    {
        _flushIsDue = false;
        if (const auto flushed = _files.flush(); !flushed && _status == 0)
            fail(flushed.failure().text);
    }

    const RecordOptions& _options;
    LiveServices _live;
    RecordingFiles _files;
    std::unique_ptr<LogGenerator> _generator; // for its start command: nothing is decoded
    Session _session;
    RecorderPort _marks;
    std::uint64_t _messages = 0;
    bool _flushIsDue = false;
    int _status = 0;
};

} // namespace

int record(const RecordOptions& options, const Context& context)
{
    return Recorder(options, context).run();
}

} // namespace spectrel
