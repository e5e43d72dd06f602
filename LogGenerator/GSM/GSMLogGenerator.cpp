#include "LogGenerator/GSM/GSMLogGenerator.h"

#include "Platform/SystemLog.h"
#include "Platform/TelephonyProtocol.h"
#include "Values/PropertyList/PropertyList.h"

#include <array>
#include <string>

namespace spectrel {

namespace {

constexpr std::string_view SourceName = "LogGenerator/GSM/GSMLogGenerator";
// The lines that the log names for these two places. They are fixed, on purpose, so that the log's text stays the same
// when this file changes; the lines of today are others.
constexpr int UnknownObjectLine = 78;
constexpr int UndecodableLine = 90;

/// By kind.
constexpr std::array<std::string_view, 9> TypeNames {
    "nothing", "string", "dictionary", "array", "integer", "real", "boolean", "date", "data"};

/// The display copy of a value inside a container.
Value collapsed(const Value& object, SystemLog& log)
{
    Value processed = GSMLogGenerator::processObject(object, log);
    Value only = GSMLogGenerator::canCollapse(processed);
    return only.isAbsent() ? processed : only;
}

} // namespace

GSMLogGenerator::GSMLogGenerator(const Context& context)
    : LogGenerator(context)
{
    init();
}

std::unique_ptr<GSMLogGenerator> GSMLogGenerator::generator(const Context& context)
{
    return std::make_unique<GSMLogGenerator>(context);
}

std::string_view GSMLogGenerator::className() const
{
    return "GSMLogGenerator";
}

void GSMLogGenerator::updateState(Dictionary& state, ByteView data)
{
    const auto object = parsePropertyList(data);
    if (!object)
        reportAssertionFailure(log(), SourceName, UndecodableLine, "Could not deserialize the object");
    state.set(StateKey::DisplayState, object.value_or(Value()));
    state.set(StateKey::Display, object ? processObject(*object, log()) : Value());
    state.set(StateKey::ExtraInfo, Dictionary::make());
}

Value GSMLogGenerator::generateLogUsingState(Dictionary& state)
{
    updateHistoryInState(state, context().clock);
    return state[StateKey::Display];
}

DictionaryRef GSMLogGenerator::getStartCommand()
{
    return Dictionary::make({{TelephonyProtocol::SetStateKey, TelephonyProtocol::StreamingState}});
}

ListRef GSMLogGenerator::getSaveContentsFromState(const Dictionary& state)
{
    const auto& history = state[StateKey::History].list();
    return history ? history->copy() : List::make();
}

Value GSMLogGenerator::canCollapse(const Value& object)
{
    const auto& dictionary = object.dictionary();
    return dictionary && dictionary->count() == 1 ? dictionary->entries().front().value : Value();
}

Value GSMLogGenerator::processObject(const Value& object, SystemLog& log)
{
    if (object.string())
        return object;
    if (const auto& dictionary = object.dictionary()) {
        auto copy = std::make_shared<Dictionary>();
        copy->reserve(dictionary->count());
        for (const auto& [key, value] : dictionary->entries())
            copy->set(key, collapsed(value, log));
        return copy;
    }
    if (const auto& list = object.list()) {
        auto copy = std::make_shared<List>();
        for (std::size_t index = 1; index < list->count(); ++index) // without the first element, on purpose
            copy->append(collapsed((*list)[index], log));
        return copy;
    }
    const std::string typeName(TypeNames[static_cast<std::size_t>(object.kind())]);
    reportAssertionFailure(log, SourceName, UnknownObjectLine, "Unknown object of type " + typeName + " encountered");
    return {};
}

} // namespace spectrel
