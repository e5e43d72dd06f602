#include "Analysis/Report/LevelTimeline.h"

#include <algorithm>

namespace spectrel {

void LevelTimeline::Spread::add(const Spread& other)
{
    if (other.count == 0)
        return;
    min = count == 0 ? other.min : std::min(min, other.min);
    max = count == 0 ? other.max : std::max(max, other.max);
    sum += other.sum;
    count += other.count;
}

void LevelTimeline::touch(Moment time, std::optional<std::uint32_t> cell)
{
    if (_columns.empty())
        _start = time;
    const auto elapsed = std::max(time - _start, std::chrono::microseconds(0));
    while (elapsed / _width >= static_cast<std::int64_t>(MaxColumns))
        halve();
    const auto place = static_cast<std::size_t>(elapsed / _width);
    if (place >= _columns.size())
        _columns.resize(place + 1);
    _columns.back().cell = cell;
    _columns.back().isTouched = true;
}

void LevelTimeline::add(Level level, double value)
{
    if (!_columns.empty())
        _columns.back().levels[static_cast<std::size_t>(level)].add({value, value, value, 1});
}

void LevelTimeline::halve()
{
    _width *= 2;
    const std::size_t size = (_columns.size() + 1) / 2;
    for (std::size_t i = 0; i < size; ++i) {
        Column joined = _columns[2 * i];
        if (2 * i + 1 < _columns.size()) {
            const Column& second = _columns[2 * i + 1];
            for (std::size_t level = 0; level < LevelCount; ++level)
                joined.levels[level].add(second.levels[level]);
            if (second.isTouched) {
                joined.cell = second.cell;
                joined.isTouched = true;
            }
        }
        _columns[i] = joined;
    }
    _columns.resize(size);
}

} // namespace spectrel
