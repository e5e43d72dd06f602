#pragma once

#include "LogGenerator/Template/RecordSection.h"
#include "Records/TelephonyConstants.h"

#include <array>

namespace spectrel {

/// The network that serves the phone, from the serving-network record, the registration state and the cell-information
/// record. Keys written by several of them show whichever came last; country and network codes are digits in the first
/// and plain numbers in the last, which have no leading zeros.
class ServingPLMN final : public SectionOf<ServingPLMN> {
    /// A nibble's digit; a filler (0xF) and anything else that is no digit is a blank.
    static char digit(std::uint32_t nibble)
    {
        return nibble < 10 ? static_cast<char>('0' + nibble) : ' ';
    }

    static std::string_view threeDigits(
        std::uint32_t first, std::uint32_t second, std::uint32_t third, TextBuffer& buffer)
    {
        const std::array digits {digit(first & 0xF), digit(second & 0xF), digit(third & 0xF)};
        return buffer.text({digits.data(), digits.size()}).view();
    }

    /// Three nibbles, the first digit lowest.
    static std::string_view countryCode(std::uint32_t nibbles, TextBuffer& buffer)
    {
        return threeDigits(nibbles, nibbles >> 4, nibbles >> 8, buffer);
    }

    /// Three nibbles, the third digit lowest: it stands before the other two.
    static std::string_view networkCode(std::uint32_t nibbles, TextBuffer& buffer)
    {
        return threeDigits(nibbles >> 4, nibbles >> 8, nibbles, buffer);
    }

    static std::string_view decimalBigEndian16(std::uint32_t value, TextBuffer& buffer)
    {
        return buffer.decimal((value & 0xFF) << 8 | value >> 8).view();
    }

    static constexpr std::array<std::string_view, 5> ServiceTypes {{
        "NO_SERVICE",
        "CS_ONLY",
        "PS_ONLY",
        "CS_PS_SERVICE",
        "LIMITED_SERVICE",
    }};

    static constexpr std::array<std::string_view, 5> SelectionModes {{
        "Automatic",
        "Manual",
        "Limited",
        "LIMITED_ROUTINE_ACQ",
        "LIMITED_MANUAL_ACQ",
    }};

    /// Serving network, in writing order. Bytes 15 to 17 are a PLMN identity (3GPP TS 24.008, 10.5.1.3).
    static constexpr std::array<Field, 5> ServingPLMNFields {{
        {15, bits(0, 12), "Mobile Country Code", countryCode},
        {16, bits(4, 12), "Mobile Network Code", networkCode},
        {18, Width::U16, "Location Area Code", decimalBigEndian16},
        {20, Width::U8, "Routing Area Code", decimal},
        {14, Width::U8, "Service Type", named<ServiceTypes>},
    }};

    /// Registration state.
    static constexpr std::array<Field, 1> SelectionModeFields {{
        {14, Width::U8, "PLMN Sel Mod", named<SelectionModes>},
    }};

    /// Cell information, in writing order.
    static constexpr std::array<CellField, 3> CellInformationFields {{
        {kRKCellMonitorMCC, "Mobile Country Code", decimal, "ServingPLMN: Failed to retrieve MCC\n"},
        {kRKCellMonitorMNC, "Mobile Network Code", decimal, "ServingPLMN: Failed to retrieve MNC\n"},
        {kRKCellMonitorLAC, "Location Area Code", decimal, "ServingPLMN: Failed to retrieve LAC\n"},
    }};

    static constexpr std::array<RecordLayout, 3> Layouts {{
        {.code = 0x7135, .minimumLength = 32, .fields = ServingPLMNFields},
        {.code = 0x7132, .minimumLength = 16, .fields = SelectionModeFields},
        {.code = CellInfoArrayReader::Code,
            .cells = {CellChoice::FirstServing,
                {kRKCellMonitorRadioAccessTechnologyUMTS, kRKCellMonitorRadioAccessTechnologyGSM},
                CellInformationFields}},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "Serving PLMN", .layouts = Layouts};
};

} // namespace spectrel
