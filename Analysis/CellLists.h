#pragma once

#include "Analysis/CellValues.h"
#include "Analysis/PathTable.h"
#include "Values/Value.h"

#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// The value at a path of the display, names as shown; null where there is none.
const Value* valueAt(const Value& display, std::string_view path);

/// A cell of a list.
struct ListedCell {
    Cell cell;
    bool isActive = false; // by its set's name or the list's role
    bool isReference = false; // the reference pilot
};

/// One list of cells as it was last stored.
class CellList {
public:
    CellList(const ListRow& row, ChannelNumbering umtsNumbering)
        : _row(&row)
        , _umtsNumbering(umtsNumbering)
    {
    }

    const ListRow& row() const
    {
        return *_row;
    }
    /// Something of it was stored or removed in this message.
    void touch(std::uint64_t message, Moment time)
    {
        _isStored = true;
        _isRead = false;
        _message = message;
        _time = time;
    }
    bool isStored() const
    {
        return _isStored;
    }
    std::uint64_t message() const
    {
        return _message;
    }
    /// What the list was filled with is no list of such cells.
    void setUnusable(bool isUnusable)
    {
        _isUnusable = isUnusable;
    }
    /// The cells, without those of which nothing tells which they are; read again only after a touch.
    const std::vector<ListedCell>& cells(const Value& display, PathTable& paths, const ReadValue* channel);

private:
    struct EntryNotes;

    void read(const Value& container, PathTable& paths, const ReadValue* channel);
    void readEntry(std::string_view name, const Value& entry, PathTable& paths, const ReadValue* channel);
    void readField(std::string_view name, const EntryField& field, std::string_view text, PathTable& paths,
        ListedCell& listed, EntryNotes& notes);
    Origin originOf(std::string_view name, std::string_view key, PathTable& paths) const;

    const ListRow* _row;
    ChannelNumbering _umtsNumbering;
    std::vector<ListedCell> _cells;
    std::uint64_t _message = 0;
    Moment _time {};
    bool _isStored = false;
    bool _isRead = false;
    bool _isUnusable = false;
};

} // namespace spectrel
