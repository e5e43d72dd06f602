#include "Telephony/Sources/ReplaySource.h"

#include "Platform/Lifetime.h"
#include "Telephony/ServiceLine.h"

#include <cmath>
#include <utility>

namespace spectrel {

namespace {

/// Messages delivered in one turn of the run loop, so that other channels have theirs.
constexpr int MessagesPerTurn = 64;
/// Messages passed over in one turn.
constexpr int PassedPerTurn = 20'000;
/// Of the time between two files, what is waited for.
constexpr std::chrono::seconds MaxGap {10};

} // namespace

/// One channel's way through the files.
class ReplaySource::Stream final : public LogStream {
public:
    Stream(RunLoop& runLoop, const Clock& clock, const ReplayOptions& options, MessageSink& sink)
        : _runLoop(runLoop)
        , _clock(clock)
        , _options(options)
        , _sink(sink)
    {
        later(std::chrono::nanoseconds::zero());
    }

    void resume() override
    {
        if (std::exchange(_isStopped, false))
            play();
    }

private:
    enum class Reading : std::uint8_t { Done, Busy, Over };

    /// Delivers what is due, up to a turn's worth.
    void play()
    {
        for (int count = 0; count < MessagesPerTurn; ++count) {
            if (!_message) {
                switch (readNext()) {
                case Reading::Over:
                    return;
                case Reading::Busy:
                    return later(std::chrono::nanoseconds::zero());
                case Reading::Done:
                    break;
                }
            }
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
        const auto job = _lifetime.guard([this] { play(); });
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
        const bool isAfterGap = _isFirstOfFile && _message->time - _previous > MaxGap;
        if (!_origin || _message->time < _previous || isAfterGap) {
            _origin = _message->time;
            _startedAt = _clock.steady();
        }
        _previous = _message->time;
        _isFirstOfFile = false;
        const auto recorded = static_cast<double>((_message->time - *_origin).count());
        const std::chrono::microseconds place(std::llround(recorded / _options.speed));
        return place - (_clock.steady() - _startedAt);
    }

    /// The next message between the two points.
    Reading readNext()
    {
        for (int passed = 0; passed < PassedPerTurn;) {
            RecordedMessage message;
            if (_reader && _reader->next(message)) {
                if (isWithin(message.time)) {
                    _message = message;
                    _hasPlayed = true;
                    return Reading::Done;
                }
                ++passed;
            } else if (!openNext()) {
                return Reading::Over;
            }
        }
        return Reading::Busy;
    }

    bool isWithin(Moment time)
    {
        if (!_range) {
            _range.emplace(_options.from ? _options.from->in(time, _clock) : Moment::min(),
                _options.to ? _options.to->in(time, _clock) : Moment::max());
        }
        return time >= _range->first && time <= _range->second;
    }

    /// False at the end of all files.
    bool openNext()
    {
        if (_reader && !_reader->damage().empty())
            printServiceLine(_options.files[_file - 1] + ": " + _reader->damage());
        _reader.reset();
        while (!_reader) {
            if (_file == _options.files.size() && !rewind())
                return false;
            const std::string& file = _options.files[_file++];
            if (auto opened = openRecording(file))
                _reader = *std::move(opened);
            else
                printServiceLine(opened.failure().of(file).text);
        }
        _isFirstOfFile = true;
        return true;
    }

    bool rewind()
    {
        const bool hasPlayed = std::exchange(_hasPlayed, false);
        _isEmpty = _isEmpty && !hasPlayed;
        if (!_options.loop || !hasPlayed) {
            printServiceLine(_isEmpty && _range ? "the replay has ended: no message lies between --from and --to"
                                                : "the replay has ended");
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
    Lifetime _lifetime;
    std::unique_ptr<RecordingReader> _reader;
    std::size_t _file = 0; // the next one to open
    std::optional<RecordedMessage> _message; // read, not delivered yet
    std::optional<std::pair<Moment, Moment>> _range; // of the messages to play; known from the first message on
    std::optional<Moment> _origin;
    std::chrono::nanoseconds _startedAt {0}; // steady
    Moment _previous {}; // that of the message before
    bool _isFirstOfFile = false;
    bool _isEmpty = true; // nothing was played so far
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

Result<std::unique_ptr<LogSource>> ReplaySource::open(RunLoop& runLoop, const Clock& clock, ReplayOptions options)
{
    std::optional<Technology> technology;
    for (const std::string& file : options.files) {
        const auto opened = openRecording(file);
        if (!opened)
            return opened.failure().of(file);
        const RecordingReader& reader = **opened;
        const auto named = reader.technology() ? reader.technology() : options.technology;
        if (!named)
            return Failure {file + ": does not tell its technology; name it with --technology"};
        if (technology && technology != named)
            return Failure {file + ": is of technology " + std::string(technologyName(*named)) + ", the first file of "
                + std::string(technologyName(*technology))};
        technology = named;
    }
    if (!technology)
        return Failure {"no file to replay"};
    return std::unique_ptr<LogSource>(new ReplaySource(runLoop, clock, std::move(options), *technology));
}

std::unique_ptr<LogStream> ReplaySource::start(MessageSink& sink)
{
    return std::make_unique<Stream>(_runLoop, _clock, _options, sink);
}

std::string ReplaySource::status() const
{
    std::string text = _options.files.front();
    if (_options.files.size() > 1)
        text += " and " + std::to_string(_options.files.size() - 1) + " more";
    return text + " (" + std::string(technologyName(_technology)) + ")" + (_options.loop ? ", looping" : "");
}

} // namespace spectrel
