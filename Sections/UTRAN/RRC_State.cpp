#include "Sections/UTRAN/RRC_State.h"

#include "Platform/DiagnosticLog.h"
#include "Platform/SystemLog.h"
#include "Values/Description.h"

#include <array>
#include <string>

namespace spectrel {

namespace {

constexpr std::uint32_t Code = 0xD0E0;
constexpr std::size_t ExpectedLength = 15;

constexpr std::uint8_t Valid = 1; // of the byte that tells whether the mode may be used
constexpr std::uint8_t NoMode = 255;

/// By the mode's number; any other is unknown.
constexpr std::array<std::string_view, 6> Modes {
    "Disconnected", "Connecting", "Cell Fach", "Cell DCH", "Cell PCH", "Cell URA PCH"};

std::uint8_t modeOf(RecordView record)
{
    return record.u8(13) == Valid ? record.u8(14) : NoMode;
}

std::string_view nameOf(std::uint8_t mode)
{
    return mode < Modes.size() ? Modes[mode] : "Unknown RRC Mode";
}

void tellDiagnosticLog(const Value& section, std::uint8_t mode)
{
    if (DiagnosticLog* const log = DiagnosticLog::installed())
        log->write("Display Dict = " + describe(section) + ", rrc mode = " + std::to_string(mode) + " "
            + std::string(nameOf(mode)));
}

} // namespace

RRC_State::RRC_State(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view RRC_State::getSectionName() const
{
    return "RRC Info";
}

std::vector<std::uint32_t> RRC_State::getLogCodeArray() const
{
    return {Code};
}

void RRC_State::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "RRC Info");
    if (logCode != Code)
        return;
    if (record.size() < ExpectedLength)
        SPECTREL_LOG(Priority::Warning, "LogCode_0xD0E0 is length is %ld expected size %ld",
            static_cast<long>(record.size()), static_cast<long>(ExpectedLength));
    const std::uint8_t mode = modeOf(record);
    storeText("State", nameOf(mode));
    tellDiagnosticLog(sectionRef, mode);
}

} // namespace spectrel
