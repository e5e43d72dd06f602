#include "Sections/LTE/MeasuredNeighborCells.h"

#include "Sections/LTE/ConnectedModeRecord.h"
#include "Sections/LTE/LTEKind.h"

#include <array>

namespace spectrel {

namespace {

constexpr RecordKind OwnRecord =
    lteKind("Measured Neighbor Cells", ConnectedModeRecord::Code, ConnectedModeRecord::MinimumLength);

/// A measured neighbour, 6 bytes.
constexpr std::array<Field, 3> EntryFields {{
    {0, Width::U16, "Physical Cell ID", decimal},
    {2, Width::U16, "Filtered RSRP", ConnectedModeRecord::FilteredRSRP},
    {4, Width::U16, "Filtered RSRQ", ConnectedModeRecord::FilteredRSRQ},
}};

} // namespace

MeasuredNeighborCells::MeasuredNeighborCells(ClassDictionary& dict, CodeDictionary& codeDict)
    : RecordSection(OwnRecord, dict, codeDict)
{
}

void MeasuredNeighborCells::decode(RecordView record)
{
    clearList();
    replaceList(*entriesWithFields(record, ConnectedModeRecord::measuredNeighbours(record), EntryFields));
}

} // namespace spectrel
