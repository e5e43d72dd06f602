#include "Tests/Records/RecordingText.h"

namespace spectrel {

std::string u16(unsigned number)
{
    return {static_cast<char>(number), static_cast<char>(number >> 8)};
}

std::string u32(std::uint32_t number)
{
    return u16(number & 0xFFFF) + u16(number >> 16);
}

std::string record(unsigned code, std::string_view payload, char type)
{
    const auto length = static_cast<unsigned>(12 + payload.size());
    return type + u16(length) + u16(code) + std::string("\x10\x32\x54\x76\x98\xBA\xDC\xE0") + std::string(payload);
}

std::string wrapped(const std::string& record, char second)
{
    return std::string("\x81") + second + record;
}

std::string versionReport(std::uint32_t secondsSince1970)
{
    std::string report = u16(161) + u16(0x1FFD) + std::string(77, '\0') + u32(secondsSince1970);
    report.resize(161);
    return report;
}

RecordingText readRecording(const std::string& path)
{
    RecordingText text;
    const auto opened = openRecording(path);
    if (!opened) {
        text.reason = opened.failure().text;
        return text;
    }
    const auto& reader = *opened;
    text.isOpen = true;
    text.technology = reader->technology();
    for (RecordedMessage message; reader->next(message);) {
        text.messages.emplace_back(message.body.begin(), message.body.end());
        text.times.push_back(message.time.time_since_epoch().count());
    }
    text.damage = reader->damage();
    RecordedMessage message;
    if (reader->next(message))
        text.damage += " (and yet it goes on)";
    return text;
}

ByteView viewOf(std::string_view text)
{
    return {reinterpret_cast<const std::uint8_t*>(text.data()), text.size()};
}

} // namespace spectrel
