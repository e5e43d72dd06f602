#pragma once

#include "Values/JsonText.h"

#include <charconv>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

namespace spectrel {

/// Appends a number without exponent and needless digits, whatever the user's locale is.
inline void appendJsonNumber(double value, std::string& out)
{
    char digits[400];
    const auto end = std::to_chars(digits, digits + sizeof digits, value, std::chars_format::fixed).ptr;
    out.append(digits, end);
}

/// Appends one JSON object on one line: begins it when made, ends it when it goes. Pairs that have nothing to tell are
/// left out.
class JsonObjectWriter {
public:
    explicit JsonObjectWriter(std::string& out)
        : _out(out)
    {
        _out += '{';
    }
    JsonObjectWriter(const JsonObjectWriter&) = delete;
    JsonObjectWriter& operator=(const JsonObjectWriter&) = delete;
    ~JsonObjectWriter()
    {
        _out += '}';
    }

    /// Begins a pair; its value is appended to what this gives.
    std::string& key(std::string_view name)
    {
        if (!std::exchange(_isFirst, false))
            _out += ", ";
        appendJsonText(name, _out);
        _out += ": ";
        return _out;
    }
    void text(std::string_view name, std::string_view value)
    {
        if (!value.empty())
            appendJsonText(value, key(name));
    }
    template <typename Number> void number(std::string_view name, const std::optional<Number>& value)
    {
        if (value)
            appendJsonNumber(static_cast<double>(*value), key(name));
    }

private:
    std::string& _out;
    bool _isFirst = true;
};

/// Appends a JSON array of what `append(element)` appends of each element.
template <typename Elements, typename Append>
void appendJsonArray(const Elements& elements, std::string& out, Append append)
{
    out += '[';
    bool isFirst = true;
    for (const auto& element : elements) {
        if (!std::exchange(isFirst, false))
            out += ", ";
        append(element);
    }
    out += ']';
}

} // namespace spectrel
