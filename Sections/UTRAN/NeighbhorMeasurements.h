#pragma once

#include "LogGenerator/Template/RecordSection.h"

#include <array>

namespace spectrel {

/// The UTRAN cells around, with the set that each is in. Every record of the code rebuilds the list.
class UTRANNeighbhorMeasurements final : public SectionOf<UTRANNeighbhorMeasurements> {
    /// 256ths, as "%f".
    static std::string_view filterRSCP(std::uint32_t raw, TextBuffer& buffer)
    {
        return buffer.fixed6(static_cast<double>(raw) / 256).view();
    }
    static constexpr std::array<std::string_view, 2> FalseTrue {{"FALSE", "TRUE"}};

    /// A cell, 16 bytes; 4 to 15 are not read. Its status stands between the two halves.
    static constexpr std::array<Field, 3> FieldsBeforeStatus {{
        {0, bits(0, 14), "UARFCN", decimal},
        {1, bits(6, 7), "Cell ID", decimal},
        {2, bits(5, 8), "Filter RSCP", filterRSCP},
    }};
    static constexpr std::array<Field, 1> FieldsAfterStatus {{
        {3, bits(7, 1), "inJDCS", flagged<FalseTrue>},
    }};
    /// The set that a cell is in: active, monitored or detected. The fourth value writes no key.
    static constexpr std::array<std::string_view, 3> Statuses {"ASET", "MSET", "DSET"};

    /// The cells stand at the end of a fixed head of 168 bytes, of which a record need have only 21: those that it does
    /// not reach show zeros, kept on purpose.
    static constexpr RepeatedGroup cells(RecordView record)
    {
        return {168, 16, record.bits(16, 1, 7)};
    }
    static DictionaryRef cellEntry(RecordView record, std::size_t start)
    {
        const DictionaryRef entry = entryWithFields(record, FieldsBeforeStatus, start);
        if (const std::uint32_t status = record.bits(start + 3, 5, 2); status < Statuses.size())
            entry->setText("Status", Statuses[status]);
        spectrel::storeFields(record, FieldsAfterStatus, *entry, start);
        return entry;
    }
    void listCells(RecordView record)
    {
        replaceList(*eachEntry(cells(record), [record](std::size_t start) { return cellEntry(record, start); }));
    }

    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = 0xD00A, .minimumLength = 21, .hook = hook<&UTRANNeighbhorMeasurements::listCells>},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "Neighbor Cell List",
        .trace = "NeighbhorMeasurements List",
        .layouts = Layouts,
        .unknownCode = UnknownCode::Ignored};
};

/// The GSM cells around. Every record of the code rebuilds the list.
class GSMNeighbhorMeasurements final : public SectionOf<GSMNeighbhorMeasurements> {
    /// A cell, 8 bytes.
    static constexpr std::array<Field, 7> EntryFields {{
        {0, bits(0, 14), "Cell ID", decimal},
        {1, bits(6, 1), "Band Indicator", decimal},
        {1, bits(7, 1), "BSIC Valid", decimal},
        {2, Width::U8, "NCC", decimal},
        {3, Width::U8, "BCC", decimal},
        {4, Width::U16, "ARFCN", decimal},
        {6, Width::S16, "RSSI", decimal},
    }};
    static constexpr RepeatedGroup cells(RecordView record)
    {
        return {17, 8, record.u8(16)};
    }
    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = 0xD00E, .minimumLength = 17, .entries = {cells, EntryFields}},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {
        .name = "GSM Neighbor Cell List", .layouts = Layouts, .unknownCode = UnknownCode::Ignored};
};

} // namespace spectrel
