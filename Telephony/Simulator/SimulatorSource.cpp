#include "Telephony/Simulator/SimulatorSource.h"

#include "Telephony/Encoders/LTERecords.h"
#include "Telephony/Encoders/PropertyListRecords.h"
#include "Telephony/Tell.h"

#include <algorithm>
#include <deque>

namespace spectrel {

namespace {

constexpr std::chrono::milliseconds Step {100};

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

const std::vector<SimulatorSource::Cadence>& SimulatorSource::cadences()
{
    using namespace std::chrono_literals;
    static const std::vector<Cadence> All {
        {10s, true, [](const LTEWorld&, Moment time) { return simFilesRecord(time); }},
        {2s, true, [](const LTEWorld& world, Moment time) { return lteCellInformationRecord(world, time); }},
        {1s, true,
            [](const LTEWorld& world, Moment time) {
                return contextsRecord(world.bytesReceived(), world.bytesSent(), time);
            }},
        {400ms, false,
            [](const LTEWorld& world, Moment time) { return lteServingCellRecord(world.servingCell(), time); }},
        {800ms, false, [](const LTEWorld& world, Moment time) { return lteAntennasRecord(world.servingCell(), time); }},
    };
    return All;
}

SimulatorSource::SimulatorSource(RunLoop& runLoop, const Clock& clock, std::uint32_t seed, double rate)
    : _runLoop(runLoop)
    , _clock(clock)
    , _rate(rate)
    , _world(seed)
{
}

SimulatorSource::~SimulatorSource() = default;

std::unique_ptr<LogStream> SimulatorSource::start(MessageSink& sink)
{
    auto stream = std::make_unique<Stream>(*this, sink);
    for (const Cadence& cadence : cadences()) {
        if (cadence.atStart)
            stream->send(cadence.make(_world, _clock.now()));
    }
    _streams.push_back(stream.get());
    if (!_timer)
        _timer = _runLoop.repeat(Step, [this] { tick(); });
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
    _owed += static_cast<double>(Step.count()) * _rate;
    for (; _owed >= static_cast<double>(Step.count()); _owed -= static_cast<double>(Step.count()))
        step();
}

void SimulatorSource::step()
{
    _world.advance(Step);
    _elapsed += Step;
    const Moment now = _clock.now();
    for (const Cadence& cadence : cadences()) {
        if (_elapsed % cadence.interval == std::chrono::milliseconds::zero())
            send(cadence.make(_world, now));
    }
}

void SimulatorSource::send(ByteView record)
{
    for (Stream* stream : _streams)
        stream->send(record);
}

} // namespace spectrel
