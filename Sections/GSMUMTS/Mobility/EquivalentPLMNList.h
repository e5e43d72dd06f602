#pragma once

#include "LogGenerator/Template/RecordSection.h"

#include <array>

namespace spectrel {

/// The networks that count as equivalent to the serving one.
class EquivalentPLMNList final : public SectionOf<EquivalentPLMNList> {
    /// Six bytes of one digit each, country and network code by turns. Entries stand only three bytes apart, so each
    /// shares three bytes with the next: kept on purpose.
    static constexpr std::size_t EntryStride = 3;

    static std::uint32_t number(RecordView record, std::size_t firstDigit)
    {
        return record.u8(firstDigit) * 100u + record.u8(firstDigit + 2) * 10u + record.u8(firstDigit + 4);
    }

    static DictionaryRef network(RecordView record, std::size_t entry)
    {
        TextBuffer countryCode;
        TextBuffer networkCode;
        return Dictionary::make({
            {"Mobile Country Code", countryCode.decimal(number(record, entry)).view()},
            {"Mobile Network Code", networkCode.decimal(number(record, entry + 1)).view()},
        });
    }

    void listNetworks(RecordView record)
    {
        replaceList(*eachEntry(
            {17, EntryStride, record.u8(16)}, [record](std::size_t start) { return network(record, start); }));
    }

    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = 0x7150, .minimumLength = 17, .hook = hook<&EquivalentPLMNList::listNetworks>},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "Equivalent PLMN List", .layouts = Layouts};
};

} // namespace spectrel
