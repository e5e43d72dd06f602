#include "Analysis/Series/Series.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace spectrel {

namespace {

constexpr double NoNumber = std::numeric_limits<double>::quiet_NaN();

void take(Series::Span& span, const Series::Span& other)
{
    if (other.count == 0)
        return;
    if (span.count == 0) {
        span = other;
        return;
    }
    span.min = std::min(span.min, other.min);
    span.max = std::max(span.max, other.max);
    const double part = static_cast<double>(other.count) / (static_cast<double>(span.count) + other.count);
    span.mean = static_cast<float>(span.mean + (static_cast<double>(other.mean) - span.mean) * part);
    span.count += other.count;
}

} // namespace

int SeriesAxis::advance(Moment time)
{
    if (_refreshes == 0)
        _start = _now = time;
    _now = std::max(_now, time);
    _recent[_refreshes++ % Recent] = _now;
    int joins = 0;
    for (; span() >= Spans; ++joins)
        _spanLength *= 2;
    return joins;
}

std::size_t SeriesAxis::recentCount() const
{
    return static_cast<std::size_t>(std::min<std::uint64_t>(_refreshes, Recent));
}

std::size_t SeriesAxis::slot(std::size_t index) const
{
    return static_cast<std::size_t>((_refreshes - recentCount() + index) % Recent);
}

Moment SeriesAxis::recentTime(std::size_t index) const
{
    return _recent[slot(index)];
}

void Series::add(const SeriesAxis& axis, int joins, std::optional<double> value)
{
    for (int join = 0; join < joins; ++join)
        this->join();
    if (value && !std::isfinite(*value))
        value.reset();
    if (!_recent) {
        if (!value)
            return;
        _recent = std::make_unique<std::array<double, SeriesAxis::Recent>>();
        _recent->fill(NoNumber);
    }
    (*_recent)[axis.slot(axis.recentCount() - 1)] = value.value_or(NoNumber);
    if (!value)
        return;
    _statistics.add(*value);
    if (_spans.capacity() <= axis.span())
        _spans.reserve(std::min(2 * axis.span() + 1, SeriesAxis::Spans));
    if (_spans.size() <= axis.span())
        _spans.resize(axis.span() + 1);
    const auto number = static_cast<float>(*value);
    take(_spans[axis.span()], {number, number, number, 1});
}

void Series::join()
{
    for (std::size_t span = 0; span < _spans.size(); ++span) {
        const Span joined = _spans[span];
        _spans[span] = {};
        take(_spans[span / 2], joined);
    }
    _spans.resize((_spans.size() + 1) / 2);
}

std::optional<double> Series::recent(const SeriesAxis& axis, std::size_t index) const
{
    const double value = _recent ? (*_recent)[axis.slot(index)] : NoNumber;
    return std::isnan(value) ? std::nullopt : std::optional(value);
}

} // namespace spectrel
