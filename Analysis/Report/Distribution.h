#pragma once

#include <cstdint>
#include <map>
#include <optional>

namespace spectrel {

/// How often which level was measured. Counts in classes of 0.5 dB, so that its size does not grow with the recording.
class Distribution {
public:
    static constexpr double ClassWidth = 0.5; // dB
    static constexpr double Limit = 400; // dB; what is beyond counts as this

    /// Not-a-numbers are left out.
    void add(double value);

    std::uint64_t count() const
    {
        return _count;
    }
    /// The exact smallest, mean and largest value; none of nothing.
    std::optional<double> min() const;
    std::optional<double> mean() const;
    std::optional<double> max() const;
    /// The level that a share (0 to 1) of the values is at or below, to the class; none of nothing.
    std::optional<double> percentile(double share) const;
    /// Counts by class; the class k holds the values from (k − 0.5) × ClassWidth up to (k + 0.5) × ClassWidth.
    const std::map<int, std::uint64_t>& classes() const
    {
        return _classes;
    }

private:
    std::map<int, std::uint64_t> _classes;
    std::uint64_t _count = 0;
    double _sum = 0;
    double _min = 0;
    double _max = 0;
};

} // namespace spectrel
