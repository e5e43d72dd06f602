#pragma once

#include "Analysis/Report/Report.h"

#include <chrono>
#include <cmath>
#include <cstdint>
#include <string>

namespace spectrel {

inline const Moment ReportStart {std::chrono::seconds(1'709'647'651)}; // 2024-03-05 14:07:31 UTC

inline Cell reportedLTECell(std::uint32_t id, std::uint32_t identity)
{
    Cell cell;
    cell.technology = RadioTechnology::LTE;
    cell.plmn = "001-01";
    cell.cell = identity;
    cell.site = identity / 256;
    cell.sector = identity % 256;
    cell.id = id;
    cell.channel = 1300;
    cell.band = "3";
    cell.downlinkMHz = 1815.0;
    return cell;
}

/// Seconds of measurements once a second; the serving cell changes each minute among so many cells.
inline ReportedRecording sampleRecording(const std::string& title, int seconds, std::uint32_t cells, double offset = 0)
{
    ReportedRecording recording;
    recording.title = title;
    recording.files = {title + ".pcap"};
    recording.technologies = {"lte"};
    recording.first = ReportStart;
    for (std::uint32_t i = 0; i < cells; ++i)
        recording.cells.push_back({reportedLTECell(50 + i, 4101 * 256 + i), 0, 0, {}});
    for (int second = 0; second < seconds; ++second) {
        const Moment time = ReportStart + std::chrono::seconds(second);
        const auto number = static_cast<std::uint32_t>(second / 60) % cells;
        const double rsrp = -95 + offset + 12 * std::sin(second / 37.0);
        ReportedCell& served = recording.cells[number];
        recording.timeline.touch(time, number);
        for (const auto& [level, value] : {std::pair {Level::RSRP, rsrp}, std::pair {Level::RSRQ, -9 + rsrp / 40}}) {
            recording.timeline.add(level, value);
            recording.levels[static_cast<std::size_t>(level)].add(value);
            served.levels[static_cast<std::size_t>(level)].add(value);
        }
        ++served.seconds;
        ++recording.secondsWithCell;
        ++recording.messages;
        recording.last = time;
        if (second % 60 == 0) {
            ++served.visits;
            ReportedEvent move {time, "cell", "The phone moved to PCI " + std::to_string(50 + number) + ".",
                "reselection: equal-priority", "PCI 51 was 4.0 dB stronger for 1.3 s.", {}, {},
                ReportedEvent::Mark::Move};
            recording.events.push_back(move);
        }
    }
    return recording;
}

} // namespace spectrel
