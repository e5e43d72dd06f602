#include "Telephony/Sources/SimulatorSource.h"

#include "Telephony/ChannelQueue.h"
#include "Telephony/ServiceLine.h"

#include <algorithm>

namespace spectrel {

/// One channel's share.
class SimulatorSource::Stream final : public LogStream {
public:
    Stream(SimulatorSource& source, MessageSink& sink)
        : _source(source)
        , _queue(sink)
    {
    }
    ~Stream() override
    {
        _source.remove(*this);
    }

    void send(ByteView record)
    {
        _queue.send(record);
    }
    void resume() override
    {
        _queue.drain();
    }
    std::size_t waiting() const override
    {
        return _queue.waiting();
    }
    std::uint64_t lost() const override
    {
        return _queue.lost();
    }

private:
    SimulatorSource& _source;
    ChannelQueue _queue;
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
    for (_owed += StepLength * _rate; _owed >= StepLength; _owed -= StepLength) {
        const Technology before = technology();
        _baseband->advance(_clock.now(), [this](ByteView record) { send(record); });
        if (technology() != before && _basebandHandler)
            return changeTechnology();
    }
}

/// The world stands still until clients have asked for the new technology.
void SimulatorSource::changeTechnology()
{
    printServiceLine("the phone has moved to technology " + std::string(technologyName(technology())));
    _owed = 0;
    _timer.reset();
    _runLoop.async(_lifetime.guard([this] {
        if (_basebandHandler)
            _basebandHandler(); // ends the channels, and with them their streams
    }));
}

void SimulatorSource::send(ByteView record)
{
    for (Stream* stream : _streams)
        stream->send(record);
}

} // namespace spectrel
