#pragma once

#include "LogGenerator/Template/Fields.h"
#include "Values/List.h"
#include "Values/Value.h"

#include <initializer_list>
#include <span>
#include <string_view>

/// Sections' readings of the cell-information record (code 0xFF0001), as tables.
namespace spectrel {

/// One number of a cell: its key in the cell information, the display key it is shown under, and how. `missing` is
/// logged, with its own line end, when there is none or it is not a whole number of 32 bits.
struct CellField {
    std::string_view cellKey;
    std::string_view key;
    Formatter format;
    const char* missing;
};

/// Writes a cell's fields in table order; a node that is none loses them.
void storeCell(const Dictionary& cell, std::span<const CellField> fields, const Value& sectionRef);

/// Writes the fields of the record's first serving cell of one of the technologies, in table order; changes nothing
/// when there is none. Logs "Failed to get Cell Array" for a payload that does not parse.
void storeServingCell(RecordView record, std::initializer_list<std::string_view> technologies,
    std::span<const CellField> fields, const Value& sectionRef);

/// Refills a section's list with one dictionary for each of the record's neighbour cells of the technology, in the
/// record's order; a field that cannot be read is left out. Logs "Failed to get Cell Array" for a payload that does
/// not parse, and leaves the list empty.
void listNeighborCells(
    RecordView record, std::string_view technology, std::span<const CellField> fields, const Value& sectionRef);

} // namespace spectrel
