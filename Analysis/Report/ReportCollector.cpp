#include "Analysis/Report/ReportCollector.h"

#include <algorithm>
#include <chrono>
#include <utility>

namespace spectrel {

namespace {

template <typename Value> void fill(std::optional<Value>& known, const std::optional<Value>& further)
{
    if (!known)
        known = further;
}

void fill(std::string& known, const std::string& further)
{
    if (known.empty())
        known = further;
}

/// What a later look at the same cell adds to what is known of it.
void complete(Cell& known, const Cell& further)
{
    fill(known.plmn, further.plmn);
    fill(known.operatorName, further.operatorName);
    fill(known.area, further.area);
    fill(known.cell, further.cell);
    fill(known.site, further.site);
    fill(known.rnc, further.rnc);
    fill(known.sector, further.sector);
    fill(known.id, further.id);
    fill(known.channel, further.channel);
    fill(known.band, further.band);
    fill(known.downlinkMHz, further.downlinkMHz);
    fill(known.uplinkMHz, further.uplinkMHz);
    fill(known.bandwidthMHz, further.bandwidthMHz);
}

ReportedEvent::Mark markOf(const Event& event)
{
    switch (event.kind) {
    case EventKind::Cell:
        return event.fromCell ? ReportedEvent::Mark::Move : ReportedEvent::Mark::None;
    case EventKind::ServiceLost:
        return ReportedEvent::Mark::ServiceLost;
    case EventKind::ServiceBack:
        return ReportedEvent::Mark::ServiceBack;
    case EventKind::Bookmark:
    case EventKind::Alarm:
        return ReportedEvent::Mark::Note;
    default:
        return ReportedEvent::Mark::None;
    }
}

ReportedEvent reported(const Event& event)
{
    constexpr std::size_t MaxEvidence = 6;
    ReportedEvent out;
    out.time = event.time;
    out.kind = event.kind == EventKind::Finding ? event.finding : std::string(eventKindName(event.kind));
    out.text = event.text;
    if (event.fromCell && event.cause) {
        out.cause = causeKindName(event.cause->kind);
        if (event.cause->kind == CauseKind::Reselection)
            out.cause += ": " + std::string(causeRuleName(event.cause->rule));
        out.causeText = event.cause->text;
    }
    out.seconds = event.seconds;
    for (std::size_t i = 0; i < std::min(event.evidence.size(), MaxEvidence); ++i)
        out.evidence.emplace_back(event.evidence[i].path, event.evidence[i].value);
    out.mark = markOf(event);
    return out;
}

bool isMoreThanALog(const ReportedEvent& event)
{
    return event.mark != ReportedEvent::Mark::None;
}

/// Keeps a limited number, rather what charts mark than the rest.
void keep(std::vector<ReportedEvent>& kept, std::uint64_t& more, ReportedEvent event, std::size_t limit)
{
    if (kept.size() < limit) {
        kept.push_back(std::move(event));
        return;
    }
    ++more;
    if (!isMoreThanALog(event))
        return;
    const auto given = std::find_if_not(kept.rbegin(), kept.rend(), isMoreThanALog);
    if (given == kept.rend())
        return;
    kept.erase(std::next(given).base());
    kept.push_back(std::move(event));
}

} // namespace

ReportCollector::ReportCollector(
    DisplayState& display, ReportedRecording& recording, const Thresholds& thresholds, OperatorNames* operators)
    : _recording(recording)
    , _analysis(display, operators)
    , _finder(_analysis, static_cast<EventListener&>(*this))
    , _findings(_analysis, _finder, thresholds)
{
    _analysis.addListener(*this);
}

ReportCollector::~ReportCollector()
{
    _analysis.removeListener(*this);
}

void ReportCollector::addBookmark(Moment time, const std::string& note)
{
    _finder.addBookmark(time, note);
}

void ReportCollector::finish()
{
    _finder.finish();
    _findings.finish();
}

void ReportCollector::messageAnalysed(
    const AppliedMessage& message, const Journal&, const Analysis& analysis, const AnalysedChanges& changes)
{
    follow(message.time);
    const Cell* serving = analysis.serving();
    if (changes.serving)
        _serving = serving ? numberOf(*serving) : std::nullopt;
    _recording.timeline.touch(message.time, _serving);
    if (serving && changes.serving)
        addLevels(*serving, message.number);
}

void ReportCollector::refreshed(const CellReport&, const Analysis&) { }

void ReportCollector::eventFound(const Event& event)
{
    if (event.kind == EventKind::Finding)
        keep(_recording.findings, _recording.moreFindings, reported(event), MaxFindings);
    else
        keep(_recording.events, _recording.moreEvents, reported(event), MaxEvents);
    _findings.eventFound(event);
}

/// The time since the message before is the serving cell's.
void ReportCollector::follow(Moment time)
{
    if (_recording.messages++ == 0)
        _recording.first = time;
    else if (_serving) {
        const auto since =
            std::clamp<std::chrono::microseconds>(time - _recording.last, std::chrono::microseconds(0), MaxSilence);
        const double seconds = std::chrono::duration<double>(since).count();
        _recording.cells[*_serving].seconds += seconds;
        _recording.secondsWithCell += seconds;
    }
    _recording.last = _recording.messages == 1 ? time : std::max(time, _recording.last);
}

/// None for a cell without an identity, and beyond the limit.
std::optional<std::uint32_t> ReportCollector::numberOf(const Cell& cell)
{
    if (!cell.id && !cell.cell)
        return std::nullopt;
    auto& cells = _recording.cells;
    const bool isSame = _serving && isSameCell(cells[*_serving].cell, cell);
    const auto known = isSame ? cells.begin() + *_serving
                              : std::find_if(cells.begin(), cells.end(),
                                  [&cell](const ReportedCell& held) { return isSameCell(held.cell, cell); });
    if (known == cells.end() && cells.size() >= MaxCells)
        return std::nullopt;
    const auto number = static_cast<std::uint32_t>(known - cells.begin());
    if (known == cells.end())
        cells.push_back({cell, 0, 0, {}});
    complete(cells[number].cell, cell);
    if (_previous != number)
        ++cells[number].visits;
    _previous = number;
    return number;
}

void ReportCollector::addLevels(const Cell& cell, std::uint64_t message)
{
    for (std::size_t i = 0; i < LevelCount; ++i) {
        const auto level = static_cast<Level>(i);
        const auto& value = cell.level(level);
        if (!value || cell.origin(cellKeyOf(level)).message != message)
            continue; // not of this message
        _recording.timeline.add(level, *value);
        _recording.levels[i].add(*value);
        if (_serving)
            _recording.cells[*_serving].levels[i].add(*value);
    }
}

} // namespace spectrel
