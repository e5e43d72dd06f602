#include "Sections/UTRAN/UTRANServingCellInfo.h"

#include "LogGenerator/Template/CellFields.h"
#include "LogGenerator/Template/Fields.h"
#include "LogGenerator/Template/PropertyListReaders.h"
#include "Platform/SystemLog.h"
#include "Records/TelephonyConstants.h"

#include <array>

namespace spectrel {

namespace {

constexpr std::uint32_t ServingCellCode = 0xD0E2;
constexpr std::size_t ServingCellMinimumLength = 26; // bytes, header included

std::string_view allowedAccess(std::uint32_t bit, TextBuffer&)
{
    return bit ? "Emergency Calls Only" : "All Calls";
}

/// Serving cell, code 0xD0E2, in writing order; byte 16 is not read.
constexpr std::array<Field, 6> ServingCellFields {{
    {14, Width::U8, "Cell Access Restrictions", decimal},
    {21, Width::U32, "Cell ID", decimal},
    {19, Width::U16, "Downlink UARFCN", decimal},
    {17, Width::U16, "Uplink UARFCN", decimal},
    {15, Width::U8, "URA ID", decimal},
    {25, bits(0, 1), "Allowed Access", allowedAccess},
}};

/// Cell information, code 0xFF0001, in writing order.
constexpr std::array<CellField, 5> CellInformationFields {{
    {kRKCellMonitorLAC, "Local Area Code", decimal, "Serving Cell Info: Failed to retrieve LAC\n"},
    {kRKCellMonitorCellId, "Cell ID", decimal, "Serving Cell Info: Failed to retrieve Cell ID\n"},
    {kRKCellMonitorBandInfo, "Freq Band Indicator", decimal,
        "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"},
    {kRKCellMonitorSCN, "Cell Scrambling Code", decimal,
        "Serving Cell Info: Failed to retrieve Cell Scrambling Code\n"},
    {kRKCellMonitorUARFCN, "Uplink UARFCN", decimal, "Serving Cell Info: Failed to retrieve UARFCN\n"},
}};

} // namespace

UTRANServingCellInfo::UTRANServingCellInfo(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view UTRANServingCellInfo::getSectionName() const
{
    return "Serving Cell Info";
}

std::vector<std::uint32_t> UTRANServingCellInfo::getLogCodeArray() const
{
    return {ServingCellCode, CellInfoArrayReader::Code};
}

void UTRANServingCellInfo::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "Serving Cell Info");
    if (logCode == ServingCellCode)
        updateServingCell(record);
    else if (logCode == CellInfoArrayReader::Code)
        updateFromCellInformation(record);
}

void UTRANServingCellInfo::updateServingCell(RecordView record)
{
    if (record.size() >= ServingCellMinimumLength)
        storeFields(record, ServingCellFields, sectionRef);
}

void UTRANServingCellInfo::updateFromCellInformation(RecordView record)
{
    const CellInfoArrayReader reader(record);
    // Of several serving cells the last one's values remain.
    for (const DictionaryRef& cell : reader.servingCells(kRKCellMonitorRadioAccessTechnologyUTRAN2)) {
        storeCell(*cell, CellInformationFields, sectionRef);
        showOneChannelBothWays(*cell);
    }
}

/// The cell information knows one channel: it stands in both keys until a serving-cell record tells them apart.
void UTRANServingCellInfo::showOneChannelBothWays(const Dictionary& cell)
{
    TextBuffer buffer;
    if (const auto channel = cell[kRKCellMonitorUARFCN].int32())
        storeText("Downlink UARFCN", buffer.decimal(*channel).view());
}

} // namespace spectrel
