#pragma once

#include "Platform/Clock.h"
#include "Platform/Lifetime.h"
#include "Platform/RunLoop.h"
#include "Telephony/LogSource.h"
#include "Telephony/Simulator/Baseband.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace spectrel {

/// A simulated baseband as a source. One world for all channels: they all see the same phone. It moves only while
/// somebody listens.
class SimulatorSource final : public LogSource {
public:
    /// `rate`: how many simulated seconds pass in one.
    SimulatorSource(RunLoop& runLoop, const Clock& clock, std::unique_ptr<Baseband> baseband, double rate);
    ~SimulatorSource() override;

    Technology technology() const override
    {
        return _baseband->technology();
    }
    std::unique_ptr<LogStream> start(MessageSink& sink) override;
    void setBasebandHandler(std::function<void()> handler) override
    {
        _basebandHandler = std::move(handler);
    }
    std::string status() const override
    {
        return "a simulated " + std::string(technologyName(technology())) + " baseband";
    }

private:
    class Stream;

    void tick();
    void changeTechnology();
    void send(ByteView record);
    void remove(Stream& stream);

    RunLoop& _runLoop;
    const Clock& _clock;
    std::unique_ptr<Baseband> _baseband;
    double _rate;
    double _owed = 0; // simulated milliseconds not stepped through yet
    std::vector<Stream*> _streams;
    std::unique_ptr<Timer> _timer; // only while somebody listens
    std::function<void()> _basebandHandler;
    Lifetime _lifetime;
};

} // namespace spectrel
