#include "CommandLine/DisplayPrinter.h"

#include "Monitor/DisplayOrder.h"
#include "Platform/List.h"

#include <cstdio>
#include <rapidjson/writer.h>

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

using JsonWriter = rapidjson::Writer<StringSink>;

void writeText(JsonWriter& writer, std::string_view text)
{
    writer.String(text.data(), static_cast<rapidjson::SizeType>(text.size()));
}

void writeValue(JsonWriter& writer, const Value& value)
{
    if (const auto* text = value.string()) {
        writeText(writer, *text);
    } else if (const auto& dictionary = value.dictionary()) {
        writer.StartObject();
        forEachDisplayChild(*dictionary, [&writer](std::string_view name, const Value& child) {
            writer.Key(name.data(), static_cast<rapidjson::SizeType>(name.size()));
            writeValue(writer, child);
        });
        writer.EndObject();
    } else if (const auto& list = value.list()) {
        writer.StartArray();
        for (const Value& element : list->elements())
            writeValue(writer, element);
        writer.EndArray();
    } else {
        writeText(writer, UnknownText);
    }
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
    StringSink sink(out);
    JsonWriter writer(sink);
    writeValue(writer, display);
}

void appendJsonText(std::string_view text, std::string& out)
{
    StringSink sink(out);
    JsonWriter writer(sink);
    writeText(writer, text);
}

} // namespace spectrel
