#pragma once

#include "Analysis/Analysis.h"
#include "Analysis/Events/Event.h"
#include "Analysis/Events/EventFinder.h"
#include "Analysis/Events/Findings/Findings.h"
#include "LogGenerator/LogGenerator.h"
#include "Monitor/Viewing/OfflineSession.h"
#include "Platform/Resources.h"
#include "Records/Recording.h"
#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Fakes/SourceFolder.h"

#include <chrono>
#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace spectrel {

/// The events of records that a test makes itself, decoded with the templates that are shipped.
class EventFixture : public testing::Test, private EventListener {
protected:
    explicit EventFixture(Technology technology)
    {
        session.useTechnology(technology);
    }

    /// From now on findings are remarked, too.
    void remark(const Thresholds& thresholds = {})
    {
        _findings.emplace(analysis, finder, thresholds);
    }
    void at(std::chrono::milliseconds offset)
    {
        time = Start + offset;
    }
    void pass(std::chrono::milliseconds span)
    {
        time += span;
    }
    void deliver(Bytes record)
    {
        session.apply({time, std::move(record)});
    }
    void finish()
    {
        finder.finish();
        if (_findings)
            _findings->finish();
    }

    std::vector<Event> all(EventKind kind) const
    {
        std::vector<Event> found;
        for (const Event& event : events) {
            if (event.kind == kind)
                found.push_back(event);
        }
        return found;
    }
    /// The moves, without the first cell.
    std::vector<Event> moves() const
    {
        std::vector<Event> found;
        for (const Event& event : all(EventKind::Cell)) {
            if (event.fromCell)
                found.push_back(event);
        }
        return found;
    }
    /// The names of the findings, each with a blank behind it.
    std::string findings() const
    {
        std::string names;
        for (const Event& event : all(EventKind::Finding))
            names += event.finding + " ";
        return names;
    }
    /// "reselection higher-priority" and so on, of the only move.
    std::string causeOfMove() const
    {
        const auto found = moves();
        if (found.size() != 1)
            return std::to_string(found.size()) + " moves";
        const EventCause& cause = *found.front().cause;
        std::string text(causeKindName(cause.kind));
        if (cause.kind == CauseKind::Reselection)
            text += " " + std::string(causeRuleName(cause.rule));
        return text;
    }

    static constexpr Moment Start {std::chrono::seconds(1'700'000'000)};
    Moment time = Start;
    std::vector<Event> events;

private:
    void eventFound(const Event& event) override
    {
        events.push_back(event);
        if (_findings)
            _findings->eventFound(event);
    }

    FakeRunLoop _clock;
    const DirectoryResources _shipped {sourcePath("Resources")};

protected:
    OfflineSession session {
        &LogGenerator::generatorFromTechnology, false, Context {.clock = _clock, .resources = _shipped}};
    Analysis analysis {session.displayState()};
    EventFinder finder {analysis, static_cast<EventListener&>(*this)};

private:
    std::optional<Findings> _findings;
};

} // namespace spectrel
