#include "LogGenerator/CDMA/Lookup.h"

#include "Values/List.h"
#include "Values/TextBuffer.h"

namespace spectrel {

namespace {

constexpr std::string_view LabelKey = "key";
constexpr std::string_view HolderKey = "dict";

/// Calls `store` with the dictionary and the label of each position.
template <typename Store> void atEachPosition(std::string_view variable, const Value& lookup, Store store)
{
    const auto& variables = lookup.dictionary();
    const List* positions = variables ? (*variables)[variable].list().get() : nullptr;
    if (!positions)
        return;
    for (const Value& element : positions->elements()) {
        const auto& position = element.dictionary();
        const std::string* label = position ? (*position)[LabelKey].string() : nullptr;
        Dictionary* holder = position ? (*position)[HolderKey].dictionary().get() : nullptr;
        if (!label || !holder)
            return;
        store(*holder, *label);
    }
}

} // namespace

void addLookupPosition(
    Dictionary& lookup, std::string_view variable, std::string_view key, const DictionaryRef& dictionary)
{
    if (!lookup[variable].list())
        lookup.set(variable, List::make());
    lookup[variable].list()->append(
        Dictionary::make({{std::string(LabelKey), key}, {std::string(HolderKey), dictionary}}));
}

void setLookupValue(std::string_view variable, const Value& value, const Value& lookup)
{
    atEachPosition(
        variable, lookup, [&value](Dictionary& holder, const std::string& label) { holder.set(label, value); });
}

void setLookupText(std::string_view variable, std::string_view text, const Value& lookup)
{
    atEachPosition(
        variable, lookup, [text](Dictionary& holder, const std::string& label) { holder.setText(label, text); });
}

void publishFields(RecordView record, std::span<const Field> fields, const Value& lookup, std::size_t start)
{
    TextBuffer buffer;
    for (const Field& field : fields) {
        buffer.clear();
        setLookupText(field.key, field.format(fieldValue(record, field, start), buffer), lookup);
    }
}

} // namespace spectrel
