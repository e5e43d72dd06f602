#pragma once

#include "LogGenerator/Template/RecordSection.h"
#include "Records/TelephonyConstants.h"

#include <array>

namespace spectrel {

/// The UMTS cells that were ranked for reselection, or the UMTS neighbours of the cell-information record, whichever
/// came last.
class UMTSSet final : public SectionOf<UMTSSet> {
    /// The raw value is 21 above the RSCP.
    static std::string_view signalCodePower(std::uint32_t value, TextBuffer& buffer)
    {
        return decimalDB(value - 21, buffer);
    }
    static std::string_view halfDecibels(std::uint32_t value, TextBuffer& buffer)
    {
        return buffer.fixed6(static_cast<std::int32_t>(value) * 0.5).text(" dB").view();
    }
    /// A ranked UMTS cell, in writing order.
    static constexpr std::array<Field, 6> CellFields {{
        {2, Width::U16, "Scrambling Code", decimal},
        {4, Width::S8, "RSCP", signalCodePower},
        {7, Width::S8, "Energy Per Chip", halfDecibels},
        {0, Width::S16, "Downlink Frequency", decimal}, // UARFCN
        {8, Width::S16, "Ranking Value", decimal},
        {5, Width::S16, "Rank Cell RSCP", decimalDB},
    }};
    static constexpr RepeatedGroup rankedCells(RecordView record)
    {
        return {15, 10, record.u8(13)};
    }

    /// What the cell information has for "not measured".
    static constexpr std::uint32_t NotMeasured = 32767;
    static std::string_view measuredDBm(std::uint32_t value, TextBuffer& buffer)
    {
        return value == NotMeasured ? "" : decimalDBm(value, buffer);
    }
    static std::string_view measuredDB(std::uint32_t value, TextBuffer& buffer)
    {
        return value == NotMeasured ? "" : decimalDB(value, buffer);
    }
    /// A neighbour of the cell information, in writing order.
    static constexpr std::array<CellField, 4> CellInformationFields {{
        {kRKCellMonitorUARFCN, "UARFCN", decimal, "UMTSSet: Failed to retrieve UARFCN\n"},
        {kRKCellMonitorSCN, "Scrambling Code", decimal, "UMTSSet: Failed to retrieve Scrambling Code\n"},
        {kRKCellMonitorRSCP, "RSCP", measuredDBm, "UMTSSet: Failed to retrieve RSCP\n"},
        {kRKCellMonitorECN0, "Energy Per Chip", measuredDB, "UMTSSet: Failed to retrieve Energy Per Chip\n"},
    }};

    static constexpr std::array<RecordLayout, 2> Layouts {{
        {.code = 0x4005, .minimumLength = 15, .entries = {rankedCells, CellFields}},
        {.code = CellInfoArrayReader::Code,
            .cells = {CellChoice::Neighbors, {kRKCellMonitorRadioAccessTechnologyUMTS}, CellInformationFields}},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "UMTS Set", .trace = "UMTSSet", .layouts = Layouts};
};

} // namespace spectrel
