#include "Sections/UTRAN/TRCHBLERMeasurement.h"

#include "Sections/UTRAN/TransportChannelRecord.h"

#include <array>

namespace spectrel {

namespace {

constexpr int NoticePriority = 5; // LOG_NOTICE, where every other section traces at 4: kept on purpose

constexpr RecordKind OwnRecord {"TRCH BLER", TransportChannelRecord::Code, TransportChannelRecord::MinimumLength,
    "TRCH BLER Measurement", NoticePriority, UnknownCode::Ignored};

/// A transport channel, 2 bytes.
constexpr std::array<Field, 2> EntryFields {{
    {0, Width::U8, "TRCH ID", decimal},
    {1, Width::U8, "TRCH BLER Measurement", decimal},
}};

} // namespace

TRCHBLERMeasurement::TRCHBLERMeasurement(ClassDictionary& dict, CodeDictionary& codeDict)
    : RecordSection(OwnRecord, dict, codeDict)
{
}

void TRCHBLERMeasurement::decode(RecordView record)
{
    clearList();
    replaceList(*entriesWithFields(record, TransportChannelRecord::transportChannels(record), EntryFields));
}

} // namespace spectrel
