#include "Sections/GSMUMTS/UMTS/BLER.h"

#include "LogGenerator/Template/RepeatedGroup.h"
#include "Platform/SystemLog.h"

#include <array>

namespace spectrel {

namespace {

constexpr std::uint32_t BLERCode = 0x4116;
constexpr std::size_t BLERMinimumLength = 16; // bytes, 13-byte header included

/// Block errors, code 0x4116; the transport channels follow.
constexpr std::array<Field, 1> BLERFields {{
    {14, Width::U16, "Window Size", decimal},
}};

/// A transport channel of code 0x4116, in writing order; offsets from the entry's first byte.
constexpr std::array<Field, 3> ChannelFields {{
    {0, Width::U8, "Transport Channel ID", decimal},
    {1, Width::U32, "CRC Received", decimal},
    {5, Width::U32, "CRC Received in Error", decimal},
}};

} // namespace

BLER::BLER(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view BLER::getSectionName() const
{
    return "BLER";
}

std::vector<std::uint32_t> BLER::getLogCodeArray() const
{
    return {BLERCode};
}

void BLER::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "BLER");
    if (logCode != BLERCode)
        return logUnknownMessage(logCode);
    if (record.size() < BLERMinimumLength)
        return;
    storeFields(record, BLERFields, sectionRef);
    const RepeatedGroup channels {16, 9, record.u8(13)};
    store("Transport Channels", entriesWithFields(record, channels, ChannelFields));
}

} // namespace spectrel
