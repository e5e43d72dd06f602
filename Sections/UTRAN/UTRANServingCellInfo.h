#pragma once

#include "LogGenerator/Template/RecordSection.h"
#include "Records/TelephonyConstants.h"

#include <array>

namespace spectrel {

/// The UTRAN serving cell, from its own record and from the cell-information record. Keys written by both show
/// whichever came last.
class UTRANServingCellInfo final : public SectionOf<UTRANServingCellInfo> {
    static constexpr std::array<std::string_view, 2> AllowedAccess {{"All Calls", "Emergency Calls Only"}};

    /// Serving cell, in writing order; byte 16 is not read.
    static constexpr std::array<Field, 6> ServingCellFields {{
        {14, Width::U8, "Cell Access Restrictions", decimal},
        {21, Width::U32, "Cell ID", decimal},
        {19, Width::U16, "Downlink UARFCN", decimal},
        {17, Width::U16, "Uplink UARFCN", decimal},
        {15, Width::U8, "URA ID", decimal},
        {25, bits(0, 1), "Allowed Access", flagged<AllowedAccess>},
    }};

    /// Cell information, in writing order. It knows one channel, which stands in both keys until a serving-cell record
    /// separates them; `Silent` as its absence has been logged by then.
    static constexpr std::array<CellField, 6> CellInformationFields {{
        {kRKCellMonitorLAC, "Local Area Code", decimal, "Serving Cell Info: Failed to retrieve LAC\n"},
        {kRKCellMonitorCellId, "Cell ID", decimal, "Serving Cell Info: Failed to retrieve Cell ID\n"},
        {kRKCellMonitorBandInfo, "Freq Band Indicator", decimal,
            "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"},
        {kRKCellMonitorSCN, "Cell Scrambling Code", decimal,
            "Serving Cell Info: Failed to retrieve Cell Scrambling Code\n"},
        {kRKCellMonitorUARFCN, "Uplink UARFCN", decimal, "Serving Cell Info: Failed to retrieve UARFCN\n"},
        {kRKCellMonitorUARFCN, "Downlink UARFCN", decimal, CellField::Silent},
    }};

    static constexpr std::array<RecordLayout, 2> Layouts {{
        {.code = 0xD0E2, .minimumLength = 26, .fields = ServingCellFields},
        {.code = CellInfoArrayReader::Code,
            .cells = {CellChoice::EveryServing, {kRKCellMonitorRadioAccessTechnologyUTRAN2}, CellInformationFields}},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {
        .name = "Serving Cell Info", .layouts = Layouts, .unknownCode = UnknownCode::Ignored};
};

} // namespace spectrel
