#pragma once

#include "LogGenerator/Template/RecordSection.h"

#include <array>

namespace spectrel {

/// The hopping sequence number and the frequencies hopped over.
class MobileAllocation final : public SectionOf<MobileAllocation> {
    static constexpr std::array<Field, 1> Fields {{
        {13, Width::U8, "HSN", decimal},
    }};
    void storeFrequencies(RecordView record)
    {
        const RepeatedGroup frequencies {15, 2, record.u8(14)};
        store("ARFCNs", eachEntry(frequencies, [record](std::size_t start) {
            return Value(TextBuffer().decimal(record.u16(start)).view());
        }));
    }

    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = 0x51F8, .minimumLength = 15, .fields = Fields, .hook = hook<&MobileAllocation::storeFrequencies>},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {
        .name = "Mobile Allocation", .trace = "MobileAllocation", .layouts = Layouts};
};

} // namespace spectrel
