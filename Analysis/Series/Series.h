#pragma once

#include "Analysis/Series/Statistics.h"
#include "Values/Moment.h"

#include <array>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <vector>

namespace spectrel {

/// The times of many series, which all have a value, or none, at the same refreshes.
///
/// Two resolutions: the last `Recent` refreshes one by one, half an hour of them at 2 s; and all that was, in at most
/// `Spans` spans of equal length, which begins with 2 s and doubles whenever they no longer reach: a day has spans of
/// 64 s.
class SeriesAxis {
public:
    static constexpr std::size_t Recent = 900;
    static constexpr std::size_t Spans = 1440;

    /// Further in time; a time that runs backwards stands still. Whether spans were joined two by two, and how often:
    /// every series has to do the same before its next value.
    int advance(Moment time);

    std::uint64_t refreshes() const
    {
        return _refreshes;
    }
    /// Of the refreshes that are kept one by one; 0 is the oldest of them.
    std::size_t recentCount() const;
    Moment recentTime(std::size_t index) const;

    Moment start() const
    {
        return _start;
    }
    Moment now() const
    {
        return _now;
    }
    std::chrono::microseconds spanLength() const
    {
        return _spanLength;
    }
    /// The span of the last refresh; its start is so many lengths after the start.
    std::size_t span() const
    {
        return static_cast<std::size_t>((_now - _start) / _spanLength);
    }
    /// The place of a recent refresh in a series' store.
    std::size_t slot(std::size_t index) const;

private:
    std::uint64_t _refreshes = 0;
    Moment _start {};
    Moment _now {};
    std::chrono::microseconds _spanLength {std::chrono::seconds(2)};
    std::array<Moment, Recent> _recent {};
};

/// One number over time: its value at each recent refresh, its course in spans, and its statistics over all refreshes.
class Series {
public:
    /// What a span holds; of a series without a value in it the count is 0.
    struct Span {
        float min = 0;
        float mean = 0;
        float max = 0;
        std::uint32_t count = 0;
    };
    /// The memory of a series that is full, in bytes.
    static constexpr std::size_t LargestSize = sizeof(double) * SeriesAxis::Recent + sizeof(Span) * SeriesAxis::Spans
        + sizeof(Statistics) + 512; // its name and places in indexes

    /// At every refresh, after the axis has advanced, with what `advance` gave; no value where the number is not there.
    void add(const SeriesAxis& axis, int joins, std::optional<double> value);

    /// At a recent refresh of the axis; none where there was no number then.
    std::optional<double> recent(const SeriesAxis& axis, std::size_t index) const;
    /// From the axis' start on; there may be fewer than on the axis, the rest having no values.
    const std::vector<Span>& spans() const
    {
        return _spans;
    }
    const Statistics& statistics() const
    {
        return _statistics;
    }

private:
    void join();

    std::unique_ptr<std::array<double, SeriesAxis::Recent>> _recent; // not-a-number where there is no value
    std::vector<Span> _spans;
    Statistics _statistics;
};

} // namespace spectrel
