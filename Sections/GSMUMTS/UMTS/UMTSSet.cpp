#include "Sections/GSMUMTS/UMTS/UMTSSet.h"

#include "LogGenerator/Template/CellFields.h"
#include "LogGenerator/Template/PropertyListReaders.h"
#include "LogGenerator/Template/RepeatedGroup.h"
#include "Platform/SystemLog.h"
#include "Records/TelephonyConstants.h"

#include <array>

namespace spectrel {

namespace {

constexpr std::uint32_t RankedNeighborsCode = 0x4005;
constexpr std::size_t RankedNeighborsMinimumLength = 15; // bytes, 13-byte header included

/// The raw value is 21 above the RSCP.
std::string_view signalCodePower(std::uint32_t value, TextBuffer& buffer)
{
    return decimalDB(value - 21, buffer);
}

std::string_view halfDecibels(std::uint32_t value, TextBuffer& buffer)
{
    return buffer.fixed6(static_cast<std::int32_t>(value) * 0.5).text(" dB").view();
}

/// A ranked UMTS cell of code 0x4005, in writing order; offsets from the entry's first byte.
constexpr std::array<Field, 6> UMTSCellFields {{
    {2, Width::U16, "Scrambling Code", decimal},
    {4, Width::S8, "RSCP", signalCodePower},
    {7, Width::S8, "Energy Per Chip", halfDecibels},
    {0, Width::S16, "Downlink Frequency", decimal}, // UARFCN
    {8, Width::S16, "Ranking Value", decimal},
    {5, Width::S16, "Rank Cell RSCP", decimalDB},
}};

/// What the cell information tells for "not measured".
constexpr std::uint32_t NotMeasured = 32767;

std::string_view measuredDBm(std::uint32_t value, TextBuffer& buffer)
{
    return value == NotMeasured ? "" : decimalDBm(value, buffer);
}

std::string_view measuredDB(std::uint32_t value, TextBuffer& buffer)
{
    return value == NotMeasured ? "" : decimalDB(value, buffer);
}

/// A neighbour of the cell information, code 0xFF0001, in writing order.
constexpr std::array<CellField, 4> CellInformationFields {{
    {kRKCellMonitorUARFCN, "UARFCN", decimal, "UMTSSet: Failed to retrieve UARFCN\n"},
    {kRKCellMonitorSCN, "Scrambling Code", decimal, "UMTSSet: Failed to retrieve Scrambling Code\n"},
    {kRKCellMonitorRSCP, "RSCP", measuredDBm, "UMTSSet: Failed to retrieve RSCP\n"},
    {kRKCellMonitorECN0, "Energy Per Chip", measuredDB, "UMTSSet: Failed to retrieve Energy Per Chip\n"},
}};

} // namespace

UMTSSet::UMTSSet(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view UMTSSet::getSectionName() const
{
    return "UMTS Set";
}

std::vector<std::uint32_t> UMTSSet::getLogCodeArray() const
{
    return {RankedNeighborsCode, CellInfoArrayReader::Code};
}

void UMTSSet::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "UMTSSet");
    switch (logCode) {
    case RankedNeighborsCode:
        return updateRanked(record);
    case CellInfoArrayReader::Code:
        return listNeighborCells(record, kRKCellMonitorRadioAccessTechnologyUMTS, CellInformationFields, sectionRef);
    default:
        logUnknownMessage(logCode);
    }
}

void UMTSSet::updateRanked(RecordView record)
{
    if (record.size() < RankedNeighborsMinimumLength || !sectionRef.list())
        return;
    const RepeatedGroup cells {15, 10, record.u8(13)};
    replaceArray(*sectionRef.list(), *entriesWithFields(record, cells, UMTSCellFields));
}

} // namespace spectrel
