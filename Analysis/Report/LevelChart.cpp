#include "Analysis/Report/LevelChart.h"

#include "Analysis/Report/CellNames.h"
#include "Analysis/Report/HTMLText.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <cstddef>
#include <map>
#include <optional>
#include <set>
#include <utility>
#include <vector>

namespace spectrel {

namespace {

using std::chrono::microseconds;
using Mark = ReportedEvent::Mark;

// In units of the drawing.
constexpr double WholeWidth = 960;
constexpr double HalfWidth = 600;
constexpr double Height = 240;
constexpr double Left = 46;
constexpr double Margin = 18; // on the right
constexpr double Top = 34;
constexpr double Bottom = 212;
constexpr double StripTop = 8; // of the strip that names the serving cells
constexpr double StripHeight = 14;
constexpr double LetterWidth = 9;
constexpr microseconds MaxPause = std::chrono::seconds(10); // without a value, that a line spans

constexpr std::size_t TableRows = 24;

/// Columns next to each other with the same serving cell.
struct Stretch {
    std::size_t first;
    std::size_t end;
    std::optional<std::uint32_t> cell;
};

class LevelChart {
public:
    LevelChart(
        const ReportedRecording& recording, Level level, const LevelAxis& axis, ChartWidth width, std::string& out)
        : _recording(recording)
        , _timeline(recording.timeline)
        , _level(level)
        , _axis(axis)
        , _length(std::max<microseconds>(recording.last - recording.first, _timeline.width()))
        , _width(width == ChartWidth::Whole ? WholeWidth : HalfWidth)
        , _right(_width - Margin)
        , _out(out)
    {
    }

    void append(const std::string& identifier)
    {
        const std::string name(levelName(_level));
        _out += "<figure>\n<svg viewBox=\"0 0 " + decimalText(_width, 0) + " " + decimalText(Height, 0)
            + "\" role=\"img\" aria-labelledby=\"" + identifier + "t " + identifier + "d\">\n<title id=\"" + identifier
            + "t\">" + name + " of the serving cell, " + escaped(_recording.title) + "</title>\n<desc id=\""
            + identifier + "d\">" + description() + "</desc>\n";
        appendGrid();
        appendLostService();
        for (const Stretch& stretch : stretches()) {
            appendStrip(stretch);
            appendLine(stretch);
        }
        appendMarks();
        _out += "</svg>\n";
        appendTable();
        _out += "</figure>\n";
    }

private:
    double xOf(Moment time) const
    {
        const double share =
            static_cast<double>((time - _recording.first).count()) / static_cast<double>(_length.count());
        return Left + (_right - Left) * std::clamp(share, 0.0, 1.0);
    }
    /// The middle of a column, as far as the recording goes.
    double xOf(std::size_t column) const
    {
        const auto begin = _timeline.start() + static_cast<std::int64_t>(column) * _timeline.width();
        return xOf(begin + _timeline.width() / 2);
    }
    double beginOf(std::size_t column) const
    {
        return xOf(_timeline.start() + static_cast<std::int64_t>(column) * _timeline.width());
    }
    double yOf(double value) const
    {
        const double share = (value - _axis.low) / (_axis.high - _axis.low);
        return Bottom - (Bottom - Top) * std::clamp(share, 0.0, 1.0);
    }
    static std::string at(double coordinate)
    {
        return decimalText(coordinate, 1);
    }
    static std::string place(double x, double y)
    {
        return at(x) + "," + at(y) + " ";
    }

    std::string description() const
    {
        const Distribution& values = _recording.levels[static_cast<std::size_t>(_level)];
        return "From " + dateText(_recording.first) + " to " + dateText(_recording.last) + " UTC: "
            + levelText(values.min()) + " to " + levelText(values.max()) + ", mean " + levelText(values.mean()) + " "
            + std::string(levelUnit(_level)) + ". The table below has the same numbers.";
    }

    void appendGrid()
    {
        _out += "<g class=\"grid\">";
        for (const double line : _axis.lines) {
            const std::string y = at(yOf(line));
            _out += "<path d=\"M" + at(Left) + " " + y + "H" + at(_right) + "\"/><text x=\"40\" y=\""
                + at(yOf(line) + 4) + "\" class=\"end\">" + decimalText(line, 0) + "</text>";
        }
        const bool isShort = _length < std::chrono::minutes(8);
        for (const Moment line : timeLines(_recording.first, _length)) {
            const std::string x = at(xOf(line));
            _out += "<path d=\"M" + x + " " + at(Top) + "V" + at(Bottom) + "\"/><text x=\"" + x
                + "\" y=\"228\" class=\"mid\">" + (isShort ? clockText(line) : minuteText(line)) + "</text>";
        }
        _out += "<text x=\"4\" y=\"20\">" + std::string(levelUnit(_level)) + "</text></g>\n";
    }

    std::vector<Stretch> stretches() const
    {
        std::vector<Stretch> stretches;
        const auto& columns = _timeline.columns();
        for (std::size_t i = 0; i < columns.size(); ++i) {
            if (!columns[i].isTouched)
                continue;
            const bool goesOn = !stretches.empty() && stretches.back().cell == columns[i].cell
                && static_cast<std::int64_t>(i - stretches.back().end) * _timeline.width() <= MaxPause;
            if (goesOn)
                stretches.back().end = i + 1;
            else
                stretches.push_back({i, i + 1, columns[i].cell});
        }
        return stretches;
    }

    void appendStrip(const Stretch& stretch)
    {
        if (!stretch.cell)
            return;
        const double begin = beginOf(stretch.first);
        const double width = std::max(beginOf(stretch.end) - begin, 0.5);
        const std::string letters = cellLetters(*stretch.cell);
        _out += "<rect class=\"f " + cellColour(*stretch.cell) + "\" x=\"" + at(begin) + "\" y=\"" + at(StripTop)
            + "\" width=\"" + at(width) + "\" height=\"" + at(StripHeight) + "\"/>";
        if (width >= LetterWidth * static_cast<double>(letters.size()) + 4)
            _out += "<text class=\"mid on\" x=\"" + at(begin + width / 2) + "\" y=\"19\">" + letters + "</text>";
        _out += "\n";
    }

    /// The means as a line, with the span of the values around it where a column holds several.
    void appendLine(const Stretch& stretch)
    {
        std::string line;
        std::string above;
        std::string below;
        const auto& columns = _timeline.columns();
        for (std::size_t i = stretch.first; i < stretch.end; ++i) {
            const LevelTimeline::Spread& spread = columns[i].level(_level);
            if (spread.count == 0)
                continue;
            const double x = xOf(i);
            line += place(x, yOf(spread.mean()));
            above += place(x, yOf(spread.max));
            below.insert(0, place(x, yOf(spread.min)));
        }
        if (line.empty())
            return;
        const std::string colour = stretch.cell ? cellColour(*stretch.cell) : "none";
        if (above != line)
            _out += "<path class=\"b " + colour + "\" d=\"M" + above + below + "z\"/>";
        _out += "<path class=\"l " + colour + "\" d=\"M" + line + (line.find(' ') + 1 == line.size() ? "h0" : "")
            + "\"/>\n";
    }

    /// The times between a lost service and its return.
    void appendLostService()
    {
        std::optional<Moment> lost;
        for (const ReportedEvent& event : _recording.events) {
            if (event.mark == Mark::ServiceLost && !lost)
                lost = event.time;
            if (event.mark == Mark::ServiceBack && lost)
                appendLost(*std::exchange(lost, std::nullopt), event.time);
        }
        if (lost)
            appendLost(*lost, _recording.last);
    }

    void appendLost(Moment from, Moment to)
    {
        _out += "<rect class=\"lost\" x=\"" + at(xOf(from)) + "\" y=\"" + at(Top) + "\" width=\""
            + at(std::max(xOf(to) - xOf(from), 1.0)) + "\" height=\"" + at(Bottom - Top)
            + "\"><title>without service from " + clockText(from) + " to " + clockText(to) + "</title></rect>\n";
    }

    /// At most one of a kind at a place that can be told from others.
    void appendMarks()
    {
        std::set<std::pair<Mark, int>> drawn;
        for (const ReportedEvent& event : _recording.events) {
            if (event.mark != Mark::Move && event.mark != Mark::Note)
                continue;
            const double x = xOf(event.time);
            if (drawn.insert({event.mark, static_cast<int>(x)}).second)
                appendMark(event, x);
        }
        _out += "\n";
    }

    void appendMark(const ReportedEvent& event, double x)
    {
        const bool isMove = event.mark == Mark::Move;
        const std::string shape = isMove ? "M" + at(x) + " " + at(StripTop + StripHeight + 2) + "v8"
                                         : "M" + at(x) + " " + at(Top) + "V" + at(Bottom) + "m-5 0h10l-5 -8z";
        _out += "<path class=\"" + std::string(isMove ? "move" : "note") + "\" d=\"" + shape + "\"><title>"
            + clockText(event.time) + " " + escaped(event.text) + "</title></path>";
    }

    void appendTable()
    {
        const std::string unit(levelUnit(_level));
        _out += "<details><summary>As a table</summary>\n<table><caption>" + std::string(levelName(_level)) + " in "
            + unit
            + "</caption><thead><tr><th scope=\"col\">from</th><th scope=\"col\">cells</th><th "
              "scope=\"col\">min</th><th scope=\"col\">mean</th><th scope=\"col\">max</th></tr></thead>\n<tbody>\n";
        const std::size_t size = _timeline.columns().size();
        const std::size_t step = std::max<std::size_t>(1, (size + TableRows - 1) / TableRows);
        for (std::size_t first = 0; first < size; first += step)
            appendTableRow(first, std::min(first + step, size));
        _out += "</tbody></table></details>\n";
    }

    void appendTableRow(std::size_t first, std::size_t end)
    {
        LevelTimeline::Spread joined;
        std::vector<std::uint32_t> cells;
        for (std::size_t i = first; i < end; ++i) {
            const LevelTimeline::Column& column = _timeline.columns()[i];
            joined.add(column.level(_level));
            if (column.cell && std::find(cells.begin(), cells.end(), *column.cell) == cells.end())
                cells.push_back(*column.cell);
        }
        std::string letters;
        for (const std::uint32_t cell : cells)
            letters += (letters.empty() ? "" : ", ") + cellLetters(cell);
        const auto value = [&joined](double number) { return joined.count ? decimalText(number, 1) : "–"; };
        _out += "<tr><th scope=\"row\">"
            + clockText(_timeline.start() + static_cast<std::int64_t>(first) * _timeline.width()) + "</th><td>"
            + (letters.empty() ? "–" : letters) + "</td><td>" + value(joined.min) + "</td><td>"
            + value(joined.count ? joined.mean() : 0) + "</td><td>" + value(joined.max) + "</td></tr>\n";
    }

    const ReportedRecording& _recording;
    const LevelTimeline& _timeline;
    const Level _level;
    const LevelAxis& _axis;
    const microseconds _length;
    const double _width;
    const double _right;
    std::string& _out;
};

} // namespace

void appendLevelChart(const ReportedRecording& recording, Level level, const LevelAxis& axis, ChartWidth width,
    const std::string& identifier, std::string& out)
{
    LevelChart(recording, level, axis, width, out).append(identifier);
}

LevelAxis levelAxis(const std::vector<ReportedRecording>& recordings, Level level)
{
    std::optional<double> min;
    std::optional<double> max;
    for (const ReportedRecording& recording : recordings) {
        const Distribution& values = recording.levels[static_cast<std::size_t>(level)];
        if (values.count() == 0)
            continue;
        min = min ? std::min(*min, *values.min()) : *values.min();
        max = max ? std::max(*max, *values.max()) : *values.max();
    }
    return LevelAxis::around(min.value_or(0), max.value_or(1));
}

} // namespace spectrel
