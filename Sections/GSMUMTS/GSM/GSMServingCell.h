#pragma once

#include "LogGenerator/Template/RecordSection.h"
#include "Records/TelephonyConstants.h"

#include <array>

namespace spectrel {

/// The GSM serving cell's identity, level and path-loss criteria, dedicated channel, and what the cell-information
/// record has of it. Keys written by several of them show whichever came last.
class GSMServingCell final : public SectionOf<GSMServingCell> {
    static constexpr std::array<Field, 3> IdentityFields {{
        {17, Width::U16, "Cell ID", decimal},
        {13, Width::U16, "ARFCN", decimal},
        {15, Width::U16, "BSIC", decimal},
    }};
    /// Of the four bytes of each criterion only the lower two are shown.
    static constexpr std::array<Field, 3> MeasurementFields {{
        {15, Width::U8, "RSSI", decimalDBm},
        {16, Width::U16, "C1 Value", decimal},
        {20, Width::U16, "C2 Value", decimal},
    }};
    /// Of the two bytes of the channel only the lower is shown: kept on purpose.
    static constexpr std::array<Field, 1> DedicatedAllocationFields {{
        {13, Width::U8, "MA Dedicated ARFCN", decimal},
    }};
    static constexpr std::array<CellField, 2> CellInformationFields {{
        {kRKCellMonitorCellId, "Cell ID", decimal, "GSMServingCell: Failed to retrieve Cell ID\n"},
        {kRKCellMonitorARFCN, "ARFCN", decimal, "GSMServingCell: Failed to retrieve ARFCN\n"},
    }};

    static constexpr std::array<RecordLayout, 4> Layouts {{
        {.code = 0x5134, .minimumLength = 26, .fields = IdentityFields},
        {.code = 0x5137, .minimumLength = 29, .fields = MeasurementFields},
        {.code = 0x5076, .minimumLength = 17, .fields = DedicatedAllocationFields},
        {.code = CellInfoArrayReader::Code,
            .cells = {CellChoice::FirstServing, {kRKCellMonitorRadioAccessTechnologyGSM}, CellInformationFields}},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {
        .name = "GSM Serving Cell", .trace = "GSMServingCell", .layouts = Layouts};
};

} // namespace spectrel
