#pragma once

#include "LogGenerator/Template/RecordSection.h"

#include <array>

namespace spectrel {

/// How many blocks of each transport channel came, and how many of them damaged.
class BLER final : public SectionOf<BLER> {
    static constexpr std::array<Field, 1> Fields {{
        {14, Width::U16, "Window Size", decimal},
    }};
    /// A transport channel, in writing order.
    static constexpr std::array<Field, 3> ChannelFields {{
        {0, Width::U8, "Transport Channel ID", decimal},
        {1, Width::U32, "CRC Received", decimal},
        {5, Width::U32, "CRC Received in Error", decimal},
    }};
    void storeChannels(RecordView record)
    {
        store("Transport Channels", entriesWithFields(record, {16, 9, record.u8(13)}, ChannelFields));
    }

    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = 0x4116, .minimumLength = 16, .fields = Fields, .hook = hook<&BLER::storeChannels>},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "BLER", .layouts = Layouts};
};

} // namespace spectrel
