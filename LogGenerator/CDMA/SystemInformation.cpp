#include "LogGenerator/CDMA/Decoders.h"
#include "LogGenerator/CDMA/DisplayTexts.h"
#include "LogGenerator/CDMA/Lookup.h"
#include "Platform/SystemLog.h"

#include <array>

namespace spectrel {

namespace {

constexpr unsigned long MinimumLength = 171;
constexpr std::size_t Version = 13;
constexpr std::uint8_t OldestVersion = 2;
constexpr std::size_t SystemType = 46;
constexpr std::uint32_t OneX = 2; // the system type that has the identifiers

constexpr std::array<Field, 1> RoamingFields {{
    {42, Width::U32, "k1xRoamingHome", roamingIndicator},
}};

constexpr std::array<Field, 2> IdentifierFields {{
    {50, Width::U16, "kSystemId", decimal},
    {52, Width::U16, "kNetworkId", decimal},
}};

constexpr std::array<Field, 3> StationFields {{
    {131, Width::U8, "kPacketZoneId", decimal},
    {184, Width::U16, "kBaseId", decimal}, // beyond the least length: 0 in a record that ends before
    {133, Width::U8, "kProtocolRevision", decimal},
}};

} // namespace

void decodeSystemInformation(SystemLog& log, RecordView record, Dictionary&, const Value& lookup)
{
    if (record.size() < MinimumLength) {
        SPECTREL_LOG(log, Priority::Error, "Log code 0x134f is %d bytes long but must be at least %lu bytes.",
            static_cast<int>(record.size()), MinimumLength);
        return;
    }
    if (record.u8(Version) < OldestVersion) {
        SPECTREL_LOG(log, Priority::Error,
            "Log code 0x134f has version=%d; only version 2 or higher expected; dropping.", record.u8(Version));
        return;
    }
    publishFields(record, RoamingFields, lookup);
    if (const std::uint32_t type = record.u32(SystemType); type == OneX) {
        publishFields(record, IdentifierFields, lookup);
    } else {
        TextBuffer buffer;
        buffer.text("(unknown system type ").decimal(static_cast<std::int32_t>(type)).text(")");
        for (const Field& field : IdentifierFields)
            setLookupText(field.key, buffer.view(), lookup);
    }
    publishFields(record, StationFields, lookup);
}

} // namespace spectrel
