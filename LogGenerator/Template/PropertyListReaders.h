#pragma once

#include "Records/RecordView.h"
#include "Values/List.h"
#include "Values/Value.h"

#include <cstdint>
#include <exception>
#include <initializer_list>
#include <string_view>
#include <vector>

/// Readers of the records whose payload is a property list that the telephony service supplies. Each owns the parsed
/// object for the duration of one update.
namespace spectrel {

/// SIM files, code 0xFF0000: a dictionary.
class LogCode_0xFF0000 {
public:
    static constexpr std::uint32_t Code = 0xFF0000;

    /// Raised when the payload does not parse. Nothing catches it: the process ends.
    class UnknownDataException : public std::exception { };

    explicit LogCode_0xFF0000(RecordView record);
    /// The value under a key; absent when there is none.
    const Value& operator[](std::string_view key) const;

private:
    Value _files;
};

/// PDP contexts, code 0xFF0002: a list; anything else is dropped without a word.
class ContextArrayReader {
public:
    static constexpr std::uint32_t Code = 0xFF0002;

    explicit ContextArrayReader(RecordView record);
    /// Null when nothing is held.
    const List* contexts() const
    {
        return _contexts.get();
    }

private:
    ListRef _contexts;
};

/// Cell information, code 0xFF0001: a list of cell dictionaries keyed by the kRKCellMonitor... constants.
class CellInfoArrayReader {
public:
    static constexpr std::uint32_t Code = 0xFF0001;

    /// Logs "Cell Info Array data could not be constructed" when the payload does not parse.
    explicit CellInfoArrayReader(RecordView record);
    /// False when the payload did not parse.
    bool holdsAnything() const
    {
        return !_cells.isAbsent();
    }
    /// The first serving cell of any of the technologies, which has both a technology and a cell type. Null when there
    /// is none; an object that is no list has no cells.
    DictionaryRef firstServingCell(std::initializer_list<std::string_view> radioAccessTechnologies) const;
    /// All serving cells of the technology, and all neighbour cells, in the list's order.
    std::vector<DictionaryRef> servingCells(std::string_view radioAccessTechnology) const;
    std::vector<DictionaryRef> neighborCells(std::string_view radioAccessTechnology) const;

private:
    Value _cells;
};

} // namespace spectrel
