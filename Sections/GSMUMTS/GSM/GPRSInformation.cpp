#include "Sections/GSMUMTS/GSM/GPRSInformation.h"

#include "LogGenerator/Template/Fields.h"
#include "Platform/SystemLog.h"

#include <array>

namespace spectrel {

namespace {

constexpr std::uint32_t NetworkControlCode = 0x51F5;
constexpr std::uint32_t ServingPLMNCode = 0x7135;
constexpr std::uint32_t PacketCellOptionsCode = 0x51F6;
constexpr std::uint32_t PBCCHCode = 0x51FB;
constexpr std::uint32_t PacketMeasurementCode = 0x51FD;
constexpr std::uint32_t SI13Code = 0x51F4;
constexpr std::uint32_t MeasurementCode = 0x5137;

constexpr std::uint32_t NotAvailable = 255;

std::string_view si13Position(std::uint32_t code, TextBuffer&)
{
    switch (code) {
    case 0:
        return "Located on BCCH";
    case 1:
        return "Located on Extended BCCH";
    case NotAvailable:
        return "Not Available";
    default:
        return "Unknown";
    }
}

std::string_view networkControlOrder(std::uint32_t code, TextBuffer&)
{
    switch (code) {
    case 0:
        return "NC0";
    case 1:
        return "NC1";
    case 2:
        return "NC2";
    case NotAvailable:
        return "Not Available";
    default:
        return "Unknown";
    }
}

std::string_view packetFlowContext(std::uint32_t code, TextBuffer&)
{
    switch (code) {
    case 0:
        return "Not Supported";
    case 1:
        return "Supported";
    case NotAvailable:
        return "Available"; // not the others' text: kept on purpose
    default:
        return "Unknown";
    }
}

constexpr std::array<std::string_view, 8> AccessThresholds {{
    "Barred (PKT access not allowed in the Cell)",
    "Barred",
    "Barred",
    "1 Only",
    "1 to 2",
    "1 to 3",
    "1 to 4",
    "Allowed",
}};

std::string_view accessThreshold(std::uint32_t code, TextBuffer& buffer)
{
    return code == NotAvailable ? "Not Available" : named<AccessThresholds>(code, buffer);
}

/// Waiting times (3GPP TS 44.060, table 12.24.2).
constexpr std::array<std::string_view, 8> T3192Times {{
    "500 ms",
    "1000 ms",
    "1500 ms",
    "0 ms",
    "80 ms",
    "120 ms",
    "160 ms",
    "200 ms",
}};

std::string_view t3192(std::uint32_t code, TextBuffer&)
{
    return code < T3192Times.size() ? T3192Times[code] : "?? ms";
}

constexpr std::array<std::string_view, 3> OperatingModes {{"Class 1", "Class 2", "Class 3"}};
constexpr std::array<std::string_view, 2> BurstTypes {{"8-bit format", "11-bit format"}};
constexpr std::array<std::string_view, 2> Support {{"Not Supported", "Supported"}};
constexpr std::array<std::string_view, 2> Application {{"Not Applied", "Applied"}};

constexpr std::array<Field, 1> SI13Fields {{
    {14, Width::U8, "SI13 Position", si13Position},
}};

constexpr std::array<Field, 3> NetworkControlFields {{
    {15, Width::U8, "Network Control Order", networkControlOrder},
    {13, Width::U8, "PFC Supported", packetFlowContext},
    {14, Width::U8, "Priority Access Threshold", accessThreshold},
}};

constexpr std::array<Field, 3> PacketCellOptionsFields {{
    {15, Width::U8, "T3192", t3192},
    {17, Width::U8, "Access Burst Type", flagged<BurstTypes>},
    {16, Width::U8, "DRX Timer Max", decimal},
}};

constexpr std::array<Field, 1> PBCCHFields {{
    {13, Width::U8, "PBCCH Present", decimal},
}};

constexpr std::array<Field, 5> PacketMeasurementFields {{
    {16, Width::U8, "Ext Measurement Order", decimal},
    {13, Width::U8, "Packet PSI Status", decimal},
    {33, Width::U8, "Packet SI Status", flagged<Support>},
    {14, Width::U8, "Count LR", decimal},
    {15, Width::U8, "Count HR", decimal},
}};

constexpr std::array<Field, 1> MeasurementFields {{
    {26, Width::U8, "Cell Reselect Hysteresis", flagged<Application>},
}};

constexpr std::array<Field, 1> ServingPLMNFields {{
    {13, Width::U8, "Network Operating Mode", named<OperatingModes>},
}};

constexpr std::array<RecordLayout, 7> Layouts {{
    {NetworkControlCode, 18, NetworkControlFields},
    {ServingPLMNCode, 32, ServingPLMNFields},
    {PacketCellOptionsCode, 24, PacketCellOptionsFields},
    {PBCCHCode, 34, PBCCHFields},
    {PacketMeasurementCode, 35, PacketMeasurementFields},
    {SI13Code, 15, SI13Fields},
    {MeasurementCode, 29, MeasurementFields},
}};

} // namespace

GPRSInformation::GPRSInformation(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view GPRSInformation::getSectionName() const
{
    return "GPRS Information";
}

std::vector<std::uint32_t> GPRSInformation::getLogCodeArray() const
{
    return {NetworkControlCode, ServingPLMNCode, PacketCellOptionsCode, PBCCHCode, PacketMeasurementCode, SI13Code,
        MeasurementCode};
}

void GPRSInformation::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "GPRSInformation");
    if (!storeRecord(record, logCode, Layouts, sectionRef))
        logUnknownMessage(logCode);
}

} // namespace spectrel
