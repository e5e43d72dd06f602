#include "Analysis/Events/EventFinder.h"

#include "Analysis/Events/Causes/CauseFinder.h"
#include "Analysis/Events/MoveText.h"

#include <algorithm>
#include <utility>

namespace spectrel {

namespace {

constexpr std::string_view NoContext = "none";

std::string_view subjectOf(EventKind kind)
{
    switch (kind) {
    case EventKind::Area:
        return "Area";
    case EventKind::PLMN:
        return "Network";
    case EventKind::Connection:
        return "Connection";
    default:
        return "Registration";
    }
}

Event eventAt(const AppliedMessage& message, EventKind kind, std::string text)
{
    Event event;
    event.n = message.number;
    event.time = message.time;
    event.kind = kind;
    event.text = std::move(text);
    return event;
}

const Cell* secondServing(const CellReport& report)
{
    const auto found = std::ranges::find(report.active, RadioTechnology::EVDO, &Cell::technology);
    return found == report.active.end() ? nullptr : &*found;
}

bool isAnythingStored(const Cell& stored)
{
    return std::ranges::any_of(stored.origins, [](const Origin& origin) { return static_cast<bool>(origin); });
}

/// Of the event that service is back.
void describeReturn(Event& event, const Cell& cell)
{
    event.cell = cell;
    event.text = "Service is back after " + numberText(*event.seconds) + " s on " + cellText(cell);
}

} // namespace

EventFinder::EventFinder(Analysis& analysis, EventListener& listener)
    : _analysis(analysis)
    , _listener(listener)
{
    _analysis.addListener(*this);
}

EventFinder::~EventFinder()
{
    _analysis.removeListener(*this);
}

void EventFinder::messageAnalysed(
    const AppliedMessage& message, const Journal& journal, const Analysis& analysis, const AnalysedChanges& changes)
{
    reportBookmarks(message.time, message.number);
    _latest = message.number;
    _latestTime = message.time;
    settleDue(message.time);
    reportRegistration(message.time);
    reportReady(); // before what this message shows
    _log.read(message, journal);
    followService(message, analysis, changes);
    if (changes.surroundings)
        followSecondRadio(message, analysis);
    if (changes.connection || changes.registration || changes.contexts)
        followStates(message, analysis, changes);
    reportReady();
}

void EventFinder::refreshed(const CellReport& report, const Analysis&)
{
    settleDue(report.time);
    reportReady();
}

void EventFinder::reportBookmarks(Moment time, std::uint64_t n)
{
    while (!_bookmarks.empty() && _bookmarks.begin()->first <= time) {
        const auto mark = _bookmarks.extract(_bookmarks.begin());
        settleDue(mark.key());
        _latestTime = std::max(_latestTime, mark.key());
        Event event;
        event.n = n;
        event.time = mark.key();
        event.kind = EventKind::Bookmark;
        event.text = "Bookmark: " + mark.mapped();
        event.note = mark.mapped();
        push(std::move(event));
    }
}

void EventFinder::followService(const AppliedMessage& message, const Analysis& analysis, const AnalysedChanges& changes)
{
    const Cell* const serving = analysis.serving();
    Cell stored;
    if (changes.serving && serving)
        stored = storedBy(*serving, message.number);
    auto shown = ServiceWatch::Shown::Nothing;
    if (isAnythingStored(stored))
        shown = ServiceWatch::Shown::Cell;
    else if (analysis.isOutOfService())
        shown = ServiceWatch::Shown::NoService;

    const bool wasLost = _service.isLost();
    const ServiceWatch::News news = _service.messageCame(message.time, shown);
    if (shown == ServiceWatch::Shown::Cell) {
        follow(_serving, stored, message, wasLost);
        followNetwork(stored, message);
    }
    if (news == ServiceWatch::News::Lost) {
        Event event = eventAt(message, EventKind::ServiceLost, "Service lost");
        event.cell = _serving.tracker.current();
        if (event.cell)
            event.text += " on " + cellText(*event.cell);
        push(std::move(event));
    } else if (news == ServiceWatch::News::Back) {
        Event event = eventAt(message, EventKind::ServiceBack, "");
        event.seconds = std::chrono::duration<double>(_service.away()).count();
        describeReturn(event, *_serving.tracker.current());
        push(std::move(event), _serving.isWaiting ? &_serving : nullptr);
    }
}

void EventFinder::follow(Radio& radio, const Cell& stored, const AppliedMessage& message, bool isAfterLoss)
{
    if (!radio.tracker.isElsewhere(stored))
        return radio.tracker.learn(stored);
    if (radio.isWaiting && radio.tracker.move().isNamed())
        settle(radio);
    else if (radio.isWaiting)
        giveUp(radio);
    radio.tracker.begin(stored, message.number, message.time, isAfterLoss);
    radio.isWaiting = radio.tracker.isSettling();
    if (radio.isWaiting)
        push(eventAt(message, EventKind::Cell, ""), &radio);
}

void EventFinder::followSecondRadio(const AppliedMessage& message, const Analysis& analysis)
{
    const Cell* const cell = secondServing(analysis.report());
    if (!cell)
        return;
    const Cell stored = storedBy(*cell, message.number);
    if (isAnythingStored(stored))
        follow(_second, stored, message, false);
}

void EventFinder::followNetwork(const Cell& stored, const AppliedMessage& message)
{
    if (stored.area)
        noteChange(EventKind::Area, _area, std::to_string(*stored.area), message);
    if (!stored.plmn.empty())
        noteChange(EventKind::PLMN, _plmn, stored.plmn, message);
}

void EventFinder::followStates(const AppliedMessage& message, const Analysis& analysis, const AnalysedChanges& changes)
{
    const CellReport& report = analysis.report();
    if (report.connection)
        noteChange(EventKind::Connection, _connection, std::string(connectionName(*report.connection)), message);
    if (changes.registration && !report.registration.empty()) {
        _nextRegistration = report.registration;
        if (!_registrationChange)
            _registrationChange = {message.number, message.time, {}};
    }
    if (changes.contexts)
        followContexts(report, message);
}

/// What is known for the first time is no change, and what is not known any more is none either.
void EventFinder::noteChange(EventKind kind, std::string& known, const std::string& now, const AppliedMessage& message)
{
    if (now.empty() || now == known)
        return;
    const std::string before = std::exchange(known, now);
    if (before.empty())
        return;
    Event event = eventAt(message, kind, std::string(subjectOf(kind)) + ": " + now + ", was " + before);
    event.from = before;
    event.to = now;
    push(std::move(event));
}

/// The registration is put together of what several messages of one moment tell.
void EventFinder::reportRegistration(Moment time)
{
    if (!_registrationChange || time <= _registrationChange->time)
        return;
    noteChange(EventKind::Registration, _registration, _nextRegistration, *_registrationChange);
    _registrationChange.reset();
}

/// Contexts of one name are told apart by their order.
void EventFinder::followContexts(const CellReport& report, const AppliedMessage& message)
{
    Texts now;
    for (const DataContext& context : report.contexts) {
        std::string name = context.name;
        for (int number = 2; now.contains(name); ++number)
            name = context.name + " (" + std::to_string(number) + ")";
        now.emplace(std::move(name), context.state.empty() ? "shown" : context.state);
    }
    const auto before = std::exchange(_contexts, std::optional(now));
    if (!before)
        return;
    for (const auto& [name, state] : *before) {
        if (!now.contains(name))
            noteContext(name, state, std::string(NoContext), message);
    }
    for (const auto& [name, state] : now) {
        const auto known = before->find(name);
        if (known == before->end())
            noteContext(name, std::string(NoContext), state, message);
        else if (known->second != state)
            noteContext(name, known->second, state, message);
    }
}

void EventFinder::noteContext(
    const std::string& name, const std::string& from, const std::string& to, const AppliedMessage& message)
{
    Event event = eventAt(message, EventKind::Context, "Context " + name + ": " + to + ", was " + from);
    event.context = name;
    event.from = from;
    event.to = to;
    push(std::move(event));
}

void EventFinder::sessionDidChange(bool isConnected, const std::string& reason, Moment time)
{
    if (isConnected == _isConnected.value_or(false))
        return;
    const bool isFirst = !_isConnected;
    _isConnected = isConnected;
    if (isFirst)
        return;
    settleDue(time);
    Event event;
    event.n = _latest;
    event.time = time;
    event.kind = isConnected ? EventKind::SessionBack : EventKind::SessionLost;
    event.text = isConnected ? "The session is back" : "The session was lost: " + reason;
    event.reason = reason;
    add(std::move(event));
}

void EventFinder::addBookmark(Moment time, const std::string& note)
{
    _bookmarks.emplace(time, note);
}

void EventFinder::add(Event event)
{
    push(std::move(event));
    reportReady();
}

void EventFinder::finish()
{
    for (Radio* const radio : {&_serving, &_second}) {
        if (!radio->isWaiting)
            continue;
        if (radio->tracker.move().isNamed())
            settle(*radio);
        else
            giveUp(*radio);
    }
    reportRegistration(Moment::max());
    reportBookmarks(Moment::max(), _latest);
    reportReady();
}

void EventFinder::settleDue(Moment time)
{
    for (Radio* const radio : {&_serving, &_second}) {
        if (radio->tracker.isDue(time))
            settle(*radio);
        else if (radio->isWaiting && time > radio->tracker.move().time + Patience)
            giveUp(*radio);
    }
}

/// Completes the events that wait for the radio's move.
void EventFinder::settle(Radio& radio)
{
    const CellMove move = radio.tracker.take();
    radio.isWaiting = false;
    for (Waiting& each : _queue) {
        if (std::exchange(each.radio, each.radio == &radio ? nullptr : each.radio) != &radio)
            continue;
        if (each.event.kind == EventKind::Cell)
            describe(each.event, move);
        else
            describeReturn(each.event, move.to);
    }
}

/// The new cell got no name: there is nothing to report.
void EventFinder::giveUp(Radio& radio)
{
    if (radio.tracker.isSettling())
        radio.tracker.take();
    radio.isWaiting = false;
    std::erase_if(
        _queue, [&radio](const Waiting& each) { return each.radio == &radio && each.event.kind == EventKind::Cell; });
    for (Waiting& each : _queue) {
        if (each.radio == &radio)
            each.radio = nullptr;
    }
}

void EventFinder::describe(Event& event, const CellMove& move) const
{
    event.fromCell = move.from;
    event.toCell = move.to;
    if (move.from) {
        event.change = differences(*move.from, move.to);
        event.cause = findCause(_log, move, [this](const Origin& origin) { return _analysis.pathOf(origin); });
    }
    event.text = moveText(event);
}

void EventFinder::push(Event event, const Radio* radio)
{
    _queue.push_back({std::move(event), radio});
}

void EventFinder::reportReady()
{
    while (!_queue.empty() && !_queue.front().radio) {
        const Waiting ready = std::move(_queue.front());
        _queue.pop_front();
        _listener.eventFound(ready.event);
    }
}

} // namespace spectrel
