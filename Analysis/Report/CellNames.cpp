#include "Analysis/Report/CellNames.h"

namespace spectrel {

namespace {
constexpr std::uint32_t Colours = 10; // c0 to c9 in the page's style
}

std::string cellLetters(std::uint32_t number)
{
    std::string letters;
    for (std::uint32_t rest = number + 1; rest > 0; rest = (rest - 1) / 26)
        letters.insert(letters.begin(), static_cast<char>('A' + (rest - 1) % 26));
    return letters;
}

std::string cellColour(std::uint32_t number)
{
    return "c" + std::to_string(number % Colours);
}

std::string cellIdText(const Cell& cell)
{
    if (!cell.id)
        return "–";
    const std::string id = std::to_string(*cell.id);
    switch (cell.technology) {
    case RadioTechnology::GSM:
        return "BSIC " + std::to_string(*cell.id / 8) + "-" + std::to_string(*cell.id % 8);
    case RadioTechnology::UMTS:
        return "PSC " + id;
    case RadioTechnology::LTE:
        return "PCI " + id;
    case RadioTechnology::CDMA:
    case RadioTechnology::EVDO:
        return "PN " + id;
    }
    return id;
}

std::string radioTitle(RadioTechnology technology)
{
    switch (technology) {
    case RadioTechnology::GSM:
        return "GSM";
    case RadioTechnology::UMTS:
        return "UMTS";
    case RadioTechnology::LTE:
        return "LTE";
    case RadioTechnology::CDMA:
        return "CDMA2000 1x";
    case RadioTechnology::EVDO:
        return "EV-DO";
    }
    return {};
}

std::string cellIdentityText(const Cell& cell)
{
    const auto& first = cell.site ? cell.site : cell.rnc;
    if (first && cell.sector)
        return std::to_string(*first) + "-" + std::to_string(*cell.sector);
    return cell.cell ? std::to_string(*cell.cell) : "–";
}

} // namespace spectrel
