#pragma once

#include "Analysis/Cell.h"
#include "Values/Moment.h"

#include <array>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

namespace spectrel {

/// The levels of the serving cell over time, in columns of even width: a chart's worth, however long the recording.
/// When the columns are used up, each two become one of twice the width.
class LevelTimeline {
public:
    static constexpr std::size_t MaxColumns = 720;
    static constexpr std::chrono::milliseconds FirstWidth {250};

    /// The values of a level within a column.
    struct Spread {
        double min = 0;
        double max = 0;
        double sum = 0;
        std::uint32_t count = 0;

        double mean() const
        {
            return sum / count;
        }
        void add(const Spread& other);
    };
    struct Column {
        std::array<Spread, LevelCount> levels;
        std::optional<std::uint32_t> cell; // the serving cell's number, as of the last message
        bool isTouched = false; // there was a message

        const Spread& level(Level which) const
        {
            return levels[static_cast<std::size_t>(which)];
        }
    };

    /// A message; times do not go back.
    void touch(Moment time, std::optional<std::uint32_t> cell);
    /// A level of the message that `touch` told of last.
    void add(Level level, double value);

    Moment start() const
    {
        return _start;
    }
    std::chrono::microseconds width() const
    {
        return _width;
    }
    const std::vector<Column>& columns() const
    {
        return _columns;
    }

private:
    void halve();

    Moment _start {};
    std::chrono::microseconds _width {FirstWidth};
    std::vector<Column> _columns;
};

} // namespace spectrel
