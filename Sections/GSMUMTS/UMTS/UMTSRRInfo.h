#pragma once

#include "LogGenerator/Template/RecordSection.h"
#include "Records/TelephonyConstants.h"

#include <array>
#include <limits>

namespace spectrel {

/// The RRC state, transmit power, serving cell and ciphering of a UMTS connection, and what the cell-information record
/// has of the serving cell. Keys written by several of them show whichever came last.
class UMTSRRInfo final : public SectionOf<UMTSRRInfo> {
    /// RRC states (3GPP TS 25.331, 7.1), indexed by their code.
    static constexpr std::array<std::string_view, 6> RRCStates {
        {"Disconnected", "Connecting", "CELL_FACH", "CELL_DCH", "CELL_PCH", "URA_PCH"}};
    static constexpr std::array<std::string_view, 2> DisabledEnabled {{"Disabled", "Enabled"}};

    static constexpr std::array<Field, 1> StateFields {{
        {13, Width::U8, "RRC State", named<RRCStates>},
    }};

    /// Serving cell, in writing order: first what replaces the one channel of the cell information, then the rest.
    static constexpr std::array<Field, 3> ChannelFields {{
        {21, Width::U32, "Cell ID", decimal},
        {17, Width::U32, "Downlink Frequency", decimal}, // UARFCN, as the next
        {13, Width::U32, "Uplink Frequency", decimal},
    }};
    static constexpr std::array<Field, 1> URAFields {{
        {25, Width::U16, "URA ID", decimal},
    }};
    void replaceCellInformation(RecordView record)
    {
        removeKey("UARFCN"); // this record supersedes what the cell information said
        storeFields(record, URAFields);
    }

    static constexpr std::array<Field, 1> CipheringFields {{
        {13, Width::U8, "Ciphering", flagged<DisabledEnabled>},
    }};

    /// Cell information, in writing order.
    static constexpr std::array<CellField, 3> CellInformationFields {{
        {kRKCellMonitorCellId, "Cell ID", decimal, "UMTSRRInfo: Failed to retrieve Cell ID\n"},
        {kRKCellMonitorUARFCN, "UARFCN", decimal, "UMTSRRInfo: Failed to retrieve UARFCN\n"},
        {kRKCellMonitorSCN, "Scrambling Code", decimal, "UMTSRRInfo: Failed to retrieve Scrambling Code\n"},
    }};

    void storeTransmitPower(RecordView record)
    {
        storeText("Transmit Power", TextBuffer().fixed2(meanTransmitPower(record)).text(" dBm").view());
    }
    /// The mean of the record's samples in dBm; not a number when it has none.
    static double meanTransmitPower(RecordView record)
    {
        const RepeatedGroup entries {16, 14, record.u8(14)};
        double sum = 0;
        int samples = 0;
        for (std::size_t index = 0; index < entries.count; ++index) {
            const std::int16_t raw = record.s16(entries.entry(index) + 4);
            if (raw == 0)
                continue; // no sample
            sum += (raw + 512) / 10 - 70;
            ++samples;
        }
        return samples > 0 ? sum / samples : std::numeric_limits<double>::quiet_NaN();
    }

    static constexpr std::array<RecordLayout, 5> Layouts {{
        {.code = 0x4125, .minimumLength = 14, .fields = StateFields},
        {.code = 0x4031, .minimumLength = 16, .hook = hook<&UMTSRRInfo::storeTransmitPower>},
        {.code = 0x4127,
            .minimumLength = 29,
            .fields = ChannelFields,
            .hook = hook<&UMTSRRInfo::replaceCellInformation>},
        {.code = 0x4157, .minimumLength = 19, .fields = CipheringFields},
        {.code = CellInfoArrayReader::Code,
            .cells = {CellChoice::FirstServing, {kRKCellMonitorRadioAccessTechnologyUMTS}, CellInformationFields}},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "UMTS RR Info", .trace = "UMTSRRInfo", .layouts = Layouts};
};

} // namespace spectrel
