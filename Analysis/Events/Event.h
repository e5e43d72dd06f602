#pragma once

#include "Analysis/Cell.h"
#include "Values/Moment.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// What an engineer would write into a log book.
enum class EventKind : std::uint8_t {
    Cell, // the phone has moved to another cell, or shows its first one
    Area,
    PLMN,
    Connection,
    Registration,
    Context,
    ServiceLost,
    ServiceBack,
    SessionLost, // live only, as the next
    SessionBack,
    Bookmark,
    Alarm,
    Finding,
};

/// "cell", "area", "plmn", ... "service-lost", ... as the key `event` has it.
std::string_view eventKindName(EventKind kind);

/// How a phone came to another cell.
enum class CauseKind : std::uint8_t {
    Reselection, // by the phone's own choice: idle, or connected without a channel of its own
    Handover, // by the network, with the connection
    Redirection, // by the network's order to look for a cell elsewhere
    ServiceLost, // there was no cell in between
    Unknown,
};
std::string_view causeKindName(CauseKind kind);

/// Which rule of reselection was met (3GPP TS 36.304, 5.2.4; TS 25.304, 5.2.6; TS 45.008, 6.6).
enum class CauseRule : std::uint8_t {
    HigherPriority,
    EqualPriority, // ranks, C2, the strength of pilots
    LowerPriority,
    NotSuitable, // the cell that was left no longer met the cell-selection criterion: Srxlev or C1 below 0
    Unknown,
};
std::string_view causeRuleName(CauseRule rule);

/// A leaf of the tree that speaks for an answer, as it was shown then.
struct Evidence {
    std::string path;
    std::string value;
    Moment time {};
};

/// Why a phone came to another cell.
struct EventCause {
    CauseKind kind = CauseKind::Unknown;
    CauseRule rule = CauseRule::Unknown; // of reselections
    std::string text; // one sentence with the numbers
    std::vector<Evidence> evidence;
};

/// One event. Of the fields after `text` each kind has those of its row in the contract; the others are empty.
struct Event {
    std::uint64_t n = 0; // the message that shows it first, counted from 0
    Moment time {};
    EventKind kind = EventKind::Cell;
    std::string text; // one sentence

    std::optional<Cell> fromCell; // Cell; without it the first cell of a session
    std::optional<Cell> toCell;
    std::vector<std::string_view> change; // Cell: the keys in which both differ
    std::optional<EventCause> cause;
    std::string from; // Area, PLMN, Connection, Registration, Context
    std::string to;
    std::string context; // its name
    std::optional<Cell> cell; // ServiceLost: the last one; ServiceBack: the first one
    std::optional<double> seconds; // ServiceBack, Finding: how long
    std::string reason; // SessionLost, SessionBack
    std::string note; // Bookmark
    std::string condition; // Alarm
    std::optional<double> value; // Alarm: what met the condition
    std::string finding; // Finding: its name
    std::vector<Evidence> evidence; // Finding
};

/// Hears of events, in the order of their time.
class EventListener {
public:
    virtual ~EventListener() = default;
    virtual void eventFound(const Event& event) = 0;
};

} // namespace spectrel
