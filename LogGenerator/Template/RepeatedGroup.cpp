#include "LogGenerator/Template/RepeatedGroup.h"

namespace spectrel {

ListRef entriesWithFields(RecordView record, const RepeatedGroup& group, std::span<const Field> fields)
{
    auto entries = List::make();
    for (std::size_t index = 0; index < group.count; ++index)
        entries->append(entryWithFields(record, fields, group.entry(index)));
    return entries;
}

} // namespace spectrel
