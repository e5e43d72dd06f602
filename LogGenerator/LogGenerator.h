#pragma once

#include "Platform/Context.h"
#include "Values/Bytes.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <cstddef>
#include <functional>
#include <memory>
#include <string_view>

namespace spectrel {

/// Keys of the state dictionary, which the model owns and every generator fills.
namespace StateKey {
inline constexpr std::string_view History = "History"; // list of history entries, oldest first, at most 5
inline constexpr std::string_view DisplayState = "DisplayState"; // raw material of the latest display build
inline constexpr std::string_view Display = "Display"; // the display dictionary
inline constexpr std::string_view ExtraInfo = "ExtraInfo"; // a dictionary, new and empty whenever "Display" is built
inline constexpr std::string_view Template = "Template"; // the display template, loaded once
inline constexpr std::string_view Lookup = "Lookup"; // the field lookup that one generator derives from its template
} // namespace StateKey

/// Turns the log stream of one radio technology into display state.
class LogGenerator {
public:
    static constexpr std::size_t HistoryLimit = 5;

    virtual ~LogGenerator();
    LogGenerator(const LogGenerator&) = delete;
    LogGenerator& operator=(const LogGenerator&) = delete;

    /// Applies one inbound log message body. May throw the exceptions that records can raise; nobody catches them.
    virtual void updateState(Dictionary& state, ByteView data) = 0;
    /// The display dictionary, or an absent value; appends one history entry.
    virtual Value generateLogUsingState(Dictionary& state) = 0;
    /// The property-list dictionary that asks the baseband for what it should stream.
    virtual DictionaryRef getStartCommand() = 0;
    /// A new list of the dictionaries that a snapshot saves.
    virtual ListRef getSaveContentsFromState(const Dictionary& state) = 0;

    /// The concrete class's name. Two generators of one name draw the same display.
    virtual std::string_view className() const = 0;
    /// Goes on where a predecessor of the same class ended: with the display that the state holds and, when the
    /// predecessor is still there (not null), with the raw messages that no display build has taken yet.
    virtual void takeOver(LogGenerator* predecessor, Dictionary& state);
    /// Forgets the raw messages that no display build has taken yet, for programs that save no snapshot.
    virtual void discardRawMessages();
    /// Keeps a message that could not be applied among the raw messages, for a snapshot written at the program's end.
    virtual void keepRawMessage(ByteView data);

    /// A new generator for the telephony service's technology value; null for any other value. The factory of the
    /// programs; what is handed a factory does not know it.
    static std::unique_ptr<LogGenerator> generatorFromTechnology(const Value& technology, const Context& context);
    /// Appends one history entry, built from the state's current values, keeping the newest five.
    static void updateHistoryInState(Dictionary& state, const Clock& clock);

protected:
    explicit LogGenerator(const Context& context)
        : _context(context)
    {
    }
    const Context& context() const
    {
        return _context;
    }
    SystemLog& log() const
    {
        return _context.log;
    }
    /// The initialiser: logs "Creating Log object: %p". Apart from the constructor because one generator may stay
    /// uninitialised for want of a template.
    void init();

private:
    Context _context;
};

/// Makes a new generator for the telephony service's technology value; null for a value that it does not know.
using GeneratorFactory = std::function<std::unique_ptr<LogGenerator>(const Value& technology, const Context& context)>;

} // namespace spectrel
