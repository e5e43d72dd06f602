#pragma once

#include "LogGenerator/Template/RecordSection.h"
#include "Sections/LTE/Levels.h"

#include <array>

namespace spectrel {

/// Idle-mode neighbour measurement, code 0xB180.
namespace IdleNeighbourRecord {

constexpr std::uint32_t Code = 0xB180;
constexpr std::size_t MinimumLength = 21;

/// The record has the index of the last neighbour, so there are 1 to 32, never none.
constexpr RepeatedGroup neighbours(RecordView record)
{
    return {21, 20, record.bits(19, 6, 5) + 1};
}

} // namespace IdleNeighbourRecord

/// What the idle-mode neighbour measurement holds beside its list of cells.
class NeighborMeasurementMisc final : public SectionOf<NeighborMeasurementMisc> {
    static constexpr std::array<Field, 3> Fields {{
        {13, Width::U8, "Version", decimal},
        {17, Width::U16, "E-ARFCN", decimal},
        {19, bits(0, 6), "Qrxlevmin", Qrxlevmin},
    }};
    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = IdleNeighbourRecord::Code, .minimumLength = IdleNeighbourRecord::MinimumLength, .fields = Fields},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "Neighbor Measurements", .layouts = Layouts};
};

/// 1 to 32 neighbours as idle mode measures them. Every record of the code rebuilds the list.
class NeighborCellsList final : public SectionOf<NeighborCellsList> {
    // Halves of a dBm also for RSRP, of which the serving cell's record has quarters: kept on purpose.
    static constexpr Formatter Power = fineLevel<2, -140, LevelUnit::dBm>;
    static constexpr Formatter RSRQ = fineLevel<4, -30, LevelUnit::dB>;

    // A neighbour, 20 bytes; 10, 11 and 16 to 19 are not read. The second antenna shows the first one's fields: kept on
    // purpose.
    static constexpr std::array<Field, 1> CellFields {{
        {0, bits(0, 9), "Physical Cell ID", decimal},
    }};
    static constexpr std::array<Field, 3> PowerFields {{
        {1, bits(1, 8), "Measured RSSI", Power},
        {2, bits(1, 9), "Measured RSRP", Power},
        {4, bits(0, 9), "Average RSRP", Power},
    }};
    static constexpr std::array<Field, 2> QualityFields {{
        {5, bits(1, 7), "Measured RSRQ", RSRQ},
        {6, bits(0, 7), "Average RSRQ", RSRQ},
    }};
    static constexpr std::array<Field, 6> FurtherFields {{
        {6, bits(7, 7), "Srxlev", Srxlev},
        {8, Width::U16, "Frequency Offset", decimal},
        {12, bits(0, 11), "Ant 0 Frame Offset", decimal},
        {13, bits(3, 19), "Ant 0 Sample Offset", decimal},
        {12, bits(0, 11), "Ant 1 Frame Offset", decimal},
        {13, bits(3, 19), "Ant 1 Sample Offset", decimal},
    }};
    static constexpr auto EntryFields = joined(CellFields, PowerFields, QualityFields, FurtherFields);

    void logNeighbours(RecordView record)
    {
        const RepeatedGroup neighbours = IdleNeighbourRecord::neighbours(record);
        SPECTREL_LOG(log(), Priority::Warning, "Number of neighboring cells being reported: %d\n",
            static_cast<int>(neighbours.count));
        for (std::size_t index = 0; index < neighbours.count; ++index)
            logNeighbour(record, neighbours.entry(index));
    }
    /// One label for all five levels: kept on purpose.
    void logNeighbour(RecordView record, std::size_t start) const
    {
        for (const Field& field : CellFields)
            SPECTREL_LOG(
                log(), Priority::Warning, "Physical Cell ID: %d\n", static_cast<int>(fieldValue(record, field, start)));
        for (const Field& field : PowerFields)
            SPECTREL_LOG(
                log(), Priority::Warning, "Measured RSSI: %lf\n", level<2, -140>(fieldValue(record, field, start)));
        for (const Field& field : QualityFields)
            SPECTREL_LOG(
                log(), Priority::Warning, "Measured RSSI: %lf\n", level<4, -30>(fieldValue(record, field, start)));
    }

    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = IdleNeighbourRecord::Code,
            .minimumLength = IdleNeighbourRecord::MinimumLength,
            .entries = {IdleNeighbourRecord::neighbours, EntryFields},
            .hook = hook<&NeighborCellsList::logNeighbours>},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "Neighbor Cells List", .layouts = Layouts};
};

} // namespace spectrel
