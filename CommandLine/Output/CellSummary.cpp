#include "CommandLine/Output/CellSummary.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <string_view>

namespace spectrel {

namespace {

/// How people speak of a technology's cells, in its order.
struct Words {
    std::string_view technology;
    std::string_view band; // before a band's name
    std::string_view id;
    std::array<Level, 2> levels;
};
constexpr std::array<Words, 5> WordsOf {{
    {"GSM", " ", "BSIC", {Level::RSSI, Level::C1}},
    {"UMTS", " band ", "PSC", {Level::RSCP, Level::EcNo}},
    {"LTE", " band ", "PCI", {Level::RSRP, Level::RSRQ}},
    {"CDMA", " band class ", "PN", {Level::EcIo, Level::RSSI}},
    {"EV-DO", " band class ", "PN", {Level::EcIo, Level::RSSI}},
}};

const Words& wordsOf(const Cell& cell)
{
    return WordsOf[static_cast<std::size_t>(cell.technology)];
}

/// With one decimal at least.
std::string megahertz(double value)
{
    char digits[64];
    const auto end = std::to_chars(digits, digits + sizeof digits, value, std::chars_format::fixed).ptr;
    std::string text(digits, end);
    return text.find('.') == std::string::npos ? text + ".0" : text;
}

std::string tenths(double value)
{
    char digits[400];
    const auto end = std::to_chars(digits, digits + sizeof digits, value, std::chars_format::fixed, 1).ptr;
    return {digits, end};
}

std::string place(const Cell& cell)
{
    const Words& words = wordsOf(cell);
    std::string text(words.technology);
    // GSM bands have "GSM" in their names, or something else that says it.
    if (!cell.band.empty())
        text = cell.technology == RadioTechnology::GSM && cell.band.find("GSM") != std::string::npos
            ? cell.band
            : text + std::string(words.band) + cell.band;
    if (cell.downlinkMHz)
        text += ", " + megahertz(*cell.downlinkMHz) + " MHz";
    else if (cell.channel)
        text += ", channel " + std::to_string(*cell.channel);
    return text;
}

/// "PCI 52"; a BSIC as its two colour codes. GSM cells of which that is not known go by their channel.
std::string name(const Cell& cell)
{
    if (!cell.id)
        return cell.channel ? "channel " + std::to_string(*cell.channel) : std::string();
    const std::string id = cell.technology == RadioTechnology::GSM
        ? std::to_string(*cell.id / 8) + "-" + std::to_string(*cell.id % 8)
        : std::to_string(*cell.id);
    return std::string(wordsOf(cell).id) + " " + id;
}

std::string identity(const Cell& cell)
{
    const auto& group = cell.site ? cell.site : cell.rnc;
    if (group && cell.sector)
        return std::to_string(*group) + "-" + std::to_string(*cell.sector);
    return std::to_string(*cell.cell);
}

void appendLevels(const Cell& cell, std::string& out)
{
    for (const Level which : wordsOf(cell).levels) {
        if (const auto& level = cell.level(which))
            out += ", " + std::string(levelName(which)) + " " + tenths(*level) + " " + std::string(levelUnit(which));
    }
}

std::string described(const Cell& cell)
{
    std::string text = place(cell);
    if (cell.id)
        text += ", " + name(cell);
    if (cell.cell)
        text += ", cell " + identity(cell);
    appendLevels(cell, text);
    return text;
}

void appendNeighbours(const CellReport& report, std::string& out)
{
    if (report.neighbours.empty())
        return;
    const std::size_t count = report.neighbours.size();
    out += ", " + std::to_string(count) + (count == 1 ? " neighbour" : " neighbours");
    const NeighbourCell& best = report.neighbours.front();
    if (!best.strength())
        return;
    out += " (best " + name(best) + ", ";
    if (best.difference)
        out += (*best.difference >= 0 ? "+" : "") + tenths(*best.difference) + " dB";
    else
        out += tenths(*best.strength()) + " " + std::string(levelUnit(strengthLevelOf(best.technology)));
    out += ")";
}

void appendActive(const CellReport& report, std::string& out)
{
    const auto isData = [](const Cell& cell) { return cell.technology == RadioTechnology::EVDO; };
    const auto inSet = std::ranges::count_if(report.active, [&](const Cell& cell) { return !isData(cell); });
    if (inSet > 1)
        out += ", " + std::to_string(inSet) + " in the active set";
    if (const auto sector = std::ranges::find_if(report.active, isData); sector != report.active.end())
        out += "; " + described(*sector);
}

} // namespace

std::string summaryOf(const CellReport& report)
{
    std::string text = report.serving ? described(*report.serving) : "no serving cell";
    appendNeighbours(report, text);
    appendActive(report, text);
    if (report.connection)
        text += ", " + std::string(connectionName(*report.connection));
    return text;
}

} // namespace spectrel
