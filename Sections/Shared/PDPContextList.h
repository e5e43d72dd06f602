#pragma once

#include "LogGenerator/Template/RecordSection.h"

#include <array>

namespace spectrel {

/// The packet data contexts, exactly as the telephony service sent them. Shared by every technology.
class PDPContextList final : public SectionOf<PDPContextList> {
    /// Replaces the list; a payload that is no list changes nothing.
    void listContexts(RecordView record)
    {
        const ContextArrayReader reader(record, payloads());
        if (reader.contexts())
            replaceList(*reader.contexts());
    }

    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = ContextArrayReader::Code, .hook = hook<&PDPContextList::listContexts>},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "PDP Context Info",
        .trace = "PDPContextList",
        .layouts = Layouts,
        .unknownCode = UnknownCode::DecodedAsFirst};
};

} // namespace spectrel
