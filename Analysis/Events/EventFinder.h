#pragma once

#include "Analysis/Analysis.h"
#include "Analysis/Events/Event.h"
#include "Analysis/Events/EvidenceLog.h"
#include "Analysis/Events/MoveTracker.h"
#include "Analysis/Events/ServiceWatch.h"

#include <chrono>
#include <cstdint>
#include <deque>
#include <map>
#include <optional>
#include <string>

namespace spectrel {

/// Finds the events in what the display means, live and on recordings alike.
///
/// A move is reported when it is settled; later events wait for it, so that all come in order. What stands when it is
/// seen first is no event: only the first cell is.
class EventFinder final : public AnalysisListener {
public:
    /// Moves that nothing names for so long are given up, and later events go on.
    static constexpr std::chrono::seconds Patience {60};

    /// Listens to the analysis from now on. Both are there for as long as this is.
    EventFinder(Analysis& analysis, EventListener& listener);
    ~EventFinder() override;
    EventFinder(const EventFinder&) = delete;
    EventFinder& operator=(const EventFinder&) = delete;

    void messageAnalysed(const AppliedMessage& message, const Journal& journal, const Analysis& analysis,
        const AnalysedChanges& changes) override;
    void refreshed(const CellReport& report, const Analysis& analysis) override;

    /// The live session was lost, or is there again.
    void sessionDidChange(bool isConnected, const std::string& reason, Moment time);
    /// A note that somebody made at a moment; reported before the first message that is later.
    void addBookmark(Moment time, const std::string& note);
    /// An event that somebody else has found, no earlier than the latest message.
    void add(Event event);
    /// The latest message.
    std::uint64_t latest() const
    {
        return _latest;
    }
    Moment latestTime() const
    {
        return _latestTime;
    }
    /// What speaks for causes.
    const EvidenceLog& evidence() const
    {
        return _log;
    }
    /// No more messages come: what waits is reported as it stands.
    void finish();

private:
    /// The cell of one radio: CDMA phones have two.
    struct Radio {
        MoveTracker tracker;
        bool isWaiting = false; // an event in the queue is for its move
    };
    struct Waiting {
        Event event;
        const Radio* radio = nullptr; // whose move has to settle first; null: nothing holds the event
    };
    using Texts = std::map<std::string, std::string>;

    void reportBookmarks(Moment time, std::uint64_t n);
    void followService(const AppliedMessage& message, const Analysis& analysis, const AnalysedChanges& changes);
    void follow(Radio& radio, const Cell& stored, const AppliedMessage& message, bool isAfterLoss);
    void followSecondRadio(const AppliedMessage& message, const Analysis& analysis);
    void followNetwork(const Cell& stored, const AppliedMessage& message);
    void followStates(const AppliedMessage& message, const Analysis& analysis, const AnalysedChanges& changes);
    void followContexts(const CellReport& report, const AppliedMessage& message);
    void noteChange(EventKind kind, std::string& known, const std::string& now, const AppliedMessage& message);
    void reportRegistration(Moment time);
    void noteContext(
        const std::string& name, const std::string& from, const std::string& to, const AppliedMessage& message);

    void settleDue(Moment time);
    void settle(Radio& radio);
    void giveUp(Radio& radio);
    void describe(Event& event, const CellMove& move) const;
    void push(Event event, const Radio* radio = nullptr);
    void reportReady();

    Analysis& _analysis;
    EventListener& _listener;
    EvidenceLog _log;
    Radio _serving;
    Radio _second; // EV-DO
    ServiceWatch _service;
    std::string _area;
    std::string _plmn;
    std::string _connection;
    std::string _registration;
    std::optional<AppliedMessage> _registrationChange; // the first message of those at one moment that tell of another
    std::string _nextRegistration;
    std::optional<Texts> _contexts; // states by name; none before they were seen first
    std::multimap<Moment, std::string> _bookmarks; // to come
    std::optional<bool> _isConnected; // to the service; none before the first session
    std::deque<Waiting> _queue;
    std::uint64_t _latest = 0; // message
    Moment _latestTime {};
};

} // namespace spectrel
