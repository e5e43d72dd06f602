#include "Records/SnapshotFile/SnapshotReader.h"

#include "Records/MessageCutter.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyList.h"

namespace spectrel {

namespace {

class SnapshotReader final : public RecordingReader {
public:
    SnapshotReader(DictionaryRef snapshot, ListRef entries);

    std::optional<Technology> technology() const override
    {
        return _technology;
    }
    bool next(RecordedMessage& message) override;
    const std::string& damage() const override
    {
        return _damage;
    }
    DictionaryRef snapshot() const override
    {
        return _snapshot;
    }

private:
    bool openEntry();
    bool nextOfData(RecordedMessage& message);
    bool takeReport(RecordedMessage& message);
    bool damaged(const std::string& place, const std::string& why);

    DictionaryRef _snapshot;
    ListRef _entries;
    std::optional<Technology> _technology;
    std::size_t _nextEntry = 0;
    std::size_t _count = 0; // of messages read
    std::string _damage;

    // The entry being read.
    Moment _time;
    Value _displayState; // absent: none is open
    std::optional<MessageCutter> _cutter;
    std::string _report;
};

/// What an entry holds of the log; absent in one that holds none.
const Value& displayStateOf(const Value& entry)
{
    static const Value None;
    const DictionaryRef& dictionary = entry.dictionary();
    // The entry with the DLF repeats the messages of the others.
    return dictionary && !dictionary->contains("DLF") ? (*dictionary)["DisplayState"] : None;
}

/// Messages do not tell which Zephyr technology they are of; only the dictionary-reporting baseband keeps its reports.
SnapshotReader::SnapshotReader(DictionaryRef snapshot, ListRef entries)
    : _snapshot(std::move(snapshot))
    , _entries(std::move(entries))
{
    for (const Value& entry : _entries->elements()) {
        const Value& state = displayStateOf(entry);
        if (state.isAbsent())
            continue;
        if (!state.data())
            _technology = Technology::IFX;
        break;
    }
}

bool SnapshotReader::next(RecordedMessage& message)
{
    while (_damage.empty()) {
        if (_displayState.isAbsent() && !openEntry())
            return false;
        const bool found = _cutter ? nextOfData(message) : takeReport(message);
        if (found) {
            message.time = _time;
            ++_count;
            return true;
        }
    }
    return false;
}

bool SnapshotReader::openEntry()
{
    while (_nextEntry < _entries->count()) {
        const Value& entry = (*_entries)[_nextEntry++];
        _displayState = displayStateOf(entry);
        if (_displayState.isAbsent())
            continue;
        const std::string* date = (*entry.dictionary())["Date"].string();
        if (!date || !parseDefaultDateForm(*date, _time))
            _time = Moment();
        _cutter.reset();
        if (const DataRef& data = _displayState.data())
            _cutter.emplace(*data, MessageSequence::Whole);
        return true;
    }
    return false;
}

/// False at the entry's end and at damage.
bool SnapshotReader::nextOfData(RecordedMessage& message)
{
    const Bytes& bytes = *_displayState.data();
    MessageCutter::Cut cut;
    if (_cutter->next(cut)) {
        message.body = ByteView(bytes).subspan(cut.start, cut.length);
        return true;
    }
    if (_cutter->place() < bytes.size())
        return damaged(" at byte " + std::to_string(_cutter->place()), _cutter->complaint());
    _displayState = Value();
    return false;
}

bool SnapshotReader::takeReport(RecordedMessage& message)
{
    auto report = serialisePropertyList(_displayState);
    if (!report)
        return damaged("", "the report holds what a message cannot carry");
    _report = std::move(*report);
    _displayState = Value();
    message.body = {reinterpret_cast<const std::uint8_t*>(_report.data()), _report.size()};
    return true;
}

bool SnapshotReader::damaged(const std::string& place, const std::string& why)
{
    _damage = "message " + std::to_string(_count) + place + " of entry " + std::to_string(_nextEntry - 1) + ": " + why;
    return false;
}

} // namespace

Result<std::unique_ptr<RecordingReader>> openSnapshot(const Value& list)
{
    const DictionaryRef& dictionary = list.dictionary();
    const ListRef entries = dictionary ? (*dictionary)["Data"].list() : nullptr;
    if (!entries)
        return Failure {"a property list, but no snapshot: it has no list \"Data\""};
    return std::make_unique<SnapshotReader>(dictionary, entries);
}

} // namespace spectrel
