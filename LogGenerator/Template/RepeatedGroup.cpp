#include "LogGenerator/Template/RepeatedGroup.h"

namespace spectrel {

ListRef entriesWithFields(RecordView record, const RepeatedGroup& group, std::span<const Field> fields)
{
    return eachEntry(group, [&](std::size_t start) { return entryWithFields(record, fields, start); });
}

} // namespace spectrel
