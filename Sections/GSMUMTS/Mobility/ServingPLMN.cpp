#include "Sections/GSMUMTS/Mobility/ServingPLMN.h"

#include "LogGenerator/Template/CellFields.h"
#include "LogGenerator/Template/Fields.h"
#include "LogGenerator/Template/PropertyListReaders.h"
#include "Platform/SystemLog.h"
#include "Records/TelephonyConstants.h"
#include "Sections/GSMUMTS/Mobility/MobilityManagement.h"

#include <array>

namespace spectrel {

namespace {

constexpr std::uint32_t ServingPLMNCode = 0x7135;

/// A nibble's digit; a filler (0xF) and anything else that is no digit is a blank.
char digit(std::uint32_t nibble)
{
    return nibble < 10 ? static_cast<char>('0' + nibble) : ' ';
}

std::string_view threeDigits(std::uint32_t first, std::uint32_t second, std::uint32_t third, TextBuffer& buffer)
{
    const std::array digits {digit(first & 0xF), digit(second & 0xF), digit(third & 0xF)};
    return buffer.text({digits.data(), digits.size()}).view();
}

/// Three nibbles, the first digit lowest.
std::string_view countryCode(std::uint32_t nibbles, TextBuffer& buffer)
{
    return threeDigits(nibbles, nibbles >> 4, nibbles >> 8, buffer);
}

/// Three nibbles, the third digit lowest: it stands before the other two.
std::string_view networkCode(std::uint32_t nibbles, TextBuffer& buffer)
{
    return threeDigits(nibbles >> 4, nibbles >> 8, nibbles, buffer);
}

std::string_view decimalBigEndian16(std::uint32_t value, TextBuffer& buffer)
{
    return buffer.decimal((value & 0xFF) << 8 | value >> 8).view();
}

constexpr std::array<std::string_view, 5> ServiceTypes {{
    "NO_SERVICE",
    "CS_ONLY",
    "PS_ONLY",
    "CS_PS_SERVICE",
    "LIMITED_SERVICE",
}};

constexpr std::array<std::string_view, 5> SelectionModes {{
    "Automatic",
    "Manual",
    "Limited",
    "LIMITED_ROUTINE_ACQ",
    "LIMITED_MANUAL_ACQ",
}};

/// Serving network, code 0x7135, in writing order. Bytes 15 to 17 are a PLMN identity (3GPP TS 24.008, 10.5.1.3).
constexpr std::array<Field, 5> ServingPLMNFields {{
    {15, bits(0, 12), "Mobile Country Code", countryCode},
    {16, bits(4, 12), "Mobile Network Code", networkCode},
    {18, Width::U16, "Location Area Code", decimalBigEndian16},
    {20, Width::U8, "Routing Area Code", decimal},
    {14, Width::U8, "Service Type", named<ServiceTypes>},
}};

/// Registration state, code 0x7132.
constexpr std::array<Field, 1> SelectionModeFields {{
    {14, Width::U8, "PLMN Sel Mod", named<SelectionModes>},
}};

constexpr std::array<RecordLayout, 2> Layouts {{
    {ServingPLMNCode, 32, ServingPLMNFields},
    {RegistrationStateCode, RegistrationStateMinimumLength, SelectionModeFields},
}};

/// Cell information, code 0xFF0001, in writing order.
constexpr std::array<CellField, 3> CellInformationFields {{
    {kRKCellMonitorMCC, "Mobile Country Code", decimal, "ServingPLMN: Failed to retrieve MCC\n"},
    {kRKCellMonitorMNC, "Mobile Network Code", decimal, "ServingPLMN: Failed to retrieve MNC\n"},
    {kRKCellMonitorLAC, "Location Area Code", decimal, "ServingPLMN: Failed to retrieve LAC\n"},
}};

} // namespace

ServingPLMN::ServingPLMN(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view ServingPLMN::getSectionName() const
{
    return "Serving PLMN";
}

std::vector<std::uint32_t> ServingPLMN::getLogCodeArray() const
{
    return {ServingPLMNCode, RegistrationStateCode, CellInfoArrayReader::Code};
}

void ServingPLMN::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "Serving PLMN");
    if (logCode == CellInfoArrayReader::Code)
        return storeServingCell(record,
            {kRKCellMonitorRadioAccessTechnologyUMTS, kRKCellMonitorRadioAccessTechnologyGSM}, CellInformationFields,
            sectionRef);
    if (!storeRecord(record, logCode, Layouts, sectionRef))
        logUnknownMessage(logCode);
}

} // namespace spectrel
