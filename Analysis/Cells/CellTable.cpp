#include "Analysis/Cells/CellTable.h"

#include <algorithm>
#include <array>

namespace spectrel {

const CellTable* cellTableOf(std::string_view generator)
{
    static const std::array tables {&lteCells(), &utranCells(), &gsmumtsCells(), &cdmaCells(), &ifxCells()};
    const auto found = std::ranges::find(tables, generator, [](const CellTable* table) { return table->generator; });
    return found == tables.end() ? nullptr : *found;
}

} // namespace spectrel
