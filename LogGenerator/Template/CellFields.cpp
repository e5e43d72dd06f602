#include "LogGenerator/Template/CellFields.h"

#include "Platform/SystemLog.h"

namespace spectrel {

void storeCell(SystemLog& log, const Dictionary& cell, std::span<const CellField> fields, Dictionary& into)
{
    TextBuffer buffer;
    for (const CellField& field : fields) {
        buffer.clear();
        if (const auto number = cell[field.cellKey].int32())
            into.setText(field.key, field.format(static_cast<std::uint32_t>(*number), buffer));
        else if (field.missing)
            SPECTREL_LOG(log, Priority::Error, "%s", field.missing);
    }
}

} // namespace spectrel
