#pragma once

#include "Telephony/Reports/UTRANReports.h"

#include <chrono>

namespace spectrel {

/// A phone's connection to the radio network controller: set up when something is to be sent, stepped down through the
/// common channels while nothing is (3GPP TS 25.331, 7.1).
class RRCConnection {
public:
    void advance(std::chrono::milliseconds step, bool isNeeded);
    /// Ends at once: the cell is gone.
    void lose();

    RRCMode mode() const
    {
        return _mode;
    }
    bool isOnDedicatedChannel() const
    {
        return _mode == RRCMode::CellDCH;
    }

private:
    RRCMode next(bool isNeeded) const;

    RRCMode _mode = RRCMode::Disconnected;
    std::chrono::milliseconds _inMode {0};
};

} // namespace spectrel
