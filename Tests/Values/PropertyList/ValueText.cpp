#include "Tests/Values/PropertyList/ValueText.h"

#include "Values/Dictionary.h"
#include "Values/List.h"

#include <bit>
#include <cmath>
#include <cstdio>

namespace spectrel {

namespace {

template <typename Characters> std::string hexadecimal(const Characters& characters)
{
    constexpr char Digits[] = "0123456789abcdef";
    std::string text;
    for (const auto character : characters) {
        text += Digits[static_cast<std::uint8_t>(character) >> 4];
        text += Digits[static_cast<std::uint8_t>(character) & 15];
    }
    return text;
}

std::string realBits(double number)
{
    if (std::isnan(number))
        return "rnan";
    char text[20];
    std::snprintf(text, sizeof text, "r%016llx", static_cast<unsigned long long>(std::bit_cast<std::uint64_t>(number)));
    return text;
}

std::string integerDigits(Integer number)
{
    return number.isNegative() ? std::to_string(static_cast<std::int64_t>(number.bits()))
                               : std::to_string(number.bits());
}

std::string listText(const List& list)
{
    std::string text = "[";
    for (const Value& element : list.elements())
        text += (text.size() > 1 ? "," : "") + valueText(element);
    return text + "]";
}

std::string dictionaryText(const Dictionary& dictionary)
{
    std::string text = "{";
    for (const auto& [key, value] : dictionary.entries())
        text += (text.size() > 1 ? "," : "") + hexadecimal(key) + ":" + valueText(value);
    return text + "}";
}

} // namespace

std::string valueText(const Value& value)
{
    switch (value.kind()) {
    case Kind::Absent:
        return "absent";
    case Kind::String:
        return "s" + hexadecimal(*value.string());
    case Kind::Dictionary:
        return dictionaryText(*value.dictionary());
    case Kind::List:
        return listText(*value.list());
    case Kind::Integer:
        return "i" + integerDigits(*value.integer());
    case Kind::Real:
        return realBits(*value.real());
    case Kind::Boolean:
        return *value.boolean() ? "T" : "F";
    case Kind::Date:
        return "t" + std::to_string(static_cast<std::int64_t>(std::floor(value.date()->secondsSince2001)));
    case Kind::Data:
        return "d" + hexadecimal(*value.data());
    }
    return "?";
}

} // namespace spectrel
