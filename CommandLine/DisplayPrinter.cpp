#include "CommandLine/DisplayPrinter.h"

#include "Monitor/DisplayOrder.h"
#include "Platform/List.h"

#include <cstdio>
#include <rapidjson/writer.h>
#include <utility>

namespace spectrel {

namespace {

/// Lets RapidJSON's writer append to a string.
class StringSink {
public:
    using Ch = char;
    explicit StringSink(std::string& out)
        : _out(out)
    {
    }
    void Put(char character)
    {
        _out += character;
    }
    void Flush() { }

private:
    std::string& _out;
};

/// Appends a child's separator, and so begins every child but the first.
void separate(bool& isFirst, std::string& out)
{
    if (!std::exchange(isFirst, false))
        out += ',';
}

void appendPlain(std::string_view text, std::string& out)
{
    for (const char character : text) {
        const auto byte = static_cast<unsigned char>(character);
        if (byte >= 0x20 && byte != 0x7F) {
            out += character;
            continue;
        }
        char escaped[8];
        std::snprintf(escaped, sizeof escaped, "\\x%02x", byte);
        out += escaped;
    }
}

void appendNode(std::string_view name, const Value& value, std::size_t depth, std::string& out);

void appendChildren(const Value& value, std::size_t depth, std::string& out)
{
    if (const auto& dictionary = value.dictionary()) {
        forEachDisplayChild(
            *dictionary, [&](std::string_view name, const Value& child) { appendNode(name, child, depth, out); });
    } else if (const auto& list = value.list()) {
        std::size_t position = 0;
        for (const Value& element : list->elements())
            appendNode(std::to_string(position++), element, depth, out);
    }
}

void appendNode(std::string_view name, const Value& value, std::size_t depth, std::string& out)
{
    out.append(2 * depth, ' ');
    appendPlain(name, out);
    if (value.dictionary() || value.list()) {
        out += '\n';
        return appendChildren(value, depth + 1, out);
    }
    out += ": ";
    appendPlain(value.string() ? std::string_view(*value.string()) : std::string_view(UnknownText), out);
    out += '\n';
}

} // namespace

void appendTree(const Value& display, std::string& out)
{
    if (display.dictionary() || display.list())
        return appendChildren(display, 0, out);
    appendPlain(display.string() ? std::string_view(*display.string()) : std::string_view(UnknownText), out);
    out += '\n';
}

void appendJson(const Value& display, std::string& out)
{
    bool isFirst = true;
    if (const auto& dictionary = display.dictionary()) {
        out += '{';
        forEachDisplayChild(*dictionary, [&](std::string_view name, const Value& child) {
            separate(isFirst, out);
            appendJsonText(name, out);
            out += ':';
            appendJson(child, out);
        });
        out += '}';
    } else if (const auto& list = display.list()) {
        out += '[';
        for (const Value& element : list->elements()) {
            separate(isFirst, out);
            appendJson(element, out);
        }
        out += ']';
    } else {
        appendJsonText(display.string() ? std::string_view(*display.string()) : std::string_view(UnknownText), out);
    }
}

void appendJsonText(std::string_view text, std::string& out)
{
    StringSink sink(out);
    rapidjson::Writer<StringSink> writer(sink);
    writer.String(text.data(), static_cast<rapidjson::SizeType>(text.size()));
}

} // namespace spectrel
