#pragma once

#include "LogGenerator/Template/RecordSection.h"

#include <array>

namespace spectrel {

/// The GSM cells that were ranked for reselection.
class GSMSet final : public SectionOf<GSMSet> {
    /// A ranked GSM cell, in writing order.
    static constexpr std::array<Field, 4> CellFields {{
        {0, Width::U16, "ARFCN", decimal},
        {2, Width::U16, "BSIC", decimal},
        {4, Width::S8, "RSSI", decimalDBm},
        {5, Width::S16, "Ranking Value", decimal},
    }};
    /// The entries are read from the start of the UMTS ones, which are not skipped: kept on purpose.
    static constexpr RepeatedGroup rankedCells(RecordView record)
    {
        return {15, 7, record.u8(14)};
    }
    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = 0x4005, .minimumLength = 15, .entries = {rankedCells, CellFields}},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "GSM Set", .trace = "GSMSet", .layouts = Layouts};
};

} // namespace spectrel
