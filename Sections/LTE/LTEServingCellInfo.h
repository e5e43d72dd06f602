#pragma once

#include "LogGenerator/Template/RecordSection.h"
#include "Records/TelephonyConstants.h"

#include <array>

namespace spectrel {

/// The LTE serving cell, from two physical-layer records and from the cell-information record. Keys written by several
/// of them show whichever came last.
class LTEServingCellInfo final : public SectionOf<LTEServingCellInfo> {
    /// The byte is the bandwidth in resource blocks (3GPP TS 36.101, table 5.6-1).
    static constexpr CodeTexts<6> Bandwidths {
        {{6, "1.4 MHz"}, {15, "3 MHz"}, {25, "5 MHz"}, {50, "10 MHz"}, {75, "15 MHz"}, {100, "20 MHz"}}};

    /// Serving cell, in writing order: first what replaces the one channel of the cell information, then the rest.
    static constexpr std::array<Field, 3> ChannelFields {{
        {14, Width::U16, "Physical Cell ID", decimal},
        {16, Width::U16, "Download Frequency", decimal}, // E-ARFCN as received, not MHz
        {18, Width::U16, "Upload Frequency", decimal},
    }};
    static constexpr std::array<Field, 5> CellFields {{
        {20, Width::U8, "Download Bandwidth", named<Bandwidths>},
        {21, Width::U8, "Upload Bandwidth", named<Bandwidths>},
        {22, Width::U32, "Cell Identity", decimal},
        {26, Width::U16, "Tracking Area Code", decimal},
        {28, Width::U32, "Freq Band Indicator", decimal},
    }};
    void replaceCellInformation(RecordView record)
    {
        removeKey("UARFCN"); // this record supersedes what the cell information said
        storeFields(record, CellFields);
    }

    static constexpr std::array<Field, 1> AntennaFields {{
        {20, Width::U8, "Num Tx Antennas", decimal},
    }};
    void logAntennasAsUnknown(RecordView)
    {
        logUnknownMessage(AntennasCode); // although it is known: kept on purpose
    }

    /// Cell information, in writing order.
    static constexpr std::array<CellField, 5> CellInformationFields {{
        {kRKCellMonitorTAC, "Tracking Area Code", decimal, "Serving Cell Info: Failed to retrieve TAC\n"},
        {kRKCellMonitorCellId, "Cell Identity", decimal, "Serving Cell Info: Failed to retrieve Cell ID\n"},
        {kRKCellMonitorPID, "Physical Cell ID", decimal, "Serving Cell Info: Failed to retrieve Physical Cell ID\n"},
        {kRKCellMonitorBandInfo, "Freq Band Indicator", decimal,
            "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"},
        {kRKCellMonitorUARFCN, "UARFCN", decimal, "Serving Cell Info: Failed to retrieve UARFCN\n"},
    }};

    static constexpr std::uint32_t AntennasCode = 0xB0C1;
    static constexpr std::array<RecordLayout, 3> Layouts {{
        {.code = 0xB0C2,
            .minimumLength = 38,
            .fields = ChannelFields,
            .hook = hook<&LTEServingCellInfo::replaceCellInformation>},
        {.code = AntennasCode,
            .minimumLength = 22,
            .fields = AntennaFields,
            .hook = hook<&LTEServingCellInfo::logAntennasAsUnknown>},
        {.code = CellInfoArrayReader::Code,
            .cells = {CellChoice::FirstServing, {kRKCellMonitorRadioAccessTechnologyLTE}, CellInformationFields}},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {
        .name = "Serving Cell Info", .trace = "LTE Serving Cell Info", .layouts = Layouts};
};

} // namespace spectrel
