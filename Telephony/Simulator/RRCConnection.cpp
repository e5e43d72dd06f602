#include "Telephony/Simulator/RRCConnection.h"

namespace spectrel {

namespace {

using namespace std::chrono_literals;

constexpr auto SetupTime = 900ms;
constexpr auto UpgradeTime = 500ms; // from a common to a dedicated channel
constexpr auto IdleOnDCH = 3s; // the network's inactivity timers
constexpr auto IdleOnFACH = 5s;
constexpr auto IdleOnPCH = 8s;
constexpr auto IdleOnURAPCH = 10s;

} // namespace

void RRCConnection::advance(std::chrono::milliseconds step, bool isNeeded)
{
    _inMode = _mode == RRCMode::CellDCH && isNeeded ? 0ms : _inMode + step;
    if (const RRCMode mode = next(isNeeded); mode != _mode) {
        _mode = mode;
        _inMode = 0ms;
    }
}

void RRCConnection::lose()
{
    _mode = RRCMode::Disconnected;
    _inMode = std::chrono::milliseconds::zero();
}

RRCMode RRCConnection::next(bool isNeeded) const
{
    switch (_mode) {
    case RRCMode::Disconnected:
        return isNeeded ? RRCMode::Connecting : _mode;
    case RRCMode::Connecting:
        return _inMode >= SetupTime ? RRCMode::CellDCH : _mode;
    case RRCMode::CellFACH:
        if (isNeeded)
            return _inMode >= UpgradeTime ? RRCMode::CellDCH : _mode;
        return _inMode >= IdleOnFACH ? RRCMode::CellPCH : _mode;
    case RRCMode::CellDCH:
        return _inMode >= IdleOnDCH ? RRCMode::CellFACH : _mode;
    case RRCMode::CellPCH:
        if (isNeeded)
            return RRCMode::CellFACH;
        return _inMode >= IdleOnPCH ? RRCMode::URAPCH : _mode;
    case RRCMode::URAPCH:
        if (isNeeded)
            return RRCMode::CellFACH;
        return _inMode >= IdleOnURAPCH ? RRCMode::Disconnected : _mode;
    }
    return _mode;
}

} // namespace spectrel
