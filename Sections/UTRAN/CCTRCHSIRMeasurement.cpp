#include "Sections/UTRAN/CCTRCHSIRMeasurement.h"

#include "Platform/SystemLog.h"
#include "Sections/UTRAN/TransportChannelRecord.h"

#include <array>

namespace spectrel {

namespace {

constexpr RecordKind OwnRecord {"CCTRCH SIR", TransportChannelRecord::Code, TransportChannelRecord::MinimumLength,
    "CCTRCH SIR Measurement", Priority::Warning, UnknownCode::Ignored};

/// A coded composite channel, 8 bytes, before its ratios.
constexpr std::array<Field, 2> EntryFields {{
    {0, Width::U8, "CCTRCH ID", decimal},
    {1, Width::U8, "TSNUM", decimal},
}};

ListRef signalToInterference(RecordView record, const RepeatedGroup& slots)
{
    auto ratios = List::make();
    TextBuffer buffer;
    for (std::size_t slot = 0; slot < slots.count; ++slot) {
        buffer.clear();
        ratios->append(buffer.decimal(record.u8(slots.entry(slot))).view());
    }
    return ratios;
}

} // namespace

CCTRCHSIRMeasurement::CCTRCHSIRMeasurement(ClassDictionary& dict, CodeDictionary& codeDict)
    : RecordSection(OwnRecord, dict, codeDict)
{
}

void CCTRCHSIRMeasurement::decode(RecordView record)
{
    clearList();
    const RepeatedGroup group = TransportChannelRecord::codedCompositeChannels(record);
    List channels;
    for (std::size_t index = 0; index < group.count; ++index) {
        const std::size_t start = group.entry(index);
        const DictionaryRef entry = entryWithFields(record, EntryFields, start);
        entry->set("SIR", signalToInterference(record, TransportChannelRecord::timeSlots(start)));
        channels.append(entry);
    }
    replaceList(channels);
}

} // namespace spectrel
