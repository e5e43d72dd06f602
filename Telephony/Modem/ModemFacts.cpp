#include "Telephony/Modem/ModemFacts.h"

#include <algorithm>
#include <array>
#include <charconv>

namespace spectrel {

namespace {

constexpr std::size_t CountryDigits = 3;

bool isDigits(std::string_view text)
{
    return std::all_of(text.begin(), text.end(), [](char character) { return character >= '0' && character <= '9'; });
}

/// Zero is how modems report what they do not know.
std::optional<std::uint32_t> known(std::string_view text)
{
    const auto number = hexadecimal(text);
    return number && *number != 0 ? number : std::nullopt;
}

} // namespace

std::optional<std::uint32_t> hexadecimal(std::string_view text)
{
    std::uint32_t number = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number, 16);
    if (error != std::errc() || end != text.data() + text.size())
        return std::nullopt;
    return number;
}

std::optional<LocationFacts> parseLocation(std::string_view text)
{
    std::array<std::string_view, 5> fields;
    std::size_t count = 0;
    for (bool isLast = false; !isLast; ++count) {
        if (count == fields.size())
            return std::nullopt;
        const std::size_t comma = text.find(',');
        isLast = comma == std::string_view::npos;
        fields[count] = text.substr(0, comma);
        text.remove_prefix(isLast ? text.size() : comma + 1);
    }
    const auto& [country, network, locationArea, cellId, trackingArea] = fields;
    const std::string operatorId = std::string(country) + std::string(network);
    if (count < 4 || country.size() != CountryDigits || !isOperatorId(operatorId))
        return std::nullopt;
    return LocationFacts {operatorId, known(locationArea), known(trackingArea), known(cellId)};
}

bool isOperatorId(std::string_view text)
{
    return (text.size() == CountryDigits + 2 || text.size() == CountryDigits + 3) && isDigits(text);
}

std::string networkName(std::string_view operatorId)
{
    if (!isOperatorId(operatorId))
        return std::string(operatorId);
    return std::string(operatorId.substr(0, CountryDigits)) + "-" + std::string(operatorId.substr(CountryDigits));
}

std::optional<CellFacts> registeredCell(const ModemFacts& modem, const std::optional<LocationFacts>& location)
{
    const bool knowsNothing = modem.operatorId.empty() && modem.signal == SignalFacts();
    if (!modem.cellKind || (!location && knowsNothing))
        return std::nullopt;
    CellFacts cell;
    cell.kind = *modem.cellKind;
    cell.isServing = true;
    cell.operatorId = location ? location->operatorId : modem.operatorId;
    if (location) {
        cell.areaCode = cell.kind == CellKind::LTE ? location->trackingArea : location->locationArea;
        cell.cellId = location->cellId;
    }
    return cell;
}

} // namespace spectrel
