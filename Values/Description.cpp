#include "Values/Description.h"

#include "Values/Dictionary.h"
#include "Values/List.h"

#include <cstdio>

namespace spectrel {

namespace {

std::string dataText(const Bytes& bytes)
{
    std::string text = "data ";
    for (const std::uint8_t byte : bytes) {
        char digits[3];
        std::snprintf(digits, sizeof digits, "%02x", byte);
        text += digits;
    }
    return text;
}

std::string numberText(const char* kind, double number)
{
    char text[64];
    std::snprintf(text, sizeof text, "%s %g", kind, number);
    return text;
}

std::string dictionaryText(const Dictionary& dictionary)
{
    std::string text = "{";
    for (const auto& [key, value] : dictionary.entries())
        text += (text.size() > 1 ? ", \"" : "\"") + key + "\": " + describe(value);
    return text + "}";
}

std::string listText(const List& list)
{
    std::string text = "[";
    for (const Value& element : list.elements())
        text += (text.size() > 1 ? ", " : "") + describe(element);
    return text + "]";
}

} // namespace

std::string describe(const Value& value)
{
    switch (value.kind()) {
    case Kind::Absent:
        return "none";
    case Kind::String:
        return "\"" + *value.string() + "\"";
    case Kind::Dictionary:
        return dictionaryText(*value.dictionary());
    case Kind::List:
        return listText(*value.list());
    case Kind::Integer:
        return "int " + std::to_string(static_cast<std::int64_t>(value.integer()->bits()));
    case Kind::Real:
        return numberText("real", *value.real());
    case Kind::Boolean:
        return *value.boolean() ? "true" : "false";
    case Kind::Date:
        return numberText("date", value.date()->secondsSince2001);
    case Kind::Data:
        return dataText(*value.data());
    }
    return "?";
}

} // namespace spectrel
