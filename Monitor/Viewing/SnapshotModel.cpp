#include "Monitor/Viewing/SnapshotModel.h"

#include "Monitor/DisplayOrder.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <unordered_map>
#include <utility>
#include <vector>

namespace spectrel {

namespace {

std::string textOf(const Dictionary& dictionary, std::string_view key)
{
    const std::string* text = dictionary[key].string();
    return text ? *text : std::string();
}

/// The entry's date and description; a description that holds the date stands alone.
std::string entryName(const Dictionary& entry, std::size_t place)
{
    const std::string date = textOf(entry, "Date");
    const std::string description = textOf(entry, "Description");
    if (date.empty() && description.empty())
        return "Entry " + std::to_string(place);
    if (date.empty() || description.find(date) != std::string::npos)
        return description;
    return description.empty() ? date : date + "  " + description;
}

/// Gathers rows. They are found by their names, so no two may be alike, and none may be the marker that sorts them.
class Rows {
public:
    void add(const std::string& name, Value value)
    {
        std::string unlike = name;
        while (_rows->contains(unlike) || unlike == SortedMarker)
            unlike = name + " (" + std::to_string(++_others[name] + 1) + ")";
        _rows->set(unlike, std::move(value));
    }
    const DictionaryRef& dictionary() const
    {
        return _rows;
    }

private:
    DictionaryRef _rows = Dictionary::make();
    std::unordered_map<std::string, int> _others; // rows of that name beyond the first
};

std::string binaryLogText(const Value& log)
{
    return log.data() ? "binary log, " + std::to_string(log.data()->size()) + " bytes" : "(unknown)";
}

} // namespace

Value displayOfSnapshot(const Dictionary& snapshot)
{
    Rows rows;
    std::vector<std::pair<std::string, Value>> binaryLogs;
    const ListRef entries = snapshot["Data"].list();
    for (std::size_t place = entries ? entries->count() : 0; place > 0; --place) {
        const DictionaryRef entry = (*entries)[place - 1].dictionary();
        if (!entry)
            rows.add("Entry " + std::to_string(place), "(unknown)");
        else if (entry->contains("DLF"))
            binaryLogs.emplace_back(entryName(*entry, place), binaryLogText((*entry)["DLF"]));
        else if (!entry->contains("Display"))
            rows.add(entryName(*entry, place), "nothing was displayed");
        else
            rows.add(entryName(*entry, place), (*entry)["Display"]);
    }
    for (const auto& [name, value] : binaryLogs)
        rows.add(name, value);
    for (const char* key : {"Timestamp", "Description"}) {
        if (const std::string text = textOf(snapshot, key); !text.empty())
            rows.add(key, text);
    }
    return rows.dictionary();
}

SnapshotModel::SnapshotModel(RunLoop& runLoop, SpectrelModelObserver& observer, const Dictionary& snapshot)
    : _runLoop(runLoop)
    , _observer(observer)
    , _nodes(SpectrelModelNode::makeTreeFromObject(displayOfSnapshot(snapshot), _nodesByPath))
{
}

void SnapshotModel::restartMonitor()
{
    if (std::exchange(_isStarted, true))
        return;
    _observer.sessionDidChange();
    _runLoop.async(_lifetime.guard([this] { _observer.updateViewControllerFromModel(); }));
}

} // namespace spectrel
