#pragma once

#include "Analysis/Cell.h"
#include "Analysis/Cells/CellTable.h"

#include <cstdint>
#include <optional>
#include <string>

namespace spectrel {

/// One value as read, with its place in a table.
struct ReadValue {
    Meaning meaning;
    Level level;
    double number = 0;
    Origin origin;
};

/// The number as an identity of the technology (area, cell, id, channel, band indicator); none for what is out of
/// range or reserved.
std::optional<std::uint32_t> identityOf(RadioTechnology technology, Meaning meaning, double number);
/// Whether the number can be such a level.
bool isPossible(Level level, double number);

/// What a cell's band and frequencies are found by, apart from its channel.
struct BandHints {
    std::optional<std::uint32_t> band; // as the display indicates it
    std::optional<std::uint32_t> uplinkChannel;
    ChannelNumbering umtsNumbering = ChannelNumbering::UTRAFDD;
};

/// Fills in site, sector and RNC from the cell identity.
void deriveParts(Cell& cell);
/// Fills in band and frequencies from the channel; leaves them out where the indicated band does not have it.
void deriveBand(Cell& cell, const BandHints& hints);
void setOrigin(Cell& cell, CellKey key, const Origin& origin);
/// Stores an identity or level that is in range; false for one that is not, or that is neither.
bool storeValue(Cell& cell, const ReadValue& value);

} // namespace spectrel
