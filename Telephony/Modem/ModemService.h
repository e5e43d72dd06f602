#pragma once

#include "Telephony/Modem/ModemFacts.h"

#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace spectrel {

/// How a wish to a modem ended.
enum class ModemOutcome : std::uint8_t {
    Done,
    Denied, // this user may not
    Unsupported, // this modem, or this version of its service, cannot
    Failed, // not now: try again later
};

/// What keeps track of the system's modems. Nothing here blocks, but for the destructor, which sees the last wishes
/// off; handlers run from the run loop and may be dropped when the service object ends.
class ModemService {
public:
    using ChangeHandler = std::function<void()>;
    using CellsHandler = std::function<void(ModemOutcome, std::vector<CellFacts>)>;
    using LocationHandler = std::function<void(ModemOutcome, std::optional<LocationFacts>)>;
    using OutcomeHandler = std::function<void(ModemOutcome)>;

    virtual ~ModemService() = default;
    /// Called when a modem has come or gone, or when something known of one has changed.
    virtual void setChangeHandler(ChangeHandler handler) = 0;
    /// False while no program watches over modems.
    virtual bool isRunning() const = 0;
    /// The modems as they are known now, in the order of their numbers.
    virtual std::vector<ModemFacts> modems() const = 0;

    /// The cells that the modem hears now; the modem may take seconds to answer.
    virtual void listCells(const std::string& modem, CellsHandler handler) = 0;
    /// Where the modem is registered; none while it is nowhere.
    virtual void locate(const std::string& modem, LocationHandler handler) = 0;
    /// Has the modem measure its signal every so many seconds, for all clients alike; 0 is never.
    virtual void setSignalRate(const std::string& modem, std::uint32_t seconds, OutcomeHandler handler) = 0;
};

} // namespace spectrel
