#pragma once

#include "Analysis/Cell.h"
#include "Analysis/Report/Distribution.h"
#include "Analysis/Report/LevelTimeline.h"
#include "Values/Moment.h"

#include <array>
#include <cstdint>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace spectrel {

/// An event or a finding, as the report shows it.
struct ReportedEvent {
    enum class Mark : std::uint8_t { None, Move, ServiceLost, ServiceBack, Note }; // how charts show it

    Moment time {};
    std::string kind; // "cell", "service-lost", ...; of a finding its name
    std::string text; // one sentence
    std::string cause; // of a move: "reselection: equal-priority"
    std::string causeText; // one sentence with the numbers
    std::optional<double> seconds; // how long it lasted
    std::vector<std::pair<std::string, std::string>> evidence; // paths of the tree, values
    Mark mark = Mark::None;
};

/// A serving cell of a recording; its number is its place in `ReportedRecording::cells`.
struct ReportedCell {
    Cell cell; // what was known of it in the end
    double seconds = 0; // for which it served
    std::uint32_t visits = 0;
    std::array<Distribution, LevelCount> levels;
};

/// What a report shows of a recording, which may be several files that go on from one another.
struct ReportedRecording {
    std::string title;
    std::vector<std::string> files;
    std::vector<std::string> technologies; // as on the command line, in the order of their first messages
    std::vector<std::string> remarks; // damage and the like, one sentence each
    std::uint64_t messages = 0;
    std::uint64_t lostMessages = 0; // that the recorder knows of
    Moment first {};
    Moment last {};
    double secondsWithCell = 0; // while a serving cell is known and messages come
    std::vector<ReportedCell> cells; // in the order of their first service
    std::array<Distribution, LevelCount> levels; // of whichever cell served
    LevelTimeline timeline;
    std::vector<ReportedEvent> events; // without findings
    std::uint64_t moreEvents = 0; // beyond those kept
    std::vector<ReportedEvent> findings;
    std::uint64_t moreFindings = 0;

    double seconds() const
    {
        return std::chrono::duration<double>(last - first).count();
    }
};

} // namespace spectrel
