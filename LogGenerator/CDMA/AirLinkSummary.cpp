#include "LogGenerator/CDMA/Decoders.h"
#include "LogGenerator/CDMA/DisplayTexts.h"
#include "LogGenerator/CDMA/Lookup.h"
#include "Platform/SystemLog.h"

#include <array>

namespace spectrel {

namespace {

constexpr unsigned long Length = 50; // bytes, exactly
constexpr std::size_t DeviceState = 36;
constexpr std::uint8_t Access = 4; // the first device state in which the phone transmits

std::string_view pilotOffset(std::uint32_t value, TextBuffer& buffer)
{
    return value == 0xFFFF ? "Invalid Value" : buffer.decimal(value).text(" \u00D7 64chips").view();
}

/// "0x%06x" of a field of 24 bits.
std::string_view sixHexDigits(std::uint32_t value, TextBuffer& buffer)
{
    constexpr std::string_view Digits = "0123456789abcdef";
    buffer.text("0x");
    for (int shift = 20; shift >= 0; shift -= 4)
        buffer.text(Digits.substr(value >> shift & 0xF, 1));
    return buffer.view();
}

constexpr std::array<Field, 4> AnyStateFields {{
    {13, bits(0, 11), "kChannel", decimal}, // the low three bits of byte 14 on top of byte 13
    {DeviceState, Width::U8, "k1xEVDODeviceState", evdoDeviceState},
    {14, bits(3, 5), "kBandClass", bandClass},
    {15, Width::S8, "kRxAGC0", wholePower},
}};

constexpr std::array<Field, 2> TransmittingFields {{
    {16, Width::S8, "kRxAGC1", wholePower},
    {17, Width::S8, "kTxAGC", wholePower},
}};

constexpr std::array<Field, 4> SessionFields {{
    {18, Width::U16, "kServingPNOffset", pilotOffset},
    {37, Width::U8, "kSessionState", evdoSessionState},
    {38, bits(0, 24), "kUATI24", sixHexDigits},
    {41, Width::U8, "kColorCode", decimal},
}};

} // namespace

void decodeAirLinkSummary(SystemLog& log, RecordView record, Dictionary&, const Value& lookup)
{
    if (record.size() != Length) {
        SPECTREL_LOG(log, Priority::Error, "Log code 0x1183 is %u bytes long but should be %lu bytes.",
            static_cast<unsigned>(record.size()), Length);
        return;
    }
    publishFields(record, AnyStateFields, lookup);
    if (record.u8(DeviceState) < Access) {
        for (const Field& field : TransmittingFields)
            setLookupText(field.key, "N/A", lookup);
    } else {
        publishFields(record, TransmittingFields, lookup);
    }
    publishFields(record, SessionFields, lookup);
}

} // namespace spectrel
