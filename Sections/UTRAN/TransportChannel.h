#pragma once

#include "LogGenerator/Template/RecordSection.h"

#include <array>

namespace spectrel {

/// Transport-channel quality, code 0xD00C.
namespace TransportChannelRecord {

constexpr std::uint32_t Code = 0xD00C;
constexpr std::size_t MinimumLength = 17;

constexpr RepeatedGroup transportChannels(RecordView record)
{
    return {17, 2, record.bits(14, 6, 6)};
}

/// They do not follow the transport channels directly: kept on purpose.
constexpr RepeatedGroup codedCompositeChannels(RecordView record)
{
    return {289 + 34 * transportChannels(record).count, 8, record.bits(15, 4, 4)};
}

/// The six time slots of a coded composite channel that starts at `channel`: a ratio of one byte each.
constexpr RepeatedGroup timeSlots(std::size_t channel)
{
    return {channel + 2, 1, 6};
}

} // namespace TransportChannelRecord

/// The transport channels with their block error rates. Every record of the code rebuilds the list.
class TRCHBLERMeasurement final : public SectionOf<TRCHBLERMeasurement> {
    static constexpr int NoticePriority = 5; // LOG_NOTICE, where every other section traces at 4: kept on purpose

    /// A transport channel, 2 bytes.
    static constexpr std::array<Field, 2> EntryFields {{
        {0, Width::U8, "TRCH ID", decimal},
        {1, Width::U8, "TRCH BLER Measurement", decimal},
    }};
    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = TransportChannelRecord::Code,
            .minimumLength = TransportChannelRecord::MinimumLength,
            .entries = {TransportChannelRecord::transportChannels, EntryFields}},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "TRCH BLER",
        .trace = "TRCH BLER Measurement",
        .layouts = Layouts,
        .unknownCode = UnknownCode::Ignored,
        .tracePriority = NoticePriority};
};

/// The coded composite transport channels, with the signal-to-interference ratio in each of six time slots. Every
/// record of the code rebuilds the list.
class CCTRCHSIRMeasurement final : public SectionOf<CCTRCHSIRMeasurement> {
    /// A coded composite channel, 8 bytes, before its ratios.
    static constexpr std::array<Field, 2> EntryFields {{
        {0, Width::U8, "CCTRCH ID", decimal},
        {1, Width::U8, "TSNUM", decimal},
    }};

    static DictionaryRef channelEntry(RecordView record, std::size_t start)
    {
        DictionaryRef entry = entryWithFields(record, EntryFields, start);
        entry->set("SIR", eachEntry(TransportChannelRecord::timeSlots(start), [record](std::size_t slot) {
            return Value(TextBuffer().decimal(record.u8(slot)).view());
        }));
        return entry;
    }
    void listChannels(RecordView record)
    {
        replaceList(*eachEntry(TransportChannelRecord::codedCompositeChannels(record),
            [record](std::size_t start) { return channelEntry(record, start); }));
    }

    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = TransportChannelRecord::Code,
            .minimumLength = TransportChannelRecord::MinimumLength,
            .hook = hook<&CCTRCHSIRMeasurement::listChannels>},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "CCTRCH SIR",
        .trace = "CCTRCH SIR Measurement",
        .layouts = Layouts,
        .unknownCode = UnknownCode::Ignored};
};

} // namespace spectrel
