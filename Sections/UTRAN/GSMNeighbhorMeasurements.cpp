#include "Sections/UTRAN/GSMNeighbhorMeasurements.h"

#include "LogGenerator/Template/RepeatedGroup.h"
#include "Platform/SystemLog.h"

#include <array>

namespace spectrel {

namespace {

constexpr RecordKind OwnRecord {
    "GSM Neighbor Cell List", 0xD00E, 17, "GSM Neighbor Cell List", Priority::Warning, UnknownCode::Ignored};

/// A cell, 8 bytes.
constexpr std::array<Field, 7> EntryFields {{
    {0, bits(0, 14), "Cell ID", decimal},
    {1, bits(6, 1), "Band Indicator", decimal},
    {1, bits(7, 1), "BSIC Valid", decimal},
    {2, Width::U8, "NCC", decimal},
    {3, Width::U8, "BCC", decimal},
    {4, Width::U16, "ARFCN", decimal},
    {6, Width::S16, "RSSI", decimal},
}};

} // namespace

GSMNeighbhorMeasurements::GSMNeighbhorMeasurements(ClassDictionary& dict, CodeDictionary& codeDict)
    : RecordSection(OwnRecord, dict, codeDict)
{
}

void GSMNeighbhorMeasurements::decode(RecordView record)
{
    clearList();
    replaceList(*entriesWithFields(record, {17, 8, record.u8(16)}, EntryFields));
}

} // namespace spectrel
