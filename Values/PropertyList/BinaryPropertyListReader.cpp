#include "Values/PropertyList/BinaryPropertyListReader.h"

#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyListBudget.h"
#include "Values/UTF8.h"

#include <bit>
#include <cmath>
#include <cstdint>
#include <string>

namespace spectrel {

namespace {

constexpr std::size_t TrailerLength = 32;

/// An object's first byte: its kind in the high half, a width or a count in the low half.
enum ObjectKind : std::uint8_t {
    Simple = 0x0,
    WholeNumber = 0x1,
    RealNumber = 0x2,
    DateObject = 0x3,
    DataObject = 0x4,
    ASCIIText = 0x5,
    UTF16Text = 0x6,
    Array = 0xA,
    Dict = 0xD,
};

constexpr std::uint8_t FalseObject = 0x08;
constexpr std::uint8_t TrueObject = 0x09;
constexpr std::uint8_t DateMarker = 0x33;
constexpr std::uint8_t CountFollows = 0xF;

class BinaryReader {
public:
    explicit BinaryReader(ByteView bytes)
        : _bytes(bytes)
    {
    }
    std::optional<Value> read();

private:
    /// An object's kind and where its content lies.
    struct Object {
        std::uint8_t marker = 0;
        std::size_t content = 0; // behind the marker and, where there is one, the count
        std::size_t count = 0; // of bytes, UTF-16 units, elements or pairs, as the marker gives it
    };

    std::uint64_t number(std::size_t place, std::size_t width) const;
    bool readTrailer();
    bool holds(std::size_t place, std::uint64_t count, std::size_t width) const;
    bool find(std::uint64_t reference, Object& object) const;
    bool readCount(Object& object) const;
    std::uint64_t reference(const Object& object, std::size_t position) const;

    Value value(std::uint64_t reference, std::size_t depth);
    Value wholeNumber(const Object& object) const;
    Value realNumber(const Object& object) const;
    Value date(const Object& object) const;
    Value data(const Object& object);
    Value array(const Object& object, std::size_t depth);
    Value dict(const Object& object, std::size_t depth);
    std::optional<std::string> text(const Object& object);
    std::optional<std::string> textOfUnits(const Object& object) const;

    ByteView _bytes;
    PropertyListBudget _budget;
    std::size_t _offsetWidth = 0;
    std::size_t _referenceWidth = 0;
    std::uint64_t _objects = 0;
    std::uint64_t _top = 0;
    std::uint64_t _table = 0; // where the offsets start, and the objects end
};

/// Big-endian, of 1 to 8 bytes.
std::uint64_t BinaryReader::number(std::size_t place, std::size_t width) const
{
    std::uint64_t number = 0;
    for (std::size_t i = 0; i < width; ++i)
        number = number << 8 | _bytes[place + i];
    return number;
}

bool BinaryReader::readTrailer()
{
    if (_bytes.size() < BinaryPropertyListMagic.size() + TrailerLength)
        return false;
    const std::size_t trailer = _bytes.size() - TrailerLength;
    _offsetWidth = _bytes[trailer + 6];
    _referenceWidth = _bytes[trailer + 7];
    _objects = number(trailer + 8, 8);
    _top = number(trailer + 16, 8);
    _table = number(trailer + 24, 8);
    return _offsetWidth >= 1 && _offsetWidth <= 8 && _referenceWidth >= 1 && _referenceWidth <= 8 && _objects > _top
        && _table > BinaryPropertyListMagic.size() && _table < trailer && (trailer - _table) % _offsetWidth == 0
        && (trailer - _table) / _offsetWidth == _objects;
}

/// Whether so many items of that width lie at the place within the objects.
bool BinaryReader::holds(std::size_t place, std::uint64_t count, std::size_t width) const
{
    return place <= _table && count <= (_table - place) / width;
}

bool BinaryReader::find(std::uint64_t reference, Object& object) const
{
    if (reference >= _objects)
        return false;
    const std::uint64_t offset = number(_table + reference * _offsetWidth, _offsetWidth);
    if (offset < BinaryPropertyListMagic.size() || offset >= _table)
        return false;
    object.marker = _bytes[offset];
    object.content = offset + 1;
    return true;
}

/// The count that stands in the marker or, when it is large, in a whole number behind it.
bool BinaryReader::readCount(Object& object) const
{
    object.count = object.marker & 0xF;
    if (object.count != CountFollows)
        return true;
    if (!holds(object.content, 1, 1))
        return false;
    const std::uint8_t marker = _bytes[object.content++];
    const std::size_t width = std::size_t(1) << (marker & 0xF);
    if (marker >> 4 != WholeNumber || width > 8 || !holds(object.content, 1, width))
        return false;
    object.count = number(object.content, width);
    object.content += width;
    return true;
}

std::uint64_t BinaryReader::reference(const Object& object, std::size_t position) const
{
    return number(object.content + position * _referenceWidth, _referenceWidth);
}

/// Absent when the object is none that a property list may hold.
Value BinaryReader::value(std::uint64_t reference, std::size_t depth)
{
    Object object;
    if (!_budget.takeValue() || !find(reference, object))
        return {};
    switch (object.marker >> 4) {
    case Simple:
        if (object.marker == FalseObject || object.marker == TrueObject)
            return Value::boolean(object.marker == TrueObject);
        return {};
    case WholeNumber:
        return wholeNumber(object);
    case RealNumber:
        return realNumber(object);
    case DateObject:
        return date(object);
    case DataObject:
        return data(object);
    case ASCIIText:
    case UTF16Text: {
        auto held = text(object);
        return held ? Value(std::move(*held)) : Value();
    }
    case Array:
        return array(object, depth + 1);
    case Dict:
        return dict(object, depth + 1);
    default:
        return {};
    }
}

/// Widths 1, 2 and 4 are unsigned, 8 is signed, 16 is signed and must fit.
Value BinaryReader::wholeNumber(const Object& object) const
{
    const std::size_t width = std::size_t(1) << (object.marker & 0xF);
    if (width > 16 || !holds(object.content, 1, width))
        return {};
    if (width < 8)
        return Integer::fromUnsigned(number(object.content, width));
    const std::uint64_t low = number(object.content + width - 8, 8);
    if (width == 8)
        return Integer::fromSigned(static_cast<std::int64_t>(low));
    const std::uint64_t high = number(object.content, 8);
    if (high == 0)
        return Integer::fromUnsigned(low);
    if (high == ~std::uint64_t(0) && low >> 63 == 1)
        return Integer::fromSigned(static_cast<std::int64_t>(low));
    return {};
}

Value BinaryReader::realNumber(const Object& object) const
{
    const std::size_t width = std::size_t(1) << (object.marker & 0xF);
    if ((width != 4 && width != 8) || !holds(object.content, 1, width))
        return {};
    if (width == 4)
        return Value::real(std::bit_cast<float>(static_cast<std::uint32_t>(number(object.content, 4))));
    return Value::real(std::bit_cast<double>(number(object.content, 8)));
}

Value BinaryReader::date(const Object& object) const
{
    if (object.marker != DateMarker || !holds(object.content, 1, 8))
        return {};
    const double seconds = std::bit_cast<double>(number(object.content, 8));
    return std::isfinite(seconds) ? Value(Date {seconds}) : Value();
}

Value BinaryReader::data(const Object& found)
{
    Object object = found;
    if (!readCount(object) || !holds(object.content, object.count, 1) || !_budget.takeBytes(object.count))
        return {};
    const ByteView content = _bytes.subspan(object.content, object.count);
    return std::make_shared<const Bytes>(content.begin(), content.end());
}

Value BinaryReader::array(const Object& found, std::size_t depth)
{
    Object object = found;
    if (depth > PropertyListLimits::Depth || !readCount(object)
        || !holds(object.content, object.count, _referenceWidth))
        return {};
    const ListRef list = List::make();
    for (std::size_t i = 0; i < object.count; ++i) {
        Value element = value(reference(object, i), depth);
        if (element.isAbsent())
            return {};
        list->append(std::move(element));
    }
    return list;
}

/// All keys come first, then all values.
Value BinaryReader::dict(const Object& found, std::size_t depth)
{
    Object object = found;
    if (depth > PropertyListLimits::Depth || !readCount(object)
        || !holds(object.content, object.count, 2 * _referenceWidth))
        return {};
    const DictionaryRef dictionary = Dictionary::make();
    for (std::size_t i = 0; i < object.count; ++i) {
        Object keyObject;
        const auto key = find(reference(object, i), keyObject) ? text(keyObject) : std::nullopt;
        Value held = key ? value(reference(object, object.count + i), depth) : Value();
        if (held.isAbsent())
            return {};
        dictionary->set(*key, std::move(held));
    }
    return dictionary;
}

/// None for an object that is no well-formed text.
std::optional<std::string> BinaryReader::text(const Object& found)
{
    Object object = found;
    const bool isASCII = object.marker >> 4 == ASCIIText;
    if ((!isASCII && object.marker >> 4 != UTF16Text) || !readCount(object)
        || !holds(object.content, object.count, isASCII ? 1 : 2))
        return std::nullopt;
    if (!_budget.takeBytes(object.count)) // before a byte is copied
        return std::nullopt;
    if (!isASCII) {
        auto converted = textOfUnits(object);
        if (converted && !_budget.takeBytes(converted->size() - object.count)) // a unit takes a byte or more
            return std::nullopt;
        return converted;
    }
    const ByteView content = _bytes.subspan(object.content, object.count);
    for (const std::uint8_t byte : content) {
        if (byte >= 0x80)
            return std::nullopt;
    }
    return std::string(content.begin(), content.end());
}

std::optional<std::string> BinaryReader::textOfUnits(const Object& object) const
{
    std::string converted;
    for (std::size_t i = 0; i < object.count; ++i) {
        auto point = static_cast<std::uint32_t>(number(object.content + 2 * i, 2));
        if (point >> 10 == 0x36 && i + 1 < object.count) { // the first half of a pair
            const auto second = static_cast<std::uint32_t>(number(object.content + 2 * i + 2, 2));
            if (second >> 10 != 0x37)
                return std::nullopt;
            point = 0x10000 + ((point & 0x3FF) << 10 | (second & 0x3FF));
            ++i;
        }
        if (!isCharacter(point)) // half of a pair
            return std::nullopt;
        appendUTF8(converted, point);
    }
    return converted;
}

std::optional<Value> BinaryReader::read()
{
    if (!readTrailer())
        return std::nullopt;
    Value top = value(_top, 0);
    return top.isAbsent() ? std::nullopt : std::optional(std::move(top));
}

} // namespace

std::optional<Value> parseBinaryPropertyList(ByteView bytes)
{
    return BinaryReader(bytes).read();
}

} // namespace spectrel
