#include "Sections/UTRAN/UTRANNeighbhorMeasurements.h"

#include "LogGenerator/Template/RepeatedGroup.h"
#include "Platform/SystemLog.h"

#include <array>

namespace spectrel {

namespace {

constexpr RecordKind OwnRecord {
    "Neighbor Cell List", 0xD00A, 21, "NeighbhorMeasurements List", Priority::Warning, UnknownCode::Ignored};

/// 256ths, as "%f".
std::string_view filterRSCP(std::uint32_t raw, TextBuffer& buffer)
{
    return buffer.fixed6(static_cast<double>(raw) / 256).view();
}

std::string_view inJDCS(std::uint32_t bit, TextBuffer&)
{
    return bit ? "TRUE" : "FALSE";
}

/// A cell, 16 bytes; 4 to 15 are not read. Its status stands between the two halves.
constexpr std::array<Field, 3> FieldsBeforeStatus {{
    {0, bits(0, 14), "UARFCN", decimal},
    {1, bits(6, 7), "Cell ID", decimal},
    {2, bits(5, 8), "Filter RSCP", filterRSCP},
}};
constexpr std::array<Field, 1> FieldsAfterStatus {{
    {3, bits(7, 1), "inJDCS", inJDCS},
}};

/// The set that a cell is in: active, monitored or detected. The fourth value writes no key.
constexpr std::array<std::string_view, 3> Statuses {"ASET", "MSET", "DSET"};

DictionaryRef cellEntry(RecordView record, std::size_t start)
{
    const DictionaryRef entry = entryWithFields(record, FieldsBeforeStatus, start);
    if (const std::uint32_t status = record.bits(start + 3, 5, 2); status < Statuses.size())
        entry->setText("Status", Statuses[status]);
    storeFields(record, FieldsAfterStatus, entry, start);
    return entry;
}

} // namespace

UTRANNeighbhorMeasurements::UTRANNeighbhorMeasurements(ClassDictionary& dict, CodeDictionary& codeDict)
    : RecordSection(OwnRecord, dict, codeDict)
{
}

void UTRANNeighbhorMeasurements::decode(RecordView record)
{
    clearList();
    const RepeatedGroup group {168, 16, record.bits(16, 1, 7)};
    List cells;
    for (std::size_t index = 0; index < group.count; ++index)
        cells.append(cellEntry(record, group.entry(index)));
    replaceList(cells);
}

} // namespace spectrel
