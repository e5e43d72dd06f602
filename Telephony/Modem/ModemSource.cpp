#include "Telephony/Modem/ModemSource.h"

#include "Telephony/Modem/ModemChoice.h"
#include "Telephony/Modem/ModemRecords.h"
#include "Telephony/ServiceLine.h"

#include <algorithm>
#include <utility>

namespace spectrel {

namespace {

const std::string HowToPermit = "to permit it, have spectrel-modem.conf and spectrel-modem.rules in place and join the "
                                "group spectrel, as docs/modem.md tells";

} // namespace

/// One channel's share. A record holds a state: for a client that is busy, only the newest of each kind waits.
class ModemSource::Stream final : public LogStream {
public:
    Stream(ModemSource& source, MessageSink& sink)
        : _source(source)
        , _sink(sink)
    {
    }
    ~Stream() override
    {
        _source.remove(*this);
    }

    void send(Kind kind, Bytes record)
    {
        _waiting[kind] = std::move(record);
        resume();
    }
    void resume() override
    {
        for (auto& record : _waiting) {
            if (record && !_sink.deliver(*record))
                return;
            record.reset();
        }
    }

private:
    ModemSource& _source;
    MessageSink& _sink;
    std::array<std::optional<Bytes>, Kinds> _waiting;
};

ModemSource::ModemSource(RunLoop& runLoop, const Clock& clock, std::unique_ptr<ModemService> service, std::string wish)
    : _runLoop(runLoop)
    , _clock(clock)
    , _service(std::move(service))
    , _wish(std::move(wish))
{
    _service->setChangeHandler([this] { lookAround(); });
    lookAround();
}

ModemSource::~ModemSource() = default;

void ModemSource::setBasebandHandler(std::function<void()> handler)
{
    _basebandHandler = std::move(handler);
}

std::unique_ptr<LogStream> ModemSource::start(MessageSink& sink)
{
    auto stream = std::make_unique<Stream>(*this, sink);
    _streams.push_back(stream.get());
    if (_modem) {
        stream->send(Sim, record(Sim));
        stream->send(Contexts, record(Contexts));
    }
    if (_listening && _hasAnswer)
        stream->send(Cells, record(Cells));
    beginListening();
    return stream;
}

void ModemSource::remove(Stream& stream)
{
    std::erase(_streams, &stream);
    if (_streams.empty())
        endListening();
}

/// Something about the modems has changed.
void ModemSource::lookAround()
{
    const auto modems = _service->modems();
    const ModemFacts* chosen = chooseModem(modems, _wish, _modem ? _modem->id : std::string());
    if (_modem && (!chosen || chosen->id != _modem->id))
        leaveModem();
    if (chosen && !_modem)
        takeModem(*chosen);
    else if (chosen)
        update(*chosen);
    printPresence();
}

void ModemSource::printPresence()
{
    std::string presence;
    if (_modem)
        presence = "using " + modemName(*_modem) + (_modem->sim ? "" : ", without a SIM")
            + (_modem->isEnabled ? "" : ", not enabled");
    else if (!_service->isRunning())
        presence = "no ModemManager on the system bus; waiting for it";
    else
        presence = _wish.empty() ? "no modem; waiting for one" : "no modem '" + _wish + "'; waiting for it";
    if (presence != std::exchange(_presence, presence))
        printServiceLine(presence);
}

void ModemSource::leaveModem()
{
    printServiceLine(modemName(*_modem) + " is no longer used");
    endListening();
    _modem.reset();
    endChannels(); // so that the programs show that nothing is heard any more
}

void ModemSource::takeModem(const ModemFacts& modem)
{
    _modem = modem;
    _isShortcomingPrinted = false;
    send(Sim);
    send(Contexts);
    beginListening();
    followTechnology();
}

void ModemSource::update(const ModemFacts& modem)
{
    const ModemFacts before = *std::exchange(_modem, modem);
    if (_listening && modem.isEnabled && !before.isEnabled)
        tryEverything();
    if (before.sim != modem.sim)
        send(Sim);
    if (before.bearers != modem.bearers)
        send(Contexts);
    followTechnology();
    if (_listening && before.cellKind != modem.cellKind)
        forgetCells();
    else if (_hasAnswer && before.signal != modem.signal)
        send(Cells);
}

/// Other cells serve now; they need not wait for their turn.
void ModemSource::forgetCells()
{
    _hasAnswer = false;
    _cells.clear();
    _location.reset();
    askForCells();
}

/// Channels live with one modem and one technology: a change ends them, and their clients begin anew.
void ModemSource::endChannels()
{
    _runLoop.async(_lifetime.guard([this] {
        if (_basebandHandler)
            _basebandHandler();
    }));
}

void ModemSource::followTechnology()
{
    if (!_modem->technology || *_modem->technology == _technology)
        return;
    _technology = *_modem->technology;
    printServiceLine("the technology is now " + std::string(technologyName(_technology)));
    endChannels();
}

void ModemSource::beginListening()
{
    if (_listening || !_modem || _streams.empty())
        return;
    _listening.emplace();
    tryEverything();
    _cellTimer = _runLoop.repeat(CellInterval, [this] { askForCells(); });
    askForCells();
}

void ModemSource::endListening()
{
    if (!_listening)
        return;
    putSignalRateBack();
    _listening.reset();
    _cellTimer.reset();
    _isAsking = false;
    _hasAnswer = false;
    _cells.clear();
    _location.reset();
}

/// What the modem can do, and this user may, shows by trying; a modem can more once it is enabled.
void ModemSource::tryEverything()
{
    _canListCells = true;
    _canLocate = true;
    raiseSignalRate();
}

void ModemSource::raiseSignalRate()
{
    const auto rate = _modem->signalRate;
    if (_previousSignalRate || !rate || (*rate > 0 && *rate <= SignalRate))
        return;
    _previousSignalRate = rate;
    _service->setSignalRate(_modem->id, SignalRate, _listening->guard([this](ModemOutcome outcome) {
        if (outcome == ModemOutcome::Done)
            return;
        _previousSignalRate.reset();
        if (outcome == ModemOutcome::Denied)
            printOnce(_isSignalDenialPrinted,
                "this user may not set how often the modem measures (Signal.Setup): signal values are shown only where "
                "another program has set it; "
                    + HowToPermit);
    }));
}

/// The rate is everybody's: another client that has changed it since has its way.
void ModemSource::putSignalRateBack()
{
    const auto previous = std::exchange(_previousSignalRate, std::nullopt);
    const bool isOurs = _modem->signalRate == SignalRate || _modem->signalRate == previous;
    if (previous && isOurs)
        _service->setSignalRate(_modem->id, *previous, [](ModemOutcome) {});
}

void ModemSource::askForCells()
{
    if (_isAsking)
        return; // the modem takes its time
    if (!_canListCells)
        return askForLocation();
    _isAsking = true;
    _service->listCells(_modem->id, _listening->guard([this](ModemOutcome outcome, std::vector<CellFacts> cells) {
        takeCells(outcome, std::move(cells));
    }));
}

void ModemSource::takeCells(ModemOutcome outcome, std::vector<CellFacts> cells)
{
    _isAsking = false;
    _cells = std::move(cells);
    _canListCells = outcome == ModemOutcome::Done || outcome == ModemOutcome::Failed;
    if (outcome == ModemOutcome::Denied)
        printOnce(_isDenialPrinted,
            "this user may not list the modem's cells (GetCellInfo): only the serving cell is shown, from location and "
            "signal; "
                + HowToPermit);
    if (outcome == ModemOutcome::Unsupported)
        printOnce(_isShortcomingPrinted,
            modemName(*_modem) + " cannot list its cells: only the serving cell is shown, from location and signal");
    if (_cells.empty())
        return askForLocation();
    _hasAnswer = true;
    send(Cells);
}

void ModemSource::askForLocation()
{
    if (!_canLocate)
        return takeLocation(ModemOutcome::Failed, std::nullopt);
    _isAsking = true;
    _service->locate(_modem->id, _listening->guard([this](ModemOutcome outcome, std::optional<LocationFacts> location) {
        takeLocation(outcome, std::move(location));
    }));
}

void ModemSource::takeLocation(ModemOutcome outcome, std::optional<LocationFacts> location)
{
    _isAsking = false;
    _hasAnswer = true;
    _location = std::move(location);
    if (outcome == ModemOutcome::Unsupported || outcome == ModemOutcome::Denied)
        _canLocate = false;
    if (outcome == ModemOutcome::Denied)
        printOnce(_isLocationDenialPrinted,
            "this user may not ask where the modem is registered (GetLocation): the serving cell has its network only; "
                + HowToPermit);
    send(Cells);
}

Bytes ModemSource::record(Kind kind) const
{
    const Moment now = _clock.now();
    if (kind == Sim)
        return modemSimRecord(_modem->sim, now);
    if (kind == Contexts)
        return modemContextsRecord(_modem->bearers, now);
    if (_hasAnswer && _cells.empty()) {
        const auto cell = registeredCell(*_modem, _location);
        return modemCellsRecord(cell ? std::vector {*cell} : std::vector<CellFacts>(), _modem->signal, now);
    }
    return modemCellsRecord(_cells, _modem->signal, now);
}

void ModemSource::send(Kind kind)
{
    if (_streams.empty())
        return;
    const Bytes made = record(kind);
    for (Stream* stream : _streams)
        stream->send(kind, made);
}

void ModemSource::printOnce(bool& isPrinted, const std::string& line)
{
    if (!std::exchange(isPrinted, true))
        printServiceLine(line);
}

} // namespace spectrel
