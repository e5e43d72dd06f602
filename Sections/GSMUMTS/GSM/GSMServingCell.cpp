#include "Sections/GSMUMTS/GSM/GSMServingCell.h"

#include "LogGenerator/Template/CellFields.h"
#include "LogGenerator/Template/Fields.h"
#include "LogGenerator/Template/PropertyListReaders.h"
#include "Platform/SystemLog.h"
#include "Records/TelephonyConstants.h"

#include <array>

namespace spectrel {

namespace {

constexpr std::uint32_t IdentityCode = 0x5134;
constexpr std::uint32_t MeasurementCode = 0x5137;
constexpr std::uint32_t DedicatedAllocationCode = 0x5076;

/// Identity, code 0x5134, in writing order.
constexpr std::array<Field, 3> IdentityFields {{
    {17, Width::U16, "Cell ID", decimal},
    {13, Width::U16, "ARFCN", decimal},
    {15, Width::U16, "BSIC", decimal},
}};

/// Measurement, code 0x5137, in writing order. Of the four bytes of each criterion only the lower two are shown.
constexpr std::array<Field, 3> MeasurementFields {{
    {15, Width::U8, "RSSI", decimalDBm},
    {16, Width::U16, "C1 Value", decimal},
    {20, Width::U16, "C2 Value", decimal},
}};

/// Dedicated allocation, code 0x5076. Of the two bytes of the channel only the lower is shown: kept on purpose.
constexpr std::array<Field, 1> DedicatedAllocationFields {{
    {13, Width::U8, "MA Dedicated ARFCN", decimal},
}};

constexpr std::array<RecordLayout, 3> Layouts {{
    {IdentityCode, 26, IdentityFields},
    {MeasurementCode, 29, MeasurementFields},
    {DedicatedAllocationCode, 17, DedicatedAllocationFields},
}};

/// Cell information, code 0xFF0001, in writing order.
constexpr std::array<CellField, 2> CellInformationFields {{
    {kRKCellMonitorCellId, "Cell ID", decimal, "GSMServingCell: Failed to retrieve Cell ID\n"},
    {kRKCellMonitorARFCN, "ARFCN", decimal, "GSMServingCell: Failed to retrieve ARFCN\n"},
}};

} // namespace

GSMServingCell::GSMServingCell(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view GSMServingCell::getSectionName() const
{
    return "GSM Serving Cell";
}

std::vector<std::uint32_t> GSMServingCell::getLogCodeArray() const
{
    return {IdentityCode, MeasurementCode, DedicatedAllocationCode, CellInfoArrayReader::Code};
}

void GSMServingCell::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "GSMServingCell");
    if (logCode == CellInfoArrayReader::Code)
        return storeServingCell(record, {kRKCellMonitorRadioAccessTechnologyGSM}, CellInformationFields, sectionRef);
    if (!storeRecord(record, logCode, Layouts, sectionRef))
        logUnknownMessage(logCode);
}

} // namespace spectrel
