#pragma once

#include "Platform/Clock.h"
#include "Platform/RunLoop.h"
#include "Telephony/LogSource.h"
#include "Telephony/Simulator/LTEWorld.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <string_view>
#include <vector>

namespace spectrel {

/// A simulated LTE baseband. One world for all channels: they all see the same phone. It moves only while somebody
/// listens.
class SimulatorSource final : public LogSource {
public:
    /// `rate`: how many simulated seconds pass in one.
    SimulatorSource(RunLoop& runLoop, const Clock& clock, std::uint32_t seed, double rate);
    ~SimulatorSource() override;

    Technology technology() const override
    {
        return Technology::LTE;
    }
    std::unique_ptr<LogStream> start(MessageSink& sink) override;

private:
    class Stream;
    using MakeRecord = Bytes (*)(const LTEWorld& world, Moment time);
    struct Cadence {
        std::chrono::milliseconds interval;
        bool atStart; // a slow record, which a new channel gets at once
        MakeRecord make;
    };
    static const std::vector<Cadence>& cadences();

    void tick();
    void step();
    void send(ByteView record);
    void remove(Stream& stream);

    RunLoop& _runLoop;
    const Clock& _clock;
    double _rate;
    LTEWorld _world;
    std::chrono::milliseconds _elapsed {0}; // simulated, in whole steps
    double _owed = 0; // simulated milliseconds not stepped through yet
    std::vector<Stream*> _streams;
    std::unique_ptr<Timer> _timer; // only while somebody listens
};

} // namespace spectrel
