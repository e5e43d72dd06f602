#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

namespace spectrel {

/// The five radio technologies, by the names that the command line and the recordings use.
enum class Technology : std::uint8_t { IFX, GSM, CDMA, LTE, UTRAN };

/// "ifx", "gsm", "cdma", "lte", "utran".
std::string_view technologyName(Technology technology);
std::optional<Technology> technologyNamed(std::string_view name);
/// The telephony framework's constant, such as "kRKLogChannelTechnology_Zephyr_LTE".
std::string_view technologyConstant(Technology technology);
std::optional<Technology> technologyOfConstant(std::string_view constant);

} // namespace spectrel
