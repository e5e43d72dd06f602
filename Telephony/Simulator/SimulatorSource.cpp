#include "Telephony/Simulator/SimulatorSource.h"

#include "Telephony/Tell.h"

#include <algorithm>
#include <deque>

namespace spectrel {

namespace {

/// Live messages wait for a client that is busy; beyond this many the oldest go, and the loss is told.
constexpr std::size_t LongestQueue = 4096;

} // namespace

/// One channel's share: what its client has no room for waits here.
class SimulatorSource::Stream final : public LogStream {
public:
    Stream(SimulatorSource& source, MessageSink& sink)
        : _source(source)
        , _sink(sink)
    {
    }
    ~Stream() override
    {
        _source.remove(*this);
    }

    void send(ByteView record)
    {
        if (_waiting.empty() && _sink.deliver(record))
            return;
        _waiting.emplace_back(record.begin(), record.end());
        if (_waiting.size() > LongestQueue) {
            _waiting.pop_front();
            ++_lost;
        }
    }

    void resume() override
    {
        while (!_waiting.empty() && _sink.deliver(_waiting.front()))
            _waiting.pop_front();
        if (_waiting.empty() && _lost > 0) {
            tell("a client was too slow and lost " + std::to_string(_lost) + " messages");
            _lost = 0;
        }
    }

private:
    SimulatorSource& _source;
    MessageSink& _sink;
    std::deque<Bytes> _waiting;
    std::size_t _lost = 0;
};

SimulatorSource::SimulatorSource(RunLoop& runLoop, const Clock& clock, std::unique_ptr<Baseband> baseband, double rate)
    : _runLoop(runLoop)
    , _clock(clock)
    , _baseband(std::move(baseband))
    , _rate(rate)
{
}

SimulatorSource::~SimulatorSource() = default;

std::unique_ptr<LogStream> SimulatorSource::start(MessageSink& sink)
{
    auto stream = std::make_unique<Stream>(*this, sink);
    _baseband->greet(_clock.now(), [&stream](ByteView record) { stream->send(record); });
    _streams.push_back(stream.get());
    if (!_timer)
        _timer = _runLoop.repeat(Baseband::Step, [this] { tick(); });
    return stream;
}

void SimulatorSource::remove(Stream& stream)
{
    std::erase(_streams, &stream);
    if (_streams.empty())
        _timer.reset();
}

void SimulatorSource::tick()
{
    constexpr double StepLength = Baseband::Step.count();
    for (_owed += StepLength * _rate; _owed >= StepLength; _owed -= StepLength)
        _baseband->advance(_clock.now(), [this](ByteView record) { send(record); });
}

void SimulatorSource::send(ByteView record)
{
    for (Stream* stream : _streams)
        stream->send(record);
}

} // namespace spectrel
