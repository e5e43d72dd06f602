#include "Sections/GSMUMTS/GSM/NeighboringCells.h"

#include "LogGenerator/Template/CellFields.h"
#include "LogGenerator/Template/PropertyListReaders.h"
#include "LogGenerator/Template/RepeatedGroup.h"
#include "Platform/SystemLog.h"
#include "Records/TelephonyConstants.h"

#include <array>

namespace spectrel {

namespace {

constexpr std::uint32_t MeasurementCode = 0x5137;
constexpr std::uint32_t BSICListCode = 0x51FF;

// Bytes, 13-byte header included; a shorter record changes nothing and logs nothing.
constexpr std::size_t MeasurementMinimumLength = 29;
constexpr std::size_t BSICListMinimumLength = 15;

/// A neighbour of code 0x5137, in writing order; offsets from the entry's first byte.
constexpr std::array<Field, 3> NeighborFields {{
    {0, Width::U16, "ARFCN", decimal},
    {2, Width::U8, "RSSI", decimal},
    {3, Width::U32, "C1 Value", decimal},
}};

/// The cell information counts levels in steps of 2 dBm; 32767 stands for "not measured".
std::string_view level(std::uint32_t value, TextBuffer& buffer)
{
    return value == 32767 ? "" : decimalDBm(2 * value, buffer);
}

/// A neighbour of the cell information, code 0xFF0001, in writing order.
constexpr std::array<CellField, 2> CellInformationFields {{
    {kRKCellMonitorARFCN, "ARFCN", decimal, "NeighboringCells: Failed to retrieve ARFCN\n"},
    {kRKCellMonitorRSSI, "RSSI", level, "NeighboringCells: Failed to retrieve RSSI\n"},
}};

} // namespace

NeighboringCells::NeighboringCells(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view NeighboringCells::getSectionName() const
{
    return "Neighboring Cells";
}

std::vector<std::uint32_t> NeighboringCells::getLogCodeArray() const
{
    return {MeasurementCode, BSICListCode, CellInfoArrayReader::Code};
}

void NeighboringCells::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "NeighboringCells");
    switch (logCode) {
    case BSICListCode:
        return updateBSICs(record);
    case MeasurementCode:
        return updateMeasured(record);
    case CellInfoArrayReader::Code:
        return listNeighborCells(record, kRKCellMonitorRadioAccessTechnologyGSM, CellInformationFields, sectionRef);
    default:
        logUnknownMessage(logCode);
    }
}

void NeighboringCells::updateBSICs(RecordView record)
{
    if (record.size() < BSICListMinimumLength)
        return;
    arfcnToBsic.clear();
    const RepeatedGroup entries {15, 4, record.u8(14)};
    for (std::size_t index = 0; index < entries.count; ++index) {
        const std::size_t entry = entries.entry(index);
        arfcnToBsic[record.u16(entry)] = record.u8(entry + 2);
    }
}

void NeighboringCells::updateMeasured(RecordView record)
{
    if (record.size() < MeasurementMinimumLength || !sectionRef.list())
        return;
    const RepeatedGroup neighbors {29, 14, record.u8(28)};
    List cells;
    for (std::size_t index = 0; index < neighbors.count; ++index) {
        const std::size_t start = neighbors.entry(index);
        const auto cell = entryWithFields(record, NeighborFields, start);
        if (const auto known = arfcnToBsic.find(record.u16(start)); known != arfcnToBsic.end())
            cell->setText("BSIC", TextBuffer().decimal(known->second).view());
        cells.append(cell);
    }
    replaceArray(*sectionRef.list(), cells);
}

} // namespace spectrel
