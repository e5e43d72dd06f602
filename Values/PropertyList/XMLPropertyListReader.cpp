#include "Values/PropertyList/XMLPropertyListReader.h"

#include "Values/Base64.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyListBudget.h"
#include "Values/PropertyList/PropertyListScalars.h"

#include <array>
#include <expat.h>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace spectrel {

namespace {

enum class Element : std::uint8_t { None, Plist, Dict, Array, Key, String, Integer, Real, Date, Data, True, False };

struct NamedElement {
    std::string_view name;
    Element element;
};

constexpr std::array<NamedElement, 11> Elements {{
    {"plist", Element::Plist},
    {"dict", Element::Dict},
    {"array", Element::Array},
    {"key", Element::Key},
    {"string", Element::String},
    {"integer", Element::Integer},
    {"real", Element::Real},
    {"date", Element::Date},
    {"data", Element::Data},
    {"true", Element::True},
    {"false", Element::False},
}};

Element elementNamed(std::string_view name)
{
    for (const NamedElement& known : Elements) {
        if (known.name == name)
            return known.element;
    }
    return Element::None;
}

bool isBlank(std::string_view text)
{
    return text.find_first_not_of(" \t\n\r") == std::string_view::npos;
}

class XMLReader {
public:
    XMLReader();
    std::optional<Value> read(ByteView bytes);

private:
    /// A container whose end is yet to come.
    struct Open {
        DictionaryRef dictionary; // one of the two
        ListRef list;
        std::optional<std::string> key; // waits for its value
    };
    struct ParserDeleter {
        void operator()(XML_Parser parser) const
        {
            XML_ParserFree(parser);
        }
    };

    void fail();
    void begin(Element element);
    void beginKey();
    void beginValue(Element element);
    void end(Element element);
    void text(std::string_view piece);
    bool takesValue() const;
    void store(Value value);
    Value leafValue();
    Value textValue();
    Value dataValue();

    std::unique_ptr<std::remove_pointer_t<XML_Parser>, ParserDeleter> _parser {XML_ParserCreate(nullptr)};
    PropertyListBudget _budget;
    std::vector<Open> _open;
    Element _leaf = Element::None; // the element without children that is open
    std::string _text; // its text so far
    bool _insidePlist = false;
    bool _failed = false;
    Value _result;
};

XMLReader::XMLReader()
{
    XML_SetUserData(_parser.get(), this);
    XML_SetElementHandler(
        _parser.get(),
        [](void* self, const XML_Char* name, const XML_Char**) {
            static_cast<XMLReader*>(self)->begin(elementNamed(name));
        },
        [](void* self, const XML_Char* name) { static_cast<XMLReader*>(self)->end(elementNamed(name)); });
    XML_SetCharacterDataHandler(_parser.get(), [](void* self, const XML_Char* piece, int length) {
        static_cast<XMLReader*>(self)->text({piece, static_cast<std::size_t>(length)});
    });
    // Declarations of the document's own (entities above all) have no place in a property list.
    XML_SetStartDoctypeDeclHandler(
        _parser.get(), [](void* self, const XML_Char*, const XML_Char*, const XML_Char*, int hasOwnDeclarations) {
            if (hasOwnDeclarations)
                static_cast<XMLReader*>(self)->fail();
        });
    // An entity that only the document type outside could declare.
    XML_SetSkippedEntityHandler(
        _parser.get(), [](void* self, const XML_Char*, int) { static_cast<XMLReader*>(self)->fail(); });
}

std::optional<Value> XMLReader::read(ByteView bytes)
{
    const auto* characters = reinterpret_cast<const char*>(bytes.data());
    const auto status = XML_Parse(_parser.get(), characters, static_cast<int>(bytes.size()), XML_TRUE);
    if (status != XML_STATUS_OK || _failed || _result.isAbsent())
        return std::nullopt;
    return std::move(_result);
}

void XMLReader::fail()
{
    _failed = true;
    XML_StopParser(_parser.get(), XML_FALSE);
}

void XMLReader::begin(Element element)
{
    if (_failed)
        return;
    const bool isPlist = element == Element::Plist;
    if (element == Element::None || _leaf != Element::None || isPlist == _insidePlist)
        return fail();
    if (isPlist)
        _insidePlist = true;
    else if (element == Element::Key)
        beginKey();
    else
        beginValue(element);
}

void XMLReader::beginKey()
{
    if (_open.empty() || !_open.back().dictionary || _open.back().key)
        return fail();
    _leaf = Element::Key;
}

void XMLReader::beginValue(Element element)
{
    if (!takesValue() || !_budget.takeValue())
        return fail();
    if (element != Element::Dict && element != Element::Array) {
        _leaf = element;
        return;
    }
    if (_open.size() >= PropertyListLimits::Depth)
        return fail();
    Open opened;
    if (element == Element::Dict)
        opened.dictionary = Dictionary::make();
    else
        opened.list = List::make();
    store(opened.dictionary ? Value(opened.dictionary) : Value(opened.list));
    _open.push_back(std::move(opened));
}

void XMLReader::end(Element element)
{
    if (_failed)
        return;
    if (element == Element::Key) {
        if (!_budget.takeBytes(_text.size()))
            return fail();
        _open.back().key = _text;
    } else if (_leaf != Element::None) {
        Value value = leafValue();
        if (value.isAbsent())
            return fail();
        store(std::move(value));
    } else if (element != Element::Plist) {
        if (_open.back().key)
            return fail(); // a key without its value
        _open.pop_back();
    }
    _leaf = Element::None;
    _text.clear();
}

void XMLReader::text(std::string_view piece)
{
    if (_leaf != Element::None)
        _text += piece;
    else if (!isBlank(piece))
        fail();
}

bool XMLReader::takesValue() const
{
    if (_open.empty())
        return _result.isAbsent();
    return _open.back().list || _open.back().key;
}

void XMLReader::store(Value value)
{
    if (_open.empty()) {
        _result = std::move(value);
        return;
    }
    Open& holder = _open.back();
    if (holder.list) {
        holder.list->append(std::move(value));
    } else {
        holder.dictionary->set(*holder.key, std::move(value));
        holder.key.reset();
    }
}

/// Absent when the text is not what the element asks for.
Value XMLReader::leafValue()
{
    switch (_leaf) {
    case Element::String:
        return textValue();
    case Element::Integer: {
        const auto number = parseIntegerText(_text);
        return number ? Value(*number) : Value();
    }
    case Element::Real: {
        const auto number = parseRealText(_text);
        return number ? Value::real(*number) : Value();
    }
    case Element::Date: {
        const auto date = parseDateText(_text);
        return date ? Value(*date) : Value();
    }
    case Element::Data:
        return dataValue();
    default: // true and false
        return isBlank(_text) ? Value::boolean(_leaf == Element::True) : Value();
    }
}

Value XMLReader::textValue()
{
    return _budget.takeBytes(_text.size()) ? Value(_text) : Value();
}

Value XMLReader::dataValue()
{
    auto bytes = decodeBase64(_text);
    if (!bytes || !_budget.takeBytes(bytes->size()))
        return {};
    return std::make_shared<const Bytes>(std::move(*bytes));
}

} // namespace

std::optional<Value> parseXMLPropertyList(ByteView bytes)
{
    return XMLReader().read(bytes);
}

} // namespace spectrel
