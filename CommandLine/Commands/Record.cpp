#include "CommandLine/Commands/Record.h"

#include "CommandLine/Program/ErrorLine.h"
#include "CommandLine/Program/LiveServices.h"
#include "CommandLine/Program/RecorderPort.h"
#include "LogGenerator/LogGenerator.h"
#include "Monitor/Session.h"
#include "Platform/Qt/PatientOutput.h"
#include "Platform/Qt/TerminationSignals.h"
#include "Records/Beside/Marks.h"
#include "Records/Recording.h"

#include <filesystem>
#include <functional>
#include <memory>
#include <string>
#include <sys/stat.h>
#include <utility>

namespace spectrel {

namespace {

/// Messages reach the file at the latest this long after they came.
constexpr std::chrono::milliseconds FlushDelay {500};

/// Whether the target is no file or folder but an output that somebody reads, or a device.
bool isStream(const std::string& target)
{
    struct stat status { };
    return target == "-" || target.starts_with("/dev/")
        || (::lstat(target.c_str(), &status) == 0 && (S_ISFIFO(status.st_mode) || S_ISCHR(status.st_mode)));
}

std::string counted(std::uint64_t count)
{
    return std::to_string(count) + (count == 1 ? " message" : " messages");
}

class Recorder final : public SessionSink {
public:
    Recorder(const RecordOptions& options, std::unique_ptr<PatientOutput>& output, LiveServices& live)
        : _options(options)
        , _live(live)
        , _output(std::move(output))
        , _files(options.files, live.clock(), streamOf(_output.get()))
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
        bool isAskedToEnd = false;
        const TerminationSignals terminationSignals([&](int) {
            isAskedToEnd = true;
            _live.runLoop().quit();
        });
        _live.runLoop().async([this] { _session.restart(); });
        if (_options.duration)
            _live.runLoop().after(*_options.duration, [this] { _live.runLoop().quit(); });
        _live.runLoop().run();
        _session.destroyPorts();
        finish([&isAskedToEnd] { return isAskedToEnd; });
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
            technology && !_hasFailed && _messages != _options.count)
            write(*technology, body);
        holdBack();
    }
    void messagesWereLost(std::uint64_t count) override
    {
        noteLost(count);
        report(RecordingFiles::spoken(_files.path()) + ": " + counted(count)
            + " lost, for this program was too slow for the service");
    }
    void sessionDidTick() override
    {
        holdBack();
    }
    void sessionDidChange() override
    {
        if (_session.isConnected())
            begin();
        else if (!_session.loss().text.empty())
            report("Connecting... (" + _session.loss().text + ")");
    }

private:
    static RecordingOutput streamOf(PatientOutput* output)
    {
        return output ? RecordingOutput([output](ByteView bytes) { return output->write(bytes); }) : RecordingOutput();
    }

    void fail(const std::string& line)
    {
        report(line);
        _status = 1;
        _hasFailed = true;
        _live.runLoop().quit();
    }

    /// Whoever reads the stream sets the pace; until the next tick the messages wait at the service.
    void holdBack()
    {
        if (_output && _output->waiting() > PatientOutput::Plenty)
            _session.pause();
    }

    /// The file is there from the session's start on, before the first message.
    void begin()
    {
        const auto technology = technologyOfConstant(_session.technology());
        if (technology && !_hasFailed)
            settle(_files.begin(*technology));
    }

    void write(Technology technology, ByteView body)
    {
        const std::size_t before = _files.count();
        if (!settle(_files.write(technology, body))) {
            ++_lostForRoom;
            noteLost(1);
            return;
        }
        if (before > 0 && _files.count() > before)
            report("recording into " + _files.path());
        if (++_messages == _options.count)
            _live.runLoop().quit();
    }

    /// A full disk is reported once, and the recording goes on when there is room; any other failure ends it. False
    /// after either.
    bool settle(const Outcome& outcome)
    {
        flushSoon();
        if (outcome)
            return true;
        if (outcome.failure().code != Failure::Code::NoRoom)
            fail(outcome.failure().text);
        else if (!std::exchange(_lacksRoom, true))
            report(outcome.failure().text + "; what comes waits, and is lost when it is too much, until there is room");
        return false;
    }

    void flushSoon()
    {
        if (!std::exchange(_flushIsDue, true))
            _live.runLoop().after(FlushDelay, [this] { flush(); });
    }

    /// The file that is being written, for whoever asks from another folder.
    Result<std::string> recording() const
    {
        if (_output)
            return Failure {
                RecordingFiles::spoken(_options.files.target) + " is recorded to, beside which no bookmark can stand"};
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
        if (!_hasFailed && settleFlush(_files.flush()) && _output && _output->failure())
            fail(RecordingFiles::spoken(_options.files.target) + ": " + _output->failure()->text);
    }

    bool settleFlush(const Outcome& flushed)
    {
        if (!flushed)
            return settle(flushed);
        if (std::exchange(_lacksRoom, false))
            report(RecordingFiles::spoken(_files.path()) + ": there is room again; "
                + counted(std::exchange(_lostForRoom, 0)) + " lost in the meantime");
        return true;
    }

    void noteLost(std::uint64_t count)
    {
        _lost += count;
        _status = 1;
        [[maybe_unused]] const auto noted = _files.noteLost(count); // what finds no room waits
    }

    void finish(const std::function<bool()>& isAskedToEnd)
    {
        if (!_hasFailed) {
            if (const auto finished = _files.finish(); !finished)
                fail(finished.failure().text
                    + (_files.waiting() > 0 ? "; the last " + counted(_files.waiting()) + " are lost" : ""));
        }
        if (_output && !_hasFailed) {
            if (const auto taken = _output->finish(_live.runLoop(), isAskedToEnd); !taken)
                fail(RecordingFiles::spoken(_options.files.target) + ": " + taken.failure().text);
        }
        if (_hasFailed)
            return;
        if (_files.count() == 0)
            return fail(
                RecordingFiles::spoken(_options.files.target) + ": nothing was recorded, for no session was opened");
        report(RecordingFiles::spoken(_files.path()) + ": " + counted(_messages)
            + (_files.count() > 1 ? " in " + std::to_string(_files.count()) + " files, this one being the last" : "")
            + (_lost > 0 ? ", " + std::to_string(_lost) + " lost" : ""));
    }

    const RecordOptions& _options;
    LiveServices& _live;
    std::unique_ptr<PatientOutput> _output; // where the target is no file
    RecordingFiles _files;
    std::unique_ptr<LogGenerator> _generator; // for its start command: nothing is decoded
    Session _session;
    RecorderPort _marks;
    std::uint64_t _messages = 0;
    std::uint64_t _lost = 0;
    std::uint64_t _lostForRoom = 0; // since the disk is full
    bool _lacksRoom = false; // and it was reported
    bool _flushIsDue = false;
    bool _hasFailed = false;
    int _status = 0;
};

} // namespace

int record(const RecordOptions& options, const Context& context)
{
    LiveServices live(context);
    std::unique_ptr<PatientOutput> output;
    if (isStream(options.files.target)) {
        auto opened = PatientOutput::open(options.files.target);
        if (!opened) {
            report(opened.failure().of(RecordingFiles::spoken(options.files.target)).text);
            return 1;
        }
        output = *std::move(opened);
    }
    return Recorder(options, output, live).run();
}

} // namespace spectrel
