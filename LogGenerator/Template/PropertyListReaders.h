#pragma once

#include "Platform/SystemLog.h"
#include "Records/RecordView.h"
#include "Values/Bytes.h"
#include "Values/List.h"
#include "Values/Value.h"

#include <cstdint>
#include <exception>
#include <span>
#include <string_view>
#include <vector>

/// Readers of the records whose payload is a property list that the telephony service supplies. Each owns the parsed
/// object for the duration of one update.
namespace spectrel {

/// The payloads, parsed. The latest of each log code is kept, as several sections read the same record one after the
/// other, and many a record says what the one before it said. Whoever holds its nodes only reads them.
class PropertyListPayloads {
public:
    /// The payload's property list; absent when it does not parse. Lives until the next call. The next one of the code
    /// is written over it, except over the nodes that somebody holds.
    const Value& of(RecordView record);

private:
    struct Payload {
        std::uint32_t code;
        Bytes bytes;
        Value parsed;
    };
    Payload& latestOf(std::uint32_t code);

    std::vector<Payload> _latest;
};

/// SIM files, code 0xFF0000: a dictionary.
class LogCode_0xFF0000 {
public:
    static constexpr std::uint32_t Code = 0xFF0000;

    /// Raised when the payload does not parse. Nothing catches it: the process ends.
    class UnknownDataException : public std::exception { };

    LogCode_0xFF0000(RecordView record, PropertyListPayloads& payloads, SystemLog& log);
    /// The value under a key; absent when there is none.
    const Value& operator[](std::string_view key) const;

private:
    Value _files;
};

/// PDP contexts, code 0xFF0002: a list; anything else is dropped without a word.
class ContextArrayReader {
public:
    static constexpr std::uint32_t Code = 0xFF0002;

    ContextArrayReader(RecordView record, PropertyListPayloads& payloads);
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
    CellInfoArrayReader(RecordView record, PropertyListPayloads& payloads, SystemLog& log);
    /// False when the payload did not parse.
    bool holdsAnything() const
    {
        return !_cells.isAbsent();
    }
    /// The serving cells of any of the technologies (an empty one is none), and the neighbour cells, in the list's
    /// order. An object that is no list has no cells.
    std::vector<DictionaryRef> servingCells(std::span<const std::string_view> technologies) const;
    std::vector<DictionaryRef> neighborCells(std::span<const std::string_view> technologies) const;

private:
    Value _cells;
};

} // namespace spectrel
