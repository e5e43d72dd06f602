#include "Analysis/Report/DistributionChart.h"

#include "Analysis/Report/CellNames.h"
#include "Analysis/Report/HTMLText.h"

#include <algorithm>
#include <array>
#include <cstddef>

namespace spectrel {

namespace {

// In units of the drawing.
constexpr double Left = 46;
constexpr double Right = 470;
constexpr double Top = 12;
constexpr double Bottom = 190;

constexpr std::array<double, 5> Shares {0.05, 0.1, 0.5, 0.9, 0.95};

double xOf(const LevelAxis& axis, double value)
{
    return Left + (Right - Left) * std::clamp((value - axis.low) / (axis.high - axis.low), 0.0, 1.0);
}

double yOf(double share)
{
    return Bottom - (Bottom - Top) * share;
}

void appendGrid(const LevelAxis& axis, Level level, std::string& out)
{
    out += "<g class=\"grid\">";
    for (const double line : axis.lines) {
        const std::string x = decimalText(xOf(axis, line), 1);
        out += "<path d=\"M" + x + " 12V190\"/><text class=\"mid\" x=\"" + x + "\" y=\"206\">" + decimalText(line, 0)
            + "</text>";
    }
    for (const int percent : {0, 25, 50, 75, 100}) {
        const double y = yOf(percent / 100.0);
        out += "<path d=\"M46 " + decimalText(y, 1) + "H470\"/><text class=\"end\" x=\"40\" y=\""
            + decimalText(y + 4, 1) + "\">" + std::to_string(percent) + " %</text>";
    }
    out += "<text class=\"end\" x=\"470\" y=\"220\">" + std::string(levelName(level)) + " in "
        + std::string(levelUnit(level)) + "</text></g>\n";
}

/// Steps are drawn as straight lines from class to class.
void appendCurve(const Distribution& values, const LevelAxis& axis, std::size_t recording, std::string& out)
{
    if (values.count() == 0)
        return;
    std::uint64_t below = 0;
    std::string line = decimalText(xOf(axis, *values.min()), 1) + "," + decimalText(yOf(0), 1) + " ";
    for (const auto& [place, count] : values.classes()) {
        below += count;
        const double share = static_cast<double>(below) / static_cast<double>(values.count());
        line += decimalText(xOf(axis, place * Distribution::ClassWidth), 1) + "," + decimalText(yOf(share), 1) + " ";
    }
    out += "<path class=\"l " + cellColour(static_cast<std::uint32_t>(recording)) + " d" + std::to_string(recording % 4)
        + "\" d=\"M" + line + "\"/>\n";
}

void appendTable(const std::vector<ReportedRecording>& recordings, Level level, std::string& out)
{
    out += "<div class=\"wide small\"><table><caption>" + std::string(levelName(level)) + " in "
        + std::string(levelUnit(level))
        + "</caption><thead><tr><th scope=\"col\">recording</th><th scope=\"col\">values</th><th "
          "scope=\"col\">min</th>";
    for (const double share : Shares)
        out += "<th scope=\"col\">" + decimalText(share * 100, 0) + " %</th>";
    out += "<th scope=\"col\">max</th><th scope=\"col\">mean</th></tr></thead>\n<tbody>";
    for (const ReportedRecording& recording : recordings) {
        const Distribution& values = recording.levels[static_cast<std::size_t>(level)];
        const auto number = static_cast<std::uint32_t>(&recording - recordings.data());
        out += "<tr><th scope=\"row\"><span class=\"swatch " + cellColour(number) + "\"></span>"
            + escaped(recording.title) + "</th><td>" + std::to_string(values.count()) + "</td><td>"
            + levelText(values.min()) + "</td>";
        for (const double share : Shares)
            out += "<td>" + levelText(values.percentile(share)) + "</td>";
        out += "<td>" + levelText(values.max()) + "</td><td>" + levelText(values.mean()) + "</td></tr>\n";
    }
    out += "</tbody></table></div>\n";
}

} // namespace

void appendDistributionChart(const std::vector<ReportedRecording>& recordings, Level level, const LevelAxis& axis,
    const std::string& identifier, std::string& out)
{
    const std::string name(levelName(level));
    out += "<figure>\n<svg viewBox=\"0 0 480 224\" role=\"img\" aria-labelledby=\"" + identifier + "t " + identifier
        + "d\">\n<title id=\"" + identifier + "t\">Distribution of " + name + "</title>\n<desc id=\"" + identifier
        + "d\">Which share of the values was at or below which level; the table below has the percentiles.</desc>\n";
    appendGrid(axis, level, out);
    for (const ReportedRecording& recording : recordings) {
        appendCurve(recording.levels[static_cast<std::size_t>(level)], axis,
            static_cast<std::size_t>(&recording - recordings.data()), out);
    }
    out += "</svg>\n";
    appendTable(recordings, level, out);
    out += "</figure>\n";
}

} // namespace spectrel
