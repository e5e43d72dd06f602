#include "Values/PropertyList/PlainXMLReader.h"

#include "Values/Base64.h"
#include "Values/PropertyList/PropertyListBudget.h"
#include "Values/PropertyList/PropertyListScalars.h"
#include "Values/PropertyList/XMLPropertyListForm.h"
#include "Values/Rewriting.h"
#include "Values/UTF8.h"

#include <array>
#include <cstdint>
#include <cstring>
#include <memory>
#include <optional>
#include <string>

namespace spectrel {

namespace {

/// The bytes of a text that need no closer look.
constexpr std::array<bool, 256> makePlain()
{
    std::array<bool, 256> plain {};
    for (std::size_t byte = ' '; byte < 0x7F; ++byte)
        plain[byte] = byte != '<' && byte != '>' && byte != '&';
    plain['\t'] = true;
    plain['\n'] = true;
    return plain;
}

constexpr std::array<bool, 256> Plain = makePlain();

struct Escape {
    std::string_view written;
    char character;
};

constexpr std::array<Escape, 3> Escapes {{{"&amp;", '&'}, {"&lt;", '<'}, {"&gt;", '>'}}};

constexpr std::uint64_t EachByte = 0x0101010101010101;
constexpr std::uint64_t TopBits = EachByte * 0x80;

/// Sets the top bit of a byte that is the one looked for, and perhaps of bytes above it; zero when none is.
constexpr std::uint64_t findByte(std::uint64_t word, std::uint8_t byte)
{
    const std::uint64_t different = word ^ EachByte * byte;
    return (different - EachByte) & ~different & TopBits;
}

/// Whether none of eight bytes is a control, '<', '>', '&' or beyond ASCII.
bool isPlain(std::uint64_t word)
{
    const std::uint64_t belowSpace = (word - EachByte * ' ') & ~word & TopBits;
    // '<' and '>' differ in one bit
    const std::uint64_t marks = findByte(word | EachByte * 2, '>') | findByte(word, '&');
    return ((word & TopBits) | belowSpace | marks | findByte(word, 0x7F)) == 0;
}

class PlainReader {
public:
    explicit PlainReader(std::string_view document)
        : _at(document.data())
        , _end(document.data() + document.size())
    {
    }
    bool read(Value& value)
    {
        return take(XMLPropertyListHead) && readElement(value, 0) && (skipSpace(), take(XMLPropertyListFoot))
            && _at == _end;
    }

private:
    std::size_t left() const
    {
        return static_cast<std::size_t>(_end - _at);
    }
    bool take(std::string_view expected)
    {
        if (left() < expected.size() || std::memcmp(_at, expected.data(), expected.size()) != 0)
            return false;
        _at += expected.size();
        return true;
    }
    void skipSpace()
    {
        while (_at != _end && (*_at == '\n' || *_at == '\t'))
            ++_at;
    }

    /// `depth` counts the containers around the element.
    bool readElement(Value& value, std::size_t depth);
    bool readDictionary(Value& value, std::size_t depth);
    bool readList(Value& value, std::size_t depth);
    bool readInteger(Value& value);
    bool readReal(Value& value);
    bool readDate(Value& value);
    bool readData(Value& value);
    std::optional<std::string_view> readText(std::string_view endTag);
    bool readLessPlainText(const char* start);

    const char* _at;
    const char* _end;
    PropertyListBudget _budget;
    std::string _text; // the latest one that does not stand in the document as it is
};

bool PlainReader::readElement(Value& value, std::size_t depth)
{
    skipSpace();
    if (!_budget.takeValue())
        return false;
    if (take("<string>")) {
        const auto text = readText("</string>");
        if (text)
            value.assignText(*text);
        return text && _budget.takeBytes(text->size());
    }
    if (take("<integer>"))
        return readInteger(value);
    if (take("<dict"))
        return depth < PropertyListLimits::Depth && readDictionary(value, depth);
    if (take("<array"))
        return depth < PropertyListLimits::Depth && readList(value, depth);
    if (take("<true/>")) {
        value = Value::boolean(true);
        return true;
    }
    if (take("<false/>")) {
        value = Value::boolean(false);
        return true;
    }
    if (take("<real>"))
        return readReal(value);
    if (take("<date>"))
        return readDate(value);
    return take("<data>") && readData(value);
}

bool PlainReader::readDictionary(Value& value, std::size_t depth)
{
    DictionaryRewriting entries(dictionaryToRewrite(value));
    if (!take("/>")) {
        if (!take(">"))
            return false;
        for (skipSpace(); take("<key>"); skipSpace()) {
            const auto key = readText("</key>");
            if (!key || !_budget.takeBytes(key->size()) || !readElement(entries.slot(*key), depth + 1))
                return false;
        }
        if (!take("</dict>"))
            return false;
    }
    entries.finish();
    return true;
}

bool PlainReader::readList(Value& value, std::size_t depth)
{
    ListRewriting elements(listToRewrite(value));
    if (!take("/>")) {
        if (!take(">"))
            return false;
        for (skipSpace(); !take("</array>"); skipSpace()) {
            if (!readElement(elements.slot(), depth + 1))
                return false;
        }
    }
    elements.finish();
    return true;
}

bool PlainReader::readInteger(Value& value)
{
    const auto text = readText("</integer>");
    const auto number = text ? parseIntegerText(*text) : std::nullopt;
    if (number)
        value = *number;
    return number.has_value();
}

bool PlainReader::readReal(Value& value)
{
    const auto text = readText("</real>");
    const auto number = text ? parseRealText(*text) : std::nullopt;
    if (number)
        value = Value::real(*number);
    return number.has_value();
}

bool PlainReader::readDate(Value& value)
{
    const auto text = readText("</date>");
    const auto date = text ? parseDateText(*text) : std::nullopt;
    if (date)
        value = *date;
    return date.has_value();
}

bool PlainReader::readData(Value& value)
{
    const auto text = readText("</data>");
    auto bytes = text ? decodeBase64(*text) : std::nullopt;
    if (!bytes || !_budget.takeBytes(bytes->size()))
        return false;
    value = std::make_shared<const Bytes>(std::move(*bytes));
    return true;
}

/// The text up to the end tag; valid until the next one is read.
std::optional<std::string_view> PlainReader::readText(std::string_view endTag)
{
    const char* const start = _at;
    for (std::uint64_t word; left() >= sizeof word; _at += sizeof word) {
        std::memcpy(&word, _at, sizeof word);
        if (!isPlain(word))
            break;
    }
    while (_at != _end && Plain[static_cast<std::uint8_t>(*_at)])
        ++_at;
    std::string_view text(start, static_cast<std::size_t>(_at - start));
    if (_at != _end && *_at != '<') {
        if (!readLessPlainText(start))
            return std::nullopt;
        text = _text;
    }
    return take(endTag) ? std::optional(text) : std::nullopt;
}

/// Gathers a text with escapes or characters beyond ASCII up to the next tag.
bool PlainReader::readLessPlainText(const char* start)
{
    _text.assign(start, _at);
    while (_at != _end && *_at != '<') {
        if (Plain[static_cast<std::uint8_t>(*_at)]) {
            _text += *_at++;
        } else if (*_at == '&') {
            const std::size_t before = _text.size();
            for (const Escape& escape : Escapes) {
                if (_text.size() == before && take(escape.written))
                    _text += escape.character;
            }
            if (_text.size() == before)
                return false;
        } else {
            const auto next = decodeUTF8({_at, left()});
            if (!next || next->bytes < 2 || next->character == 0xFFFE || next->character == 0xFFFF)
                return false;
            _text.append(_at, next->bytes);
            _at += next->bytes;
        }
    }
    return true;
}

} // namespace

bool readPlainXML(std::string_view document, Value& value)
{
    return PlainReader(document).read(value);
}

} // namespace spectrel
