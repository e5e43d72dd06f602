#pragma once

#include "LogGenerator/Template/RecordSection.h"
#include "Sections/LTE/Levels.h"

#include <array>

namespace spectrel {

/// Connected-mode intra-frequency measurement, code 0xB179: the serving cell, the measured neighbours and, after them,
/// the detected cells.
namespace ConnectedModeRecord {

constexpr std::uint32_t Code = 0xB179;
constexpr std::size_t MinimumLength = 29;

/// Filtered levels: quarters of a dB from -140 dBm, eighths of a dB from -20 dB.
constexpr Formatter FilteredRSRP = fineLevel<4, -140, LevelUnit::dBm>;
constexpr Formatter FilteredRSRQ = fineLevel<8, -20, LevelUnit::dB>;

constexpr RepeatedGroup measuredNeighbours(RecordView record)
{
    return {29, 6, record.u8(27)};
}

constexpr RepeatedGroup detectedCells(RecordView record)
{
    const RepeatedGroup measured = measuredNeighbours(record);
    return {measured.start + measured.entrySize * measured.count, 2, record.u8(28)};
}

} // namespace ConnectedModeRecord

/// The serving cell as measured in connected mode.
class ConnectedModeMeasurementMisc final : public SectionOf<ConnectedModeMeasurementMisc> {
    static constexpr std::array<Field, 5> Fields {{
        {17, Width::U16, "E-ARFCN", decimal},
        {19, Width::U16, "Serving Physical Cell ID", decimal},
        {21, Width::U16, "Subframe Number", decimal},
        {23, Width::U16, "Serving Filtered RSRP", ConnectedModeRecord::FilteredRSRP},
        {25, Width::U16, "Serving Filtered RSRQ", ConnectedModeRecord::FilteredRSRQ},
    }};
    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = ConnectedModeRecord::Code, .minimumLength = ConnectedModeRecord::MinimumLength, .fields = Fields},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {
        .name = "Connected mode LTE Intra-frequency Measurement", .layouts = Layouts};
};

/// The intra-frequency neighbours that connected mode measures. Every record of the code rebuilds the list.
class MeasuredNeighborCells final : public SectionOf<MeasuredNeighborCells> {
    /// A measured neighbour, 6 bytes.
    static constexpr std::array<Field, 3> EntryFields {{
        {0, Width::U16, "Physical Cell ID", decimal},
        {2, Width::U16, "Filtered RSRP", ConnectedModeRecord::FilteredRSRP},
        {4, Width::U16, "Filtered RSRQ", ConnectedModeRecord::FilteredRSRQ},
    }};
    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = ConnectedModeRecord::Code,
            .minimumLength = ConnectedModeRecord::MinimumLength,
            .entries = {ConnectedModeRecord::measuredNeighbours, EntryFields}},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "Measured Neighbor Cells", .layouts = Layouts};
};

/// The cells that connected mode has detected but does not measure. Every record of the code rebuilds the list.
class DetectedCells final : public SectionOf<DetectedCells> {
    /// A detected cell, 2 bytes.
    static constexpr std::array<Field, 1> EntryFields {{
        {0, Width::U16, "Physical Cell ID", decimal},
    }};
    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = ConnectedModeRecord::Code,
            .minimumLength = ConnectedModeRecord::MinimumLength,
            .entries = {ConnectedModeRecord::detectedCells, EntryFields}},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "Detected Cells", .layouts = Layouts};
};

} // namespace spectrel
