#include "Analysis/Events/Thresholds.h"

#include "Values/Table.h"

#include <algorithm>
#include <charconv>
#include <string>

namespace spectrel {

namespace {

constexpr bool isInOrder()
{
    for (std::size_t row = 0; row < ThresholdCount; ++row) {
        if (ThresholdTable[row].threshold != static_cast<Threshold>(row))
            return false;
    }
    return true;
}
static_assert(isInOrder());

std::string knownNames()
{
    std::string names;
    for (const ThresholdRow& row : ThresholdTable)
        names += (names.empty() ? "" : ", ") + std::string(row.name);
    return names;
}

} // namespace

Outcome Thresholds::set(std::string_view assignment)
{
    const std::size_t sign = std::min(assignment.find('='), assignment.size());
    const ThresholdRow* const row = findRow(ThresholdTable, assignment.substr(0, sign), &ThresholdRow::name);
    if (!row)
        return Failure {"'" + std::string(assignment) + "' names no threshold; there are " + knownNames()};
    const std::string_view digits = assignment.substr(std::min(sign + 1, assignment.size()));
    double value = 0;
    const auto end = std::from_chars(digits.data(), digits.data() + digits.size(), value);
    // Written so that a not-a-number is outside.
    if (end.ec != std::errc() || end.ptr != digits.data() + digits.size() || !(value >= row->min && value <= row->max))
        return Failure {"'" + std::string(assignment) + "' is no number in the threshold's range"};
    _values[static_cast<std::size_t>(row->threshold)] = value;
    return Done();
}

} // namespace spectrel
