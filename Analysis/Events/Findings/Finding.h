#pragma once

#include "Analysis/Analysis.h"
#include "Analysis/Events/Event.h"
#include "Analysis/Events/MoveText.h"

#include <chrono>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// What an expert would remark, before it has a place among the messages.
struct Finding {
    std::string_view name;
    std::string text;
    double seconds = 0;
    std::vector<Evidence> evidence;
};

/// The leaf that holds a cell's value, with the number as the cell has it.
inline void speak(
    std::vector<Evidence>& evidence, const Analysis& analysis, const Cell& cell, CellKey key, double value)
{
    if (const Origin& origin = cell.origin(key))
        evidence.push_back({analysis.pathOf(origin), numberText(value), origin.time});
}

inline void speakStrength(std::vector<Evidence>& evidence, const Analysis& analysis, const Cell& cell)
{
    if (const auto level = cell.strengthLevel())
        speak(evidence, analysis, cell, cellKeyOf(*level), *cell.strength());
}

/// The leaf that says which cell it is.
inline void speakIdentity(std::vector<Evidence>& evidence, const Analysis& analysis, const Cell& cell)
{
    if (cell.id)
        speak(evidence, analysis, cell, CellKey::Id, *cell.id);
    else if (cell.cell)
        speak(evidence, analysis, cell, CellKey::Cell, *cell.cell);
}

} // namespace spectrel
