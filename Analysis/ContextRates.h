#pragma once

#include "Analysis/CellReport.h"
#include "Analysis/Cells/CellTable.h"
#include "Analysis/PathTable.h"
#include "Values/Value.h"

#include <cstdint>
#include <optional>
#include <vector>

namespace spectrel {

/// The contexts with their rates: what the counters have grown by between the last two stores, over the time between.
class ContextRates {
public:
    explicit ContextRates(const ContextRow& row)
        : _row(&row)
    {
    }

    /// The list was stored. Counters that have shrunk, and lists stored twice at once, give no rate.
    void update(const Value& display, std::uint64_t message, Moment time, PathTable& paths);
    const std::vector<DataContext>& contexts() const
    {
        return _contexts;
    }

private:
    struct Counters {
        std::optional<std::uint64_t> received;
        std::optional<std::uint64_t> sent;
        Moment time {};
    };

    DataContext read(const Value& entry, std::size_t position, const Origin& stored, PathTable& paths) const;
    Counters countersOf(const Value& entry, Moment time) const;

    const ContextRow* _row;
    std::vector<DataContext> _contexts;
    std::vector<Counters> _counters; // of each context
};

} // namespace spectrel
