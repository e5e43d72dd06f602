#include "Telephony/ReplaySource.h"

#include "Telephony/Tell.h"

#include <cmath>
#include <utility>

namespace spectrel {

namespace {

/// Messages delivered in one turn of the run loop, so that other channels have theirs.
constexpr int MessagesPerTurn = 64;

} // namespace

/// One channel's way through the files.
class ReplaySource::Stream final : public LogStream {
public:
    Stream(RunLoop& runLoop, const Clock& clock, const ReplayOptions& options, MessageSink& sink)
        : _runLoop(runLoop)
        , _clock(clock)
        , _options(options)
        , _sink(sink)
        , _alive(std::make_shared<bool>(true))
    {
        later(std::chrono::nanoseconds::zero());
    }

    void resume() override
    {
        if (std::exchange(_isStopped, false))
            play();
    }

private:
    /// Delivers what is due, up to a turn's worth.
    void play()
    {
        for (int count = 0; count < MessagesPerTurn; ++count) {
            if (!_message && !readNext())
                return;
            if (const auto wait = untilDue(); wait > std::chrono::nanoseconds::zero())
                return later(wait);
            if (!_sink.deliver(_message->body)) {
                _isStopped = true;
                return;
            }
            _message.reset();
        }
        later(std::chrono::nanoseconds::zero());
    }

    void later(std::chrono::nanoseconds delay)
    {
        const auto job = [this, alive = std::weak_ptr(_alive)] {
            if (!alive.expired())
                play();
        };
        if (delay > std::chrono::nanoseconds::zero())
            _runLoop.after(delay, job);
        else
            _runLoop.async(job);
    }

    /// How long the message still has to wait; its place on the recording's time line against the time played so far.
    std::chrono::nanoseconds untilDue()
    {
        if (_options.speed <= 0)
            return {};
        if (!_origin) {
            _origin = _message->time;
            _startedAt = _clock.now();
        }
        const auto recorded = static_cast<double>((_message->time - *_origin).count());
        const std::chrono::microseconds place(std::llround(recorded / _options.speed));
        return place - (_clock.now() - _startedAt);
    }

    /// False at the end of all files.
    bool readNext()
    {
        for (std::size_t opened = 0;;) {
            RecordedMessage message;
            if (_reader && _reader->next(message)) {
                _message = message;
                _hasPlayed = true;
                return true;
            }
            if (_reader && !_reader->damage().empty())
                tell(_options.files[_file - 1] + ": " + _reader->damage());
            if (_file == _options.files.size() && !rewind())
                return false;
            if (opened++ > _options.files.size())
                return false; // nothing to read in any of them
            std::string reason;
            _reader = openRecording(_options.files[_file++], reason);
            if (!_reader)
                tell(_options.files[_file - 1] + ": " + reason);
        }
    }

    bool rewind()
    {
        _reader.reset();
        if (!_options.loop || !std::exchange(_hasPlayed, false)) {
            tell("the replay has ended");
            return false;
        }
        _file = 0;
        _origin.reset();
        return true;
    }

    RunLoop& _runLoop;
    const Clock& _clock;
    const ReplayOptions& _options;
    MessageSink& _sink;
    std::shared_ptr<bool> _alive;
    std::unique_ptr<RecordingReader> _reader;
    std::size_t _file = 0; // the next one to open
    std::optional<RecordedMessage> _message; // read, not delivered yet
    std::optional<Moment> _origin;
    Moment _startedAt {};
    bool _isStopped = false; // the client had no room
    bool _hasPlayed = false; // since the last rewind
};

ReplaySource::ReplaySource(RunLoop& runLoop, const Clock& clock, ReplayOptions options, Technology technology)
    : _runLoop(runLoop)
    , _clock(clock)
    , _options(std::move(options))
    , _technology(technology)
{
}

std::unique_ptr<ReplaySource> ReplaySource::open(
    RunLoop& runLoop, const Clock& clock, ReplayOptions options, std::string& reason)
{
    std::optional<Technology> technology;
    for (const std::string& file : options.files) {
        const auto reader = openRecording(file, reason);
        if (!reader) {
            reason = file + ": " + reason;
            return nullptr;
        }
        const auto told = reader->technology() ? reader->technology() : options.technology;
        if (!told) {
            reason = file + ": does not tell its technology; name it with --technology";
            return nullptr;
        }
        if (technology && technology != told) {
            reason = file + ": is of technology " + std::string(technologyName(*told)) + ", the first file of "
                + std::string(technologyName(*technology));
            return nullptr;
        }
        technology = told;
    }
    if (!technology) {
        reason = "no file to replay";
        return nullptr;
    }
    return std::unique_ptr<ReplaySource>(new ReplaySource(runLoop, clock, std::move(options), *technology));
}

std::unique_ptr<LogStream> ReplaySource::start(MessageSink& sink)
{
    return std::make_unique<Stream>(_runLoop, _clock, _options, sink);
}

} // namespace spectrel
