#pragma once

#include "Platform/Clock.h"
#include "Platform/Lifetime.h"
#include "Platform/RunLoop.h"
#include "Telephony/LogSource.h"
#include "Telephony/Modem/ModemService.h"

#include <array>
#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace spectrel {

/// A real modem: what its service reports of it becomes the records of cell information, SIM files and packet data
/// contexts. Asks nothing of the modem while nobody listens.
///
/// The technology is that of the modem's access technology; while that is not known, the last known one, at first GSM.
class ModemSource final : public LogSource {
public:
    static constexpr std::chrono::seconds CellInterval {5}; // the modem has to be asked for its cells
    static constexpr std::uint32_t SignalRate = 2; // seconds

    /// `wish`: which modem, as `chooseModem` takes it.
    ModemSource(RunLoop& runLoop, const Clock& clock, std::unique_ptr<ModemService> service, std::string wish);
    ~ModemSource() override;

    Technology technology() const override
    {
        return _technology;
    }
    std::unique_ptr<LogStream> start(MessageSink& sink) override;
    void setBasebandHandler(std::function<void()> handler) override;

private:
    enum Kind : std::size_t { Sim, Cells, Contexts, Kinds };
    class Stream;

    void lookAround();
    void printPresence();
    void leaveModem();
    void takeModem(const ModemFacts& modem);
    void update(const ModemFacts& modem);
    void forgetCells();
    void endChannels();
    void followTechnology();

    void beginListening();
    void endListening();
    void tryEverything();
    void raiseSignalRate();
    void putSignalRateBack();
    void askForCells();
    void askForLocation();
    void takeCells(ModemOutcome outcome, std::vector<CellFacts> cells);
    void takeLocation(ModemOutcome outcome, std::optional<LocationFacts> location);

    Bytes record(Kind kind) const;
    void send(Kind kind);
    void printOnce(bool& isPrinted, const std::string& line);
    void remove(Stream& stream);

    RunLoop& _runLoop;
    const Clock& _clock;
    std::unique_ptr<ModemService> _service;
    std::string _wish;
    std::function<void()> _basebandHandler;
    Lifetime _lifetime;

    Technology _technology = Technology::GSM;
    std::optional<ModemFacts> _modem; // the one in use
    std::string _presence; // the newest line about modems there or not
    bool _isDenialPrinted = false;
    bool _isShortcomingPrinted = false;
    bool _isLocationDenialPrinted = false;
    bool _isSignalDenialPrinted = false;

    std::vector<Stream*> _streams;
    std::optional<Lifetime> _listening; // to one modem, from the first channel or the modem's coming on
    std::unique_ptr<Timer> _cellTimer;
    std::optional<std::uint32_t> _previousSignalRate; // to be put back
    bool _isAsking = false; // for cells or location, and not answered yet
    bool _canListCells = true;
    bool _canLocate = true;
    bool _hasAnswer = false; // cells or location were answered since listening began
    std::vector<CellFacts> _cells; // as listed
    std::optional<LocationFacts> _location;
};

} // namespace spectrel
