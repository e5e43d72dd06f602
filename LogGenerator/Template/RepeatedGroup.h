#pragma once

#include "LogGenerator/Template/ArrayOutOfBoundsException.h"
#include "LogGenerator/Template/Fields.h"
#include "Values/List.h"

#include <cstddef>
#include <span>

namespace spectrel {

/// A record's repeated group: `count` entries, as the record itself says, of `entrySize` bytes each, the first at
/// `start`. Nothing compares the count with the record's length: entries past its end read as zeros.
struct RepeatedGroup {
    std::size_t start;
    std::size_t entrySize;
    std::size_t count;

    /// Where an entry starts. Throws `ArrayOutOfBoundsException` for an index that is not below the count.
    constexpr std::size_t entry(std::size_t index) const
    {
        if (index >= count)
            throw ArrayOutOfBoundsException();
        return start + entrySize * index;
    }
};

/// A new list with what `make` makes of each entry's start.
template <typename Make> ListRef eachEntry(const RepeatedGroup& group, Make make)
{
    auto entries = List::make();
    for (std::size_t index = 0; index < group.count; ++index)
        entries->append(make(group.entry(index)));
    return entries;
}

/// A new list with one dictionary for each entry of the group, each with the fields in table order.
ListRef entriesWithFields(RecordView record, const RepeatedGroup& group, std::span<const Field> fields);

} // namespace spectrel
