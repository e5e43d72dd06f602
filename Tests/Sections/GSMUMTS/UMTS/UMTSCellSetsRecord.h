#pragma once

#include "Tests/Fakes/RecordBuilder.h"

#include <cstdint>
#include <vector>

namespace spectrel {

struct CellOfSet {
    std::uint32_t scramblingCode;
    std::uint32_t setType; // 0: active
    std::uint32_t energy[3]; // the last three words of the cell's energies
};

/// A cell-set record: the header, the carrier's raw level, the cells, and behind them their energies.
inline RecordBuilder umtsCellSets(std::int16_t level, const std::vector<CellOfSet>& cells)
{
    RecordBuilder record(0x417A, 16 + cells.size() * (15 + 44));
    record.u16(13, static_cast<std::uint16_t>(level)).u8(15, static_cast<std::uint32_t>(cells.size()));
    for (std::size_t i = 0; i < cells.size(); ++i) {
        const std::size_t cell = 16 + 15 * i;
        record.u8(cell + 7, cells[i].scramblingCode);
        record.u8(cell + 8, cells[i].scramblingCode >> 8 | cells[i].setType << 5);
        for (std::size_t word = 0; word < 3; ++word)
            record.u32(16 + 15 * cells.size() + 44 * i + 32 + 4 * word, cells[i].energy[word]);
    }
    return record;
}

} // namespace spectrel
