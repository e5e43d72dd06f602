#pragma once

#include "LogGenerator/Template/RecordSection.h"
#include "Records/TelephonyConstants.h"

#include <array>
#include <map>

namespace spectrel {

/// The GSM neighbours as the phone measures them, each with the BSIC that was last reported for its channel, or the GSM
/// neighbours of the cell-information record, whichever came last.
class NeighboringCells final : public SectionOf<NeighboringCells> {
    /// A measured neighbour, in writing order.
    static constexpr std::array<Field, 3> NeighborFields {{
        {0, Width::U16, "ARFCN", decimal},
        {2, Width::U8, "RSSI", decimal},
        {3, Width::U32, "C1 Value", decimal},
    }};
    void listMeasured(RecordView record)
    {
        replaceList(*eachEntry({29, 14, record.u8(28)}, [&](std::size_t start) {
            const auto cell = entryWithFields(record, NeighborFields, start);
            if (const auto known = arfcnToBsic.find(record.u16(start)); known != arfcnToBsic.end())
                cell->setText("BSIC", TextBuffer().decimal(known->second).view());
            return cell;
        }));
    }

    void keepBSICs(RecordView record)
    {
        arfcnToBsic.clear();
        const RepeatedGroup entries {15, 4, record.u8(14)};
        for (std::size_t index = 0; index < entries.count; ++index) {
            const std::size_t entry = entries.entry(index);
            arfcnToBsic[record.u16(entry)] = record.u8(entry + 2);
        }
    }

    /// The cell information counts levels in steps of 2 dBm; 32767 stands for "not measured".
    static std::string_view level(std::uint32_t value, TextBuffer& buffer)
    {
        return value == 32767 ? "" : decimalDBm(2 * value, buffer);
    }
    /// A neighbour of the cell information, in writing order.
    static constexpr std::array<CellField, 2> CellInformationFields {{
        {kRKCellMonitorARFCN, "ARFCN", decimal, "NeighboringCells: Failed to retrieve ARFCN\n"},
        {kRKCellMonitorRSSI, "RSSI", level, "NeighboringCells: Failed to retrieve RSSI\n"},
    }};

    static constexpr std::array<RecordLayout, 3> Layouts {{
        {.code = 0x5137, .minimumLength = 29, .hook = hook<&NeighboringCells::listMeasured>},
        {.code = 0x51FF, .minimumLength = 15, .hook = hook<&NeighboringCells::keepBSICs>},
        {.code = CellInfoArrayReader::Code,
            .cells = {CellChoice::Neighbors, {kRKCellMonitorRadioAccessTechnologyGSM}, CellInformationFields}},
    }};

    std::map<std::uint16_t, std::uint8_t> arfcnToBsic; // as the previous 0x51FF record had them

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {
        .name = "Neighboring Cells", .trace = "NeighboringCells", .layouts = Layouts};
};

} // namespace spectrel
