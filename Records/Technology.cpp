#include "Records/Technology.h"
#include "Records/TelephonyConstants.h"
#include "Values/Table.h"

#include <array>

namespace spectrel {

namespace {

struct TechnologyNames {
    Technology technology;
    std::string_view name;
    std::string_view constant;
};

constexpr std::array<TechnologyNames, 5> Technologies {{
    {Technology::IFX, "ifx", kRKLogChannelTechnology_IFX},
    {Technology::GSM, "gsm", kRKLogChannelTechnology_Zephyr_GSM},
    {Technology::CDMA, "cdma", kRKLogChannelTechnology_Zephyr_CDMA},
    {Technology::LTE, "lte", kRKLogChannelTechnology_Zephyr_LTE},
    {Technology::UTRAN, "utran", kRKLogChannelTechnology_Zephyr_UTRAN2},
}};

std::optional<Technology> technologyWith(std::string_view TechnologyNames::*member, std::string_view text)
{
    const auto* names = findRow(Technologies, text, member);
    return names ? std::optional(names->technology) : std::nullopt;
}

} // namespace

std::string_view technologyName(Technology technology)
{
    return Technologies[static_cast<std::size_t>(technology)].name;
}

std::optional<Technology> technologyNamed(std::string_view name)
{
    return technologyWith(&TechnologyNames::name, name);
}

std::string_view technologyConstant(Technology technology)
{
    return Technologies[static_cast<std::size_t>(technology)].constant;
}

std::optional<Technology> technologyOfConstant(std::string_view constant)
{
    return technologyWith(&TechnologyNames::constant, constant);
}

} // namespace spectrel
