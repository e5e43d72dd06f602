#pragma once

#include "Analysis/Cell.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

enum class Connection : std::uint8_t { Idle, Connected };

/// "idle", "connected".
std::string_view connectionName(Connection connection);

/// A cell beside the serving one.
struct NeighbourCell : Cell {
    std::optional<double>
        difference; // its strength less that of the serving cell, where both have the same level, in dB
};

/// A packet data context. Rates are those between the last two stores of its counters.
struct DataContext {
    std::string name; // the APN, else the number in the list
    std::string state; // as shown; empty where it is not
    std::optional<double> downlinkKbps; // 1000 bit/s
    std::optional<double> uplinkKbps;
    Origin nameOrigin;
    Origin stateOrigin;
};

/// What the display means at a moment.
struct CellReport {
    std::uint64_t n = 0; // messages so far
    Moment time {};
    std::optional<Connection> connection;
    Origin connectionOrigin;
    std::string registration; // as shown; empty where it is not
    Origin registrationOrigin;
    std::optional<Cell>
        serving; // none while nothing tells it: no identity, or the display says that there is no service
    std::vector<Cell> active; // UMTS and CDMA: in the display's order; EV-DO's sector is the first of `evdo`
    std::vector<NeighbourCell> neighbours; // strongest first, equals by channel, then id; those without a level last
    std::vector<DataContext> contexts;
};

} // namespace spectrel
