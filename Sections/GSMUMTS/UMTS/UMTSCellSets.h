#pragma once

#include "LogGenerator/Template/RepeatedGroup.h"

#include <cstddef>
#include <cstdint>

/// The record of the cell sets that the UMTS receiver keeps, which four sections show.
namespace spectrel {

constexpr std::uint32_t UMTSCellSetsCode = 0x417A;
constexpr std::size_t UMTSCellSetsMinimumLength = 16; // bytes, 13-byte header included

class UMTSCellSets {
public:
    static constexpr std::uint32_t ActiveSetType = 0;

    explicit constexpr UMTSCellSets(RecordView record)
        : _record(record)
    {
    }

    constexpr std::size_t count() const
    {
        return _record.u8(15);
    }
    /// Received level of the carrier, in tenths of a decibel from an origin of its own.
    constexpr std::int16_t receivedLevel() const
    {
        return _record.s16(13);
    }
    /// One cell; each throws `ArrayOutOfBoundsException` for an index that is not below the count.
    constexpr std::uint32_t setType(std::size_t index) const
    {
        return _record.bits(cells().entry(index) + 8, 5, 3);
    }
    constexpr std::uint32_t scramblingCode(std::size_t index) const
    {
        return _record.bits(cells().entry(index) + 7, 0, 13);
    }
    /// Ec/Io as `Base::lookUpECNO` takes it: the first of three words that is not zero.
    constexpr std::uint32_t energy(std::size_t index) const
    {
        const std::size_t entry = energies().entry(index);
        for (const std::size_t word : {32u, 36u}) {
            if (const std::uint32_t value = _record.u32(entry + word))
                return value;
        }
        return _record.u32(entry + 40);
    }

private:
    constexpr RepeatedGroup cells() const
    {
        return {16, 15, count()};
    }
    /// The energies follow the last cell.
    constexpr RepeatedGroup energies() const
    {
        return {16 + 15 * count(), 44, count()};
    }

    RecordView _record;
};

} // namespace spectrel
