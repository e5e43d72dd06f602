#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace spectrel {

/// Count, extremes, mean and distribution of any number of values, in 1 KiB.
///
/// The distribution is a histogram of 256 classes of equal width. It begins with 1/16 and doubles whenever a value
/// would fall outside, so that values within 128 units of each other (levels in dB, say) are told apart by half a unit.
class Statistics {
public:
    static constexpr std::size_t Classes = 256;

    /// A value that is not finite is not counted.
    void add(double value);

    std::uint64_t count() const
    {
        return _count;
    }
    // The rest is 0 without values.
    double min() const
    {
        return _min;
    }
    double max() const
    {
        return _max;
    }
    double mean() const
    {
        return _mean;
    }
    /// The value that this part of all values (0 to 1) does not exceed: the lower end of the class that holds it.
    double percentile(double part) const;

    /// The class that holds values from `from` up to `from` + the width.
    struct Class {
        double from;
        std::uint32_t count;
    };
    double classWidth() const
    {
        return _width;
    }
    /// From the lowest to the highest that holds a value, empty ones between them as well.
    std::vector<Class> distribution() const;

private:
    void makeRoomFor(double value);
    void widen();
    void moveTo(std::int64_t first);
    std::int64_t classNumber(double value) const;

    std::uint64_t _count = 0;
    double _min = 0;
    double _max = 0;
    double _mean = 0;
    double _width = 1.0 / 16;
    std::int64_t _first = 0; // the number of the first class: its values begin at this many widths
    std::array<std::uint32_t, Classes> _classes {};
};

} // namespace spectrel
