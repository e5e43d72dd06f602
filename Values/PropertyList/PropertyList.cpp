#include "Values/PropertyList/PropertyList.h"

#include "Values/PropertyList/BinaryPropertyListReader.h"
#include "Values/PropertyList/PlainXMLReader.h"
#include "Values/PropertyList/XMLPropertyListReader.h"

#include <string_view>
#include <utility>

namespace spectrel {

namespace {

/// The strict readers, which judge whatever is not in the one plain form.
std::optional<Value> parseAnyForm(ByteView bytes, std::string_view characters)
{
    return characters.starts_with(BinaryPropertyListMagic) ? parseBinaryPropertyList(bytes)
                                                           : parseXMLPropertyList(bytes);
}

} // namespace

std::optional<Value> parsePropertyList(ByteView bytes)
{
    Value value;
    return readPropertyList(bytes, value) ? std::optional(std::move(value)) : std::nullopt;
}

bool readPropertyList(ByteView bytes, Value& value)
{
    std::optional<Value> parsed;
    if (bytes.size() <= PropertyListLimits::SerialisedBytes) {
        const std::string_view characters(reinterpret_cast<const char*>(bytes.data()), bytes.size());
        if (readPlainXML(characters, value))
            return true;
        parsed = parseAnyForm(bytes, characters);
    }
    value = std::move(parsed).value_or(Value());
    return !value.isAbsent();
}

} // namespace spectrel
