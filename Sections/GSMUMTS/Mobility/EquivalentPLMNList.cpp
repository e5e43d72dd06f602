#include "Sections/GSMUMTS/Mobility/EquivalentPLMNList.h"

#include "LogGenerator/Template/RepeatedGroup.h"
#include "Platform/SystemLog.h"
#include "Values/Dictionary.h"

namespace spectrel {

namespace {

constexpr std::uint32_t EquivalentPLMNsCode = 0x7150;
constexpr std::size_t EquivalentPLMNsMinimumLength = 17; // bytes, 13-byte header included

/// Six bytes of one digit each, country and network code by turns. Entries stand only three bytes apart, so each shares
/// three bytes with the next: kept on purpose.
constexpr std::size_t EntryStride = 3;

std::uint32_t number(RecordView record, std::size_t firstDigit)
{
    return record.u8(firstDigit) * 100u + record.u8(firstDigit + 2) * 10u + record.u8(firstDigit + 4);
}

DictionaryRef network(RecordView record, std::size_t entry)
{
    TextBuffer country;
    TextBuffer network;
    return Dictionary::make({
        {"Mobile Country Code", country.decimal(number(record, entry)).view()},
        {"Mobile Network Code", network.decimal(number(record, entry + 1)).view()},
    });
}

} // namespace

EquivalentPLMNList::EquivalentPLMNList(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view EquivalentPLMNList::getSectionName() const
{
    return "Equivalent PLMN List";
}

std::vector<std::uint32_t> EquivalentPLMNList::getLogCodeArray() const
{
    return {EquivalentPLMNsCode};
}

void EquivalentPLMNList::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "Equivalent PLMN List");
    if (logCode != EquivalentPLMNsCode)
        return logUnknownMessage(logCode);
    const auto& list = sectionRef.list();
    if (record.size() < EquivalentPLMNsMinimumLength || !list)
        return;
    const RepeatedGroup entries {17, EntryStride, record.u8(16)};
    List networks;
    for (std::size_t index = 0; index < entries.count; ++index)
        networks.append(network(record, entries.entry(index)));
    replaceArray(*list, networks);
}

} // namespace spectrel
