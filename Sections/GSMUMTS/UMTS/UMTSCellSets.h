#pragma once

#include "LogGenerator/Template/RecordSection.h"

#include <array>

namespace spectrel {

/// The record of the cell sets that the UMTS receiver keeps, code 0x417A.
class UMTSCellSets {
public:
    static constexpr std::uint32_t Code = 0x417A;
    static constexpr std::size_t MinimumLength = 16;
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
    /// Primary scrambling code: 13 bits although it needs 9, as the set's type takes the other three of its 16.
    constexpr std::uint32_t scramblingCode(std::size_t index) const
    {
        return _record.bits(cells().entry(index) + 7, 0, 13);
    }
    /// Ec/Io as `Base::lookUpECNO` takes it: the first of the last three of a cell's eleven words that is not zero. The
    /// eight before them are not read: kept on purpose.
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
    /// The energies are a table of their own behind the last cell, in the cells' order.
    constexpr RepeatedGroup energies() const
    {
        return {16 + 15 * count(), 44, count()};
    }

    RecordView _record;
};

/// The cells that the UMTS receiver combines.
class ActiveSet final : public SectionOf<ActiveSet> {
    /// Received signal code power in dBm: the carrier's level, and of it the cell's share `ecno` in decibels.
    static int signalCodePower(std::int16_t receivedLevel, int ecno)
    {
        return (receivedLevel + 512) / 10 - 106 + ecno;
    }
    static DictionaryRef activeCell(const UMTSCellSets& sets, std::size_t index)
    {
        const int ecno = lookUpECNO(sets.energy(index));
        TextBuffer code;
        TextBuffer power;
        TextBuffer energy;
        return Dictionary::make({
            {"Scrambling Code", code.decimal(sets.scramblingCode(index)).view()},
            {"RSCP", power.decimal(signalCodePower(sets.receivedLevel(), ecno)).text(" dB").view()},
            {"Energy Per Chip", energy.decimal(ecno).text(" dB").view()},
        });
    }
    void listCells(RecordView record)
    {
        const UMTSCellSets sets(record);
        List cells;
        for (std::size_t index = 0; index < sets.count(); ++index) {
            if (sets.setType(index) == UMTSCellSets::ActiveSetType)
                cells.append(activeCell(sets, index));
        }
        replaceList(cells);
    }

    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = UMTSCellSets::Code, .minimumLength = UMTSCellSets::MinimumLength, .hook = hook<&ActiveSet::listCells>},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "Active Set", .trace = "ActiveSet", .layouts = Layouts};
};

// The other sets: lists that every cell-set record empties and no record ever fills, although it has their cells. Kept
// on purpose.
constexpr RepeatedGroup noCells(RecordView)
{
    return {0, 0, 0};
}
inline constexpr std::array<RecordLayout, 1> EmptiedByCellSets {{
    {.code = UMTSCellSets::Code, .minimumLength = UMTSCellSets::MinimumLength, .entries = {noCells, {}}},
}};
using DetectedSet = PlainSection<"Detected Set", "DetectedSet", EmptiedByCellSets>;
using MonitoredSet = PlainSection<"Monitored Set", "MonitoredSet", EmptiedByCellSets>;
using VirtualActiveSet = PlainSection<"Virtual Active Set", "VirtualActiveSet", EmptiedByCellSets>;

} // namespace spectrel
