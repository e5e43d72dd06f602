#include "Sections/LTE/NeighborCellsList.h"

#include "Sections/LTE/IdleNeighbourRecord.h"
#include "Sections/LTE/LTEKind.h"
#include "Sections/LTE/Levels.h"

#include <array>

namespace spectrel {

namespace {

constexpr RecordKind OwnRecord =
    lteKind("Neighbor Cells List", IdleNeighbourRecord::Code, IdleNeighbourRecord::MinimumLength);

// Halves of a dBm also for RSRP, of which the serving cell's record has quarters: kept on purpose.
constexpr Formatter Power = fineLevel<2, -140, LevelUnit::dBm>;
constexpr Formatter RSRQ = fineLevel<4, -30, LevelUnit::dB>;

/// A neighbour, 20 bytes; 10, 11 and 16 to 19 are not read. The second antenna shows the first one's fields: kept on
/// purpose.
constexpr std::array<Field, 12> EntryFields {{
    {0, bits(0, 9), "Physical Cell ID", decimal},
    {1, bits(1, 8), "Measured RSSI", Power},
    {2, bits(1, 9), "Measured RSRP", Power},
    {4, bits(0, 9), "Average RSRP", Power},
    {5, bits(1, 7), "Measured RSRQ", RSRQ},
    {6, bits(0, 7), "Average RSRQ", RSRQ},
    {6, bits(7, 7), "Srxlev", Srxlev},
    {8, Width::U16, "Frequency Offset", decimal},
    {12, bits(0, 11), "Ant 0 Frame Offset", decimal},
    {13, bits(3, 19), "Ant 0 Sample Offset", decimal},
    {12, bits(0, 11), "Ant 1 Frame Offset", decimal},
    {13, bits(3, 19), "Ant 1 Sample Offset", decimal},
}};

constexpr const Field& PhysicalCellId = EntryFields[0];
constexpr std::span<const Field> Powers = std::span(EntryFields).subspan(1, 3); // RSSI and both RSRPs
constexpr std::span<const Field> Qualities = std::span(EntryFields).subspan(4, 2); // both RSRQs

/// One label for all five levels: kept on purpose.
void logNeighbour(RecordView record, std::size_t start)
{
    SPECTREL_LOG(
        Priority::Warning, "Physical Cell ID: %d\n", static_cast<int>(fieldValue(record, PhysicalCellId, start)));
    for (const Field& field : Powers)
        SPECTREL_LOG(Priority::Warning, "Measured RSSI: %lf\n", level<2, -140>(fieldValue(record, field, start)));
    for (const Field& field : Qualities)
        SPECTREL_LOG(Priority::Warning, "Measured RSSI: %lf\n", level<4, -30>(fieldValue(record, field, start)));
}

} // namespace

NeighborCellsList::NeighborCellsList(ClassDictionary& dict, CodeDictionary& codeDict)
    : RecordSection(OwnRecord, dict, codeDict)
{
}

void NeighborCellsList::decode(RecordView record)
{
    clearList();
    const RepeatedGroup neighbours = IdleNeighbourRecord::neighbours(record);
    SPECTREL_LOG(
        Priority::Warning, "Number of neighboring cells being reported: %d\n", static_cast<int>(neighbours.count));
    for (std::size_t index = 0; index < neighbours.count; ++index)
        logNeighbour(record, neighbours.entry(index));
    replaceList(*entriesWithFields(record, neighbours, EntryFields));
}

} // namespace spectrel
