#include "Values/Base64.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyList.h"
#include "Values/PropertyList/PropertyListScalars.h"
#include "Values/PropertyList/XMLPropertyListForm.h"
#include "Values/UTF8.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <string>
#include <string_view>

namespace spectrel {

namespace {

constexpr std::size_t BytesPerDataLine = 57; // 76 characters

/// The length of the well-formed UTF-8 character at the front that XML can carry; 0 when there is none.
std::size_t characterLength(std::string_view text)
{
    const auto first = decodeUTF8(text);
    if (!first)
        return 0;
    const char32_t character = first->character;
    const bool isControl = character < 0x20 && character != '\t' && character != '\n' && character != '\r';
    return isControl || character == 0xFFFE || character == 0xFFFF ? 0 : first->bytes;
}

/// How a character must be written; empty when it stands for itself.
std::string_view escapeOf(char character)
{
    switch (character) {
    case '&':
        return "&amp;";
    case '<':
        return "&lt;";
    case '>':
        return "&gt;";
    case '\r':
        return "&#13;"; // a bare one would be read as the end of a line
    default:
        return {};
    }
}

/// The characters that stand for themselves, by far the most: the others get a closer look.
constexpr std::array<bool, 256> makePlain()
{
    std::array<bool, 256> plain {};
    for (std::size_t character = ' '; character < 0x80; ++character)
        plain[character] = character != '&' && character != '<' && character != '>';
    return plain;
}

constexpr std::array<bool, 256> Plain = makePlain();

class XMLWriter {
public:
    std::optional<std::string> write(const Value& value);

private:
    bool writeValue(const Value& value, std::size_t depth);
    bool writeDictionary(const Dictionary& dictionary, std::size_t depth);
    bool writeList(const List& list, std::size_t depth);
    bool writeText(std::string_view element, std::string_view text);
    void writeData(const Bytes& bytes, std::size_t depth);
    void writePlain(std::string_view element, std::string_view text);
    void line(std::size_t depth, std::string_view text);

    std::string _out;
    std::size_t _values = 0;
};

std::optional<std::string> XMLWriter::write(const Value& value)
{
    _out = XMLPropertyListHead;
    if (!writeValue(value, 0))
        return std::nullopt;
    _out += XMLPropertyListFoot;
    return _out.size() <= PropertyListLimits::SerialisedBytes ? std::optional(std::move(_out)) : std::nullopt;
}

/// `depth` counts the containers around the value.
bool XMLWriter::writeValue(const Value& value, std::size_t depth)
{
    // Shared containers are written each time they are met: the limits bound that, too.
    if (++_values > PropertyListLimits::Values || _out.size() > PropertyListLimits::SerialisedBytes)
        return false;
    _out.append(depth, '\t');
    switch (value.kind()) {
    case Kind::Absent:
        return false;
    case Kind::String:
        return writeText("string", *value.string());
    case Kind::Dictionary:
        return writeDictionary(*value.dictionary(), depth);
    case Kind::List:
        return writeList(*value.list(), depth);
    case Kind::Integer:
        writePlain("integer", integerText(*value.integer()));
        return true;
    case Kind::Real:
        writePlain("real", realText(*value.real()));
        return true;
    case Kind::Boolean:
        _out += *value.boolean() ? "<true/>\n" : "<false/>\n";
        return true;
    case Kind::Date: {
        const auto text = dateText(*value.date());
        if (text)
            writePlain("date", *text);
        return text.has_value();
    }
    case Kind::Data:
        writeData(*value.data(), depth);
        return true;
    }
    return false;
}

bool XMLWriter::writeDictionary(const Dictionary& dictionary, std::size_t depth)
{
    if (depth >= PropertyListLimits::Depth)
        return false;
    if (dictionary.count() == 0) {
        _out += "<dict/>\n";
        return true;
    }
    _out += "<dict>\n";
    for (const auto& [key, value] : dictionary.entries()) {
        _out.append(depth + 1, '\t');
        if (!writeText("key", key) || !writeValue(value, depth + 1))
            return false;
    }
    line(depth, "</dict>");
    return true;
}

bool XMLWriter::writeList(const List& list, std::size_t depth)
{
    if (depth >= PropertyListLimits::Depth)
        return false;
    if (list.count() == 0) {
        _out += "<array/>\n";
        return true;
    }
    _out += "<array>\n";
    for (const Value& element : list.elements()) {
        if (!writeValue(element, depth + 1))
            return false;
    }
    line(depth, "</array>");
    return true;
}

bool XMLWriter::writeText(std::string_view element, std::string_view text)
{
    _out.append("<").append(element).append(">");
    std::size_t written = 0; // what stands before has been put out
    for (std::size_t place = 0; place < text.size();) {
        if (Plain[static_cast<std::uint8_t>(text[place])]) {
            ++place;
            continue;
        }
        const std::size_t length = characterLength(text.substr(place));
        if (length == 0)
            return false;
        if (const std::string_view escape = escapeOf(text[place]); !escape.empty()) {
            _out.append(text, written, place - written).append(escape);
            written = place + 1;
        }
        place += length;
    }
    _out.append(text, written).append("</").append(element).append(">\n");
    return true;
}

void XMLWriter::writeData(const Bytes& bytes, std::size_t depth)
{
    _out += "<data>";
    for (std::size_t start = 0; start < bytes.size(); start += BytesPerDataLine) {
        _out += '\n';
        _out.append(depth, '\t');
        appendBase64(_out, ByteView(bytes).subspan(start, std::min(BytesPerDataLine, bytes.size() - start)));
    }
    if (!bytes.empty()) {
        _out += '\n';
        _out.append(depth, '\t');
    }
    _out += "</data>\n";
}

void XMLWriter::writePlain(std::string_view element, std::string_view text)
{
    _out.append("<").append(element).append(">").append(text).append("</").append(element).append(">\n");
}

void XMLWriter::line(std::size_t depth, std::string_view text)
{
    _out.append(depth, '\t').append(text).append("\n");
}

} // namespace

std::optional<std::string> serialisePropertyList(const Value& value)
{
    return XMLWriter().write(value);
}

} // namespace spectrel
