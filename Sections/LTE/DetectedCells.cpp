#include "Sections/LTE/DetectedCells.h"

#include "Sections/LTE/ConnectedModeRecord.h"
#include "Sections/LTE/LTEKind.h"

#include <array>

namespace spectrel {

namespace {

constexpr RecordKind OwnRecord =
    lteKind("Detected Cells", ConnectedModeRecord::Code, ConnectedModeRecord::MinimumLength);

/// A detected cell, 2 bytes.
constexpr std::array<Field, 1> EntryFields {{
    {0, Width::U16, "Physical Cell ID", decimal},
}};

} // namespace

DetectedCells::DetectedCells(ClassDictionary& dict, CodeDictionary& codeDict)
    : RecordSection(OwnRecord, dict, codeDict)
{
}

void DetectedCells::decode(RecordView record)
{
    clearList();
    replaceList(*entriesWithFields(record, ConnectedModeRecord::detectedCells(record), EntryFields));
}

} // namespace spectrel
