#include "Analysis/Events/Findings/CoverageFindings.h"

#include <algorithm>
#include <array>
#include <utility>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

/// What was measured longer ago says nothing of now. Neighbours of other carriers are measured in turn.
constexpr auto Fresh = 6s;

/// The measure by which a cell is too weak to be used, with the limit for it.
struct Minimum {
    Level level;
    Threshold threshold;
};
/// Srxlev and C1 count from what the cell itself asks for, Ec/No from Q_qualmin, which the display does not have.
constexpr std::array<Minimum, 3> Minima {{
    {Level::Srxlev, Threshold::HoleSrxlev},
    {Level::C1, Threshold::HoleC1},
    {Level::EcNo, Threshold::HoleEcNo},
}};

bool isFresh(const Cell& cell, CellKey key, Moment now)
{
    const Origin& origin = cell.origin(key);
    return origin && origin.time >= now - Fresh;
}

bool isStrengthFresh(const Cell& cell, Moment now)
{
    const auto level = cell.strengthLevel();
    return level && isFresh(cell, cellKeyOf(*level), now);
}

/// The neighbours measured just now with what separates them from the serving cell.
std::vector<const NeighbourCell*> comparable(const CellReport& report)
{
    std::vector<const NeighbourCell*> cells;
    if (!report.serving || !isStrengthFresh(*report.serving, report.time))
        return cells;
    for (const NeighbourCell& cell : report.neighbours) {
        if (cell.difference && isStrengthFresh(cell, report.time))
            cells.push_back(&cell);
    }
    return cells;
}

} // namespace

std::vector<Finding> CoverageFindings::consider(const CellReport& report)
{
    const bool isElsewhere = report.serving && _serving && !isSameCell(*report.serving, *_serving);
    if (isElsewhere || !report.serving) {
        end(_better, Threshold::BetterNeighbourTime);
        end(_missing, Threshold::MissingNeighbourTime);
    }
    _serving = report.serving;
    considerHole(report);
    considerBetterNeighbour(report);
    considerPollution(report);
    considerMissingNeighbour(report);
    return std::exchange(_found, {});
}

std::vector<Finding> CoverageFindings::finish()
{
    end(_hole, Threshold::HoleTime);
    end(_better, Threshold::BetterNeighbourTime);
    end(_pollution, Threshold::PollutionTime);
    end(_missing, Threshold::MissingNeighbourTime);
    return std::exchange(_found, {});
}

void CoverageFindings::end(Episode& episode, Threshold time)
{
    if (auto finding = episode.ends(_thresholds[time]))
        _found.push_back(*std::move(finding));
}

void CoverageFindings::considerHole(const CellReport& report)
{
    for (const auto& [level, threshold] : Minima) {
        if (!report.serving || !report.serving->level(level)
            || !isFresh(*report.serving, cellKeyOf(level), report.time))
            continue;
        const double value = *report.serving->level(level);
        if (value >= _thresholds[threshold])
            break;
        Finding finding {"hole",
            "Coverage hole on " + cellText(*report.serving) + ": " + std::string(levelName(level)) + " down to "
                + numberText(value) + " dB",
            0, {}};
        speak(finding.evidence, _analysis, *report.serving, cellKeyOf(level), value);
        speakStrength(finding.evidence, _analysis, *report.serving);
        return _hole.holds(report.time, std::move(finding), -value);
    }
    end(_hole, Threshold::HoleTime);
}

void CoverageFindings::considerBetterNeighbour(const CellReport& report)
{
    const auto cells = comparable(report);
    const auto best = std::ranges::max_element(cells, {}, [](const NeighbourCell* cell) { return *cell->difference; });
    const bool isBetter = best != cells.end() && *(*best)->difference >= _thresholds[Threshold::BetterNeighbourMargin];
    if (_betterCell && (!isBetter || !isSameCell(*_betterCell, **best)))
        end(_better, Threshold::BetterNeighbourTime);
    _betterCell.reset();
    if (!isBetter)
        return;
    const NeighbourCell& cell = **best;
    Finding finding {"better-neighbour",
        "Better neighbour: " + cellText(cell) + " was " + numberText(*cell.difference) + " dB stronger than "
            + cellText(*report.serving) + whatKeptIt(report, cell),
        0, {}};
    speakStrength(finding.evidence, _analysis, cell);
    speakStrength(finding.evidence, _analysis, *report.serving);
    _better.holds(report.time, std::move(finding), *cell.difference);
    _betterCell = cell;
}

/// Why the phone stayed, where what it measured decides that.
std::string CoverageFindings::whatKeptIt(const CellReport& report, const Cell& neighbour) const
{
    if (report.connection == Connection::Connected)
        return "; in a connection the network decides, and did not hand over";
    if (neighbour.technology != RadioTechnology::LTE || neighbour.channel == report.serving->channel)
        return "; the hysteresis and the reselection time kept the phone there";
    const auto& samples = _log.samples(EvidenceSection::LTEServing);
    if (samples.empty())
        return "";
    const auto srxlev = samples.back().number("Srxlev");
    const auto search = samples.back().number("S Non Intra Search");
    if (srxlev && search && *srxlev > *search)
        return "; the cell's Srxlev of " + numberText(*srxlev) + " dB is above its search threshold of "
            + numberText(*search) + " dB, so that carriers of no higher priority are not taken";
    return "; the carriers' priorities and thresholds kept the phone there";
}

void CoverageFindings::considerPollution(const CellReport& report)
{
    const auto cells = comparable(report);
    std::vector<const NeighbourCell*> close;
    for (const NeighbourCell* const cell : cells) {
        if (cell->channel == report.serving->channel && *cell->difference >= -_thresholds[Threshold::PollutionRange])
            close.push_back(cell);
    }
    if (static_cast<double>(close.size()) < _thresholds[Threshold::PollutionCells])
        return end(_pollution, Threshold::PollutionTime);
    Finding finding {"pilot-pollution",
        "Pilot pollution: " + std::to_string(close.size()) + " neighbours within "
            + numberText(_thresholds[Threshold::PollutionRange]) + " dB of " + cellText(*report.serving),
        0, {}};
    speakStrength(finding.evidence, _analysis, *report.serving);
    for (const NeighbourCell* const cell : close)
        speakStrength(finding.evidence, _analysis, *cell);
    _pollution.holds(report.time, std::move(finding), static_cast<double>(close.size()));
}

/// UTRAN's neighbour list says of each cell whether the network has named it.
void CoverageFindings::considerMissingNeighbour(const CellReport& report)
{
    const auto& samples = _log.samples(EvidenceSection::UTRANNeighbours);
    const EvidenceSample* detected = nullptr;
    const EvidenceSample* listed = nullptr;
    const auto isStronger = [](const EvidenceSample& one, const EvidenceSample* other) {
        return !other || one.number("Filter RSCP").value_or(0) > other->number("Filter RSCP").value_or(0);
    };
    for (auto sample = samples.rbegin(); sample != samples.rend() && sample->n == samples.back().n; ++sample) {
        const EvidenceSample*& best = sample->text("Status") == "DSET" ? detected : listed;
        if (isStronger(*sample, best))
            best = &*sample;
    }
    constexpr double StepsPerUnit = 256; // the levels are shown in 256ths
    const auto level = [](const EvidenceSample* sample) { return sample->number("Filter RSCP").value_or(0); };
    const double over = detected && listed ? (level(detected) - level(listed)) * StepsPerUnit : 0;
    if (!detected || !listed || detected->time < report.time - Fresh
        || over < _thresholds[Threshold::MissingNeighbourMargin])
        return end(_missing, Threshold::MissingNeighbourTime);
    Finding finding {"missing-neighbour",
        "Missing neighbour: cell parameter " + detected->text("Cell ID") + " on " + detected->text("UARFCN")
            + " is strong, and the network has not named it",
        0, {detected->evidence("Status"), detected->evidence("Filter RSCP"), listed->evidence("Filter RSCP")}};
    _missing.holds(report.time, std::move(finding), over);
}

} // namespace spectrel
