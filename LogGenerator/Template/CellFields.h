#pragma once

#include "LogGenerator/Template/Fields.h"
#include "Platform/SystemLog.h"

#include <array>
#include <cstdint>
#include <span>
#include <string_view>

/// Sections' readings of the cell-information record (code 0xFF0001), as tables.
namespace spectrel {

/// One number of a cell: its key in the cell information, the display key it is shown under, and how. `missing` is
/// logged, with its own line end, when there is none or it is not a whole number of 32 bits, unless it is
/// `Silent`.
struct CellField {
    std::string_view cellKey;
    std::string_view key;
    Formatter format;
    const char* missing;

    static constexpr const char* Silent = nullptr;
};

/// Writes a cell's fields in table order; a field that cannot be read is left out.
void storeCell(SystemLog& log, const Dictionary& cell, std::span<const CellField> fields, Dictionary& into);

/// Which cells of the cell-information record a section shows.
enum class CellChoice : std::uint8_t {
    None,
    FirstServing, // the first serving cell of any of the technologies, in the section's dictionary
    EveryServing, // one serving cell after the other, so that the last one's values remain
    Neighbors, // a list with one dictionary for each neighbour, in the record's order
};

struct CellTable {
    CellChoice choice = CellChoice::None;
    std::array<std::string_view, 2> technologies {}; // the second one may be empty
    std::span<const CellField> fields {};
};

} // namespace spectrel
