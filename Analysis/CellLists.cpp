#include "Analysis/CellLists.h"

#include "Monitor/DisplayOrder.h"
#include "Values/List.h"

#include <algorithm>
#include <charconv>
#include <utility>

namespace spectrel {

namespace {

const Value* childNamed(const Value& container, std::string_view name)
{
    const auto& dictionary = container.dictionary();
    if (!dictionary)
        return nullptr;
    if (!dictionary->contains(SortedMarker)) {
        const Value& child = (*dictionary)[name];
        return child.isAbsent() ? nullptr : &child;
    }
    const auto& entries = dictionary->entries();
    const auto found =
        std::ranges::find(entries, name, [](const Dictionary::Entry& entry) { return sortedKeyName(entry.key); });
    return found == entries.end() ? nullptr : &found->value;
}

/// Channels of other lists' cells, and the band that they are in, are all the same: looked up only once in a row.
void deriveBandAsBefore(Cell& cell, const std::vector<ListedCell>& before, const BandHints& hints)
{
    const Cell* const last = before.empty() ? nullptr : &before.back().cell;
    if (!last || hints.band || last->channel != cell.channel || last->technology != cell.technology)
        return deriveBand(cell, hints);
    cell.band = last->band;
    cell.downlinkMHz = last->downlinkMHz;
    cell.uplinkMHz = last->uplinkMHz;
    for (const CellKey key : {CellKey::Band, CellKey::DownlinkMHz, CellKey::UplinkMHz})
        setOrigin(cell, key, cell.origin(CellKey::Channel));
}

} // namespace

const Value* valueAt(const Value& display, std::string_view path)
{
    const Value* value = &display;
    while (value && !path.empty()) {
        path.remove_prefix(1); // the slash
        const std::string_view name = path.substr(0, path.find('/'));
        path.remove_prefix(name.size());
        value = childNamed(*value, name);
    }
    return value;
}

/// What an entry's fields say that only together makes sense.
struct CellList::EntryNotes {
    BandHints hints;
    std::array<std::uint8_t, LevelCount> ranks {};
    std::optional<std::uint32_t> networkColour;
    std::optional<std::uint32_t> stationColour;
    Origin colours;
    bool isBSICUnread = false;
};

const std::vector<ListedCell>& CellList::cells(const Value& display, PathTable& paths, const ReadValue* channel)
{
    if (!std::exchange(_isRead, true)) {
        _cells.clear();
        const Value* const container = _isUnusable ? nullptr : valueAt(display, _row->container);
        if (container)
            read(*container, paths, channel);
    }
    return _cells;
}

void CellList::read(const Value& container, PathTable& paths, const ReadValue* channel)
{
    if (_row->shape == ListShape::Pilots) {
        if (const auto& pilots = container.dictionary())
            forEachDisplayChild(*pilots,
                [&](std::string_view name, const Value& strength) { readEntry(name, strength, paths, channel); });
        return;
    }
    if (const auto& list = container.list()) {
        for (std::size_t position = 0; position < list->count(); ++position)
            readEntry(std::to_string(position), (*list)[position], paths, channel);
    }
}

Origin CellList::originOf(std::string_view name, std::string_view key, PathTable& paths) const
{
    std::string path(_row->container);
    path += '/';
    path += name;
    if (!key.empty()) {
        path += '/';
        path += key;
    }
    return {paths.numberOf(path), _message, _time};
}

void CellList::readEntry(std::string_view name, const Value& entry, PathTable& paths, const ReadValue* channel)
{
    ListedCell listed;
    Cell& cell = listed.cell;
    cell.technology = _row->technology;
    cell.stored = _time;
    listed.isActive = _row->role == ListRole::Active;
    EntryNotes notes;
    notes.hints.umtsNumbering = _umtsNumbering;
    if (_row->shape == ListShape::Pilots) {
        double offset = 0;
        const auto end = std::from_chars(name.data(), name.data() + name.size(), offset).ptr;
        if (end == name.data() + name.size() && !name.empty())
            storeValue(cell, {Meaning::Id, {}, offset, originOf(name, {}, paths)});
    }
    for (const EntryField& field : _row->fields) {
        const Value* const value = field.key.empty() ? &entry : childNamed(entry, field.key);
        if (value && value->string())
            readField(name, field, *value->string(), paths, listed, notes);
    }
    if (notes.networkColour && notes.stationColour && !notes.isBSICUnread)
        storeValue(cell,
            {Meaning::Id, {}, static_cast<double>(*notes.networkColour * 8 + *notes.stationColour), notes.colours});
    if (!cell.channel && channel)
        storeValue(cell, *channel);
    const bool isTold = cell.id || (cell.technology == RadioTechnology::GSM && cell.channel);
    if (!isTold)
        return;
    if (cell.channel)
        deriveBandAsBefore(cell, _cells, notes.hints);
    deriveParts(cell);
    _cells.push_back(std::move(listed));
}

void CellList::readField(std::string_view name, const EntryField& field, std::string_view text, PathTable& paths,
    ListedCell& listed, EntryNotes& notes)
{
    if (field.meaning == Meaning::SetName) {
        listed.isActive = text == "ASET";
        return;
    }
    listed.isReference |= field.reading == Reading::Pilot && text.starts_with(ReferencePilotMark);
    const auto number = readNumber(field.reading, text);
    if (!number)
        return;
    const auto colour =
        *number >= 0 && *number <= 7 ? std::optional(static_cast<std::uint32_t>(*number)) : std::nullopt;
    switch (field.meaning) {
    case Meaning::BSICIsValid:
        notes.isBSICUnread = *number == 0;
        return;
    case Meaning::NetworkColour:
        notes.networkColour = colour;
        notes.colours = originOf(name, field.key, paths);
        return;
    case Meaning::StationColour:
        notes.stationColour = colour;
        return;
    case Meaning::GSMBandIndicator:
        notes.hints.band = identityOf(listed.cell.technology, Meaning::BandIndicator, *number);
        return;
    case Meaning::Level: {
        auto& rank = notes.ranks[static_cast<std::size_t>(field.level)];
        if (listed.cell.level(field.level) && rank <= field.rank)
            return;
        rank = field.rank;
        break;
    }
    default:
        break;
    }
    storeValue(listed.cell, {field.meaning, field.level, *number, originOf(name, field.key, paths)});
}

} // namespace spectrel
