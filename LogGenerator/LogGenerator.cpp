#include "LogGenerator/LogGenerator.h"

#include "Platform/SystemLog.h"
#include "Values/Moment.h"

#include <string>

namespace spectrel {

namespace {

/// The five values in their order; the first absent one ends the entry.
DictionaryRef makeHistoryEntry(const Dictionary& state, const Clock& clock)
{
    auto entry = Dictionary::make();
    const Value& displayState = state[StateKey::DisplayState];
    if (displayState.isAbsent())
        return entry;
    entry->set(StateKey::DisplayState, copyTopLevel(displayState));
    for (const std::string_view key : {StateKey::Display, StateKey::ExtraInfo}) {
        const Value& value = state[key];
        if (value.isAbsent())
            return entry;
        entry->set(key, copyTopLevel(value));
    }
    // The date is read twice: the two texts may differ by a second, and that stays so.
    entry->set("Date", defaultDateForm(clock.now()));
    entry->set("Description", "Snapshot (" + defaultDateForm(clock.now()) + ")");
    return entry;
}

} // namespace

LogGenerator::~LogGenerator() = default;

void LogGenerator::init()
{
    SPECTREL_LOG(log(), Priority::Warning, "Creating Log object: %p", static_cast<void*>(this));
}

void LogGenerator::takeOver(LogGenerator*, Dictionary&) { }

void LogGenerator::discardRawMessages() { }

void LogGenerator::keepRawMessage(ByteView) { }

void LogGenerator::updateHistoryInState(Dictionary& state, const Clock& clock)
{
    ListRef history = state[StateKey::History].list();
    if (!history) {
        history = List::make();
        state.set(StateKey::History, history);
    } else if (history->count() >= HistoryLimit) {
        history->removeFirst(history->count() - (HistoryLimit - 1));
    }
    history->append(makeHistoryEntry(state, clock));
}

} // namespace spectrel
