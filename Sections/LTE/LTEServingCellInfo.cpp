#include "Sections/LTE/LTEServingCellInfo.h"

#include "LogGenerator/Template/CellFields.h"
#include "LogGenerator/Template/Fields.h"
#include "LogGenerator/Template/PropertyListReaders.h"
#include "Platform/SystemLog.h"
#include "Records/TelephonyConstants.h"

#include <array>

namespace spectrel {

namespace {

constexpr std::uint32_t ServingCellCode = 0xB0C2;
constexpr std::uint32_t AntennasCode = 0xB0C1;

// Bytes, 13-byte header included; a shorter record changes nothing and logs nothing.
constexpr std::size_t ServingCellMinimumLength = 38;
constexpr std::size_t AntennasMinimumLength = 22;

/// The byte is the bandwidth in resource blocks (3GPP TS 36.101, table 5.6-1).
std::string_view bandwidth(std::uint32_t resourceBlocks, TextBuffer&)
{
    switch (resourceBlocks) {
    case 6:
        return "1.4 MHz";
    case 15:
        return "3 MHz";
    case 25:
        return "5 MHz";
    case 50:
        return "10 MHz";
    case 75:
        return "15 MHz";
    case 100:
        return "20 MHz";
    default:
        return "Unknown";
    }
}

/// Serving cell, code 0xB0C2, in writing order.
constexpr std::array<Field, 8> ServingCellFields {{
    {14, Width::U16, "Physical Cell ID", decimal},
    {16, Width::U16, "Download Frequency", decimal}, // E-ARFCN as received, not MHz
    {18, Width::U16, "Upload Frequency", decimal},
    {20, Width::U8, "Download Bandwidth", bandwidth},
    {21, Width::U8, "Upload Bandwidth", bandwidth},
    {22, Width::U32, "Cell Identity", decimal},
    {26, Width::U16, "Tracking Area Code", decimal},
    {28, Width::U32, "Freq Band Indicator", decimal},
}};

/// Antennas, code 0xB0C1.
constexpr std::array<Field, 1> AntennaFields {{
    {20, Width::U8, "Num Tx Antennas", decimal},
}};

/// Cell information, code 0xFF0001, in writing order.
constexpr std::array<CellField, 5> CellInformationFields {{
    {kRKCellMonitorTAC, "Tracking Area Code", decimal, "Serving Cell Info: Failed to retrieve TAC\n"},
    {kRKCellMonitorCellId, "Cell Identity", decimal, "Serving Cell Info: Failed to retrieve Cell ID\n"},
    {kRKCellMonitorPID, "Physical Cell ID", decimal, "Serving Cell Info: Failed to retrieve Physical Cell ID\n"},
    {kRKCellMonitorBandInfo, "Freq Band Indicator", decimal,
        "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"},
    {kRKCellMonitorUARFCN, "UARFCN", decimal, "Serving Cell Info: Failed to retrieve UARFCN\n"},
}};

} // namespace

LTEServingCellInfo::LTEServingCellInfo(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view LTEServingCellInfo::getSectionName() const
{
    return "Serving Cell Info";
}

std::vector<std::uint32_t> LTEServingCellInfo::getLogCodeArray() const
{
    return {ServingCellCode, AntennasCode, CellInfoArrayReader::Code};
}

void LTEServingCellInfo::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "LTE Serving Cell Info");
    switch (logCode) {
    case ServingCellCode:
        return updateServingCell(record);
    case AntennasCode:
        return updateAntennas(record);
    case CellInfoArrayReader::Code:
        return updateFromCellInformation(record);
    default:
        logUnknownMessage(logCode);
    }
}

void LTEServingCellInfo::updateServingCell(RecordView record)
{
    if (record.size() < ServingCellMinimumLength)
        return;
    const std::span fields(ServingCellFields);
    storeFields(record, fields.first(3), sectionRef);
    removeKey("UARFCN"); // this record supersedes what the cell information told
    storeFields(record, fields.subspan(3), sectionRef);
}

void LTEServingCellInfo::updateAntennas(RecordView record)
{
    if (record.size() < AntennasMinimumLength)
        return;
    storeFields(record, AntennaFields, sectionRef);
    logUnknownMessage(AntennasCode); // although it is known: kept on purpose
}

void LTEServingCellInfo::updateFromCellInformation(RecordView record)
{
    storeServingCell(record, {kRKCellMonitorRadioAccessTechnologyLTE}, CellInformationFields, sectionRef);
}

} // namespace spectrel
