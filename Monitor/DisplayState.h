#pragma once

#include "LogGenerator/GeneratorSlot.h"
#include "Monitor/Journal.h"
#include "Platform/Clock.h"
#include "Values/Bytes.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/Value.h"

#include <chrono>
#include <cstdint>
#include <memory>
#include <utility>
#include <vector>

namespace spectrel {

/// A message as those hear of it who read the journal.
struct AppliedMessage {
    std::uint64_t number = 0; // counts from 0 since the state was made
    Moment time {};
    ByteView body;
};

/// Hears after each message what it has changed in the display.
class JournalReader {
public:
    virtual ~JournalReader() = default;
    /// Also of a message that failed half-way, where the program goes on. The changes are those since the last call;
    /// they and the message are there only while this runs.
    virtual void messageApplied(const AppliedMessage& message, const Journal& journal) = 0;
};

/// What messages are decoded into, live or offline: the state dictionary, the generator that fills it and, for those
/// who listen, the journal of the display's changes.
class DisplayState {
public:
    /// Between two refresh ticks, at which the display is built when messages have come.
    static constexpr std::chrono::milliseconds RefreshInterval {2000};

    DisplayState(GeneratorFactory makeGenerator, const Context& context)
        : _makeGenerator(std::move(makeGenerator))
        , _context(context)
        , _state(Dictionary::make())
    {
    }
    DisplayState(const DisplayState&) = delete;
    DisplayState& operator=(const DisplayState&) = delete;

    /// What becomes of a generator of the class that the new one has, too.
    enum class SameClass : std::uint8_t { IsReplaced, GoesOn };

    /// Puts the generator of the technology (a constant of the telephony service) in the place of the one before; none
    /// for a technology that is not known.
    void useTechnology(const Value& technology, SameClass same = SameClass::IsReplaced);
    const LogGenerator* generator() const
    {
        return _generator.get();
    }
    LogGenerator* generator()
    {
        return _generator.get();
    }
    const Dictionary& state() const
    {
        return *_state;
    }
    /// The display as it stands; absent when there is none.
    const Value& display() const;

    /// Passes on what the message raises; who goes on then calls `finishMessage`. Without a generator a message only
    /// counts as news.
    void apply(ByteView body, Moment time);
    void finishMessage();
    /// The message being applied right now; empty otherwise.
    ByteView messageInProgress() const
    {
        return _message.body;
    }
    /// Whether messages came since this was asked last: a refresh tick asks.
    bool takeNews();
    bool hasNews() const
    {
        return _hasNews;
    }
    /// The display with one more history entry; there must be a generator.
    Value build();
    /// What a snapshot saves; null without a generator.
    ListRef saveContents() const;
    /// The same for a program that is about to end: the messages since the last build are folded in first, and the
    /// message being applied, if one is.
    ListRef lastContents();

    /// From now on there is a journal.
    Journal& followChanges();
    /// The reader outlives this, or is removed.
    void addReader(JournalReader& reader);
    void removeReader(JournalReader& reader);

private:
    GeneratorFactory _makeGenerator;
    Context _context; // of the generators
    DictionaryRef _state;
    GeneratorSlot _generator;
    bool _hasNews = false;
    AppliedMessage _message; // its body is empty between messages
    std::uint64_t _messages = 0;
    std::unique_ptr<Journal> _journal; // while anybody listens
    std::vector<JournalReader*> _readers;
};

} // namespace spectrel
