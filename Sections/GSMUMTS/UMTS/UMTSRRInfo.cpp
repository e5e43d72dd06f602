#include "Sections/GSMUMTS/UMTS/UMTSRRInfo.h"

#include "LogGenerator/Template/CellFields.h"
#include "LogGenerator/Template/PropertyListReaders.h"
#include "LogGenerator/Template/RepeatedGroup.h"
#include "Platform/SystemLog.h"
#include "Records/TelephonyConstants.h"

#include <array>
#include <limits>

namespace spectrel {

namespace {

constexpr std::uint32_t StateCode = 0x4125;
constexpr std::uint32_t TransmitPowerCode = 0x4031;
constexpr std::uint32_t ServingCellCode = 0x4127;
constexpr std::uint32_t CipheringCode = 0x4157;

// Bytes, 13-byte header included; a shorter record changes nothing and logs nothing.
constexpr std::size_t TransmitPowerMinimumLength = 16;
constexpr std::size_t ServingCellMinimumLength = 29;

/// RRC states (3GPP TS 25.331, 7.1), indexed by their code.
constexpr std::array<std::string_view, 6> RRCStates {{
    "Disconnected",
    "Connecting",
    "CELL_FACH",
    "CELL_DCH",
    "CELL_PCH",
    "URA_PCH",
}};

constexpr std::array<std::string_view, 2> DisabledEnabled {{"Disabled", "Enabled"}};

/// RRC state, code 0x4125.
constexpr std::array<Field, 1> StateFields {{
    {13, Width::U8, "RRC State", named<RRCStates>},
}};

/// Serving cell, code 0x4127, in writing order.
constexpr std::array<Field, 4> ServingCellFields {{
    {21, Width::U32, "Cell ID", decimal},
    {17, Width::U32, "Downlink Frequency", decimal}, // UARFCN, as the next
    {13, Width::U32, "Uplink Frequency", decimal},
    {25, Width::U16, "URA ID", decimal},
}};

/// Ciphering, code 0x4157.
constexpr std::array<Field, 1> CipheringFields {{
    {13, Width::U8, "Ciphering", flagged<DisabledEnabled>},
}};

constexpr std::array<RecordLayout, 2> Layouts {{
    {StateCode, 14, StateFields},
    {CipheringCode, 19, CipheringFields},
}};

/// Cell information, code 0xFF0001, in writing order.
constexpr std::array<CellField, 3> CellInformationFields {{
    {kRKCellMonitorCellId, "Cell ID", decimal, "UMTSRRInfo: Failed to retrieve Cell ID\n"},
    {kRKCellMonitorUARFCN, "UARFCN", decimal, "UMTSRRInfo: Failed to retrieve UARFCN\n"},
    {kRKCellMonitorSCN, "Scrambling Code", decimal, "UMTSRRInfo: Failed to retrieve Scrambling Code\n"},
}};

/// The mean of the record's samples in dBm; not a number when it has none.
double meanTransmitPower(RecordView record)
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

} // namespace

UMTSRRInfo::UMTSRRInfo(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view UMTSRRInfo::getSectionName() const
{
    return "UMTS RR Info";
}

std::vector<std::uint32_t> UMTSRRInfo::getLogCodeArray() const
{
    return {StateCode, TransmitPowerCode, ServingCellCode, CipheringCode, CellInfoArrayReader::Code};
}

void UMTSRRInfo::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "UMTSRRInfo");
    switch (logCode) {
    case TransmitPowerCode:
        if (record.size() >= TransmitPowerMinimumLength)
            storeText("Transmit Power", TextBuffer().fixed2(meanTransmitPower(record)).text(" dBm").view());
        return;
    case ServingCellCode:
        return updateServingCell(record);
    case CellInfoArrayReader::Code:
        return storeServingCell(record, {kRKCellMonitorRadioAccessTechnologyUMTS}, CellInformationFields, sectionRef);
    default:
        if (!storeRecord(record, logCode, Layouts, sectionRef))
            logUnknownMessage(logCode);
    }
}

void UMTSRRInfo::updateServingCell(RecordView record)
{
    if (record.size() < ServingCellMinimumLength)
        return;
    const std::span fields(ServingCellFields);
    storeFields(record, fields.first(3), sectionRef);
    removeKey("UARFCN"); // this record supersedes what the cell information told
    storeFields(record, fields.subspan(3), sectionRef);
}

} // namespace spectrel
