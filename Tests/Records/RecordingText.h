#pragma once

#include "Records/Recording.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// Little-endian.
std::string u16(unsigned number);
std::string u32(std::uint32_t number);

/// A log record of that many payload bytes (13 bytes and those).
std::string record(unsigned code, std::string_view payload = "", char type = '\x01');
/// The record behind a wrapper of two bytes.
std::string wrapped(const std::string& record, char second = '\x2A');
/// The 161 bytes that a DLF starts with, written at that second.
std::string versionReport(std::uint32_t secondsSince1970 = 0);

/// All that a recording holds.
struct RecordingText {
    bool isOpen = false;
    std::string reason; // when it is not
    std::optional<Technology> technology;
    std::vector<std::string> messages;
    std::vector<std::int64_t> times; // microseconds since 1970
    std::string damage;
};

RecordingText readRecording(const std::string& path);

ByteView viewOf(std::string_view text);

} // namespace spectrel
