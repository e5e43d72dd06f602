#include "Values/PropertyList/PropertyList.h"

#include "Values/PropertyList/BinaryPropertyListReader.h"
#include "Values/PropertyList/XMLPropertyListReader.h"

#include <string_view>

namespace spectrel {

std::optional<Value> parsePropertyList(ByteView bytes)
{
    if (bytes.size() > PropertyListLimits::SerialisedBytes)
        return std::nullopt;
    const std::string_view characters(reinterpret_cast<const char*>(bytes.data()), bytes.size());
    if (characters.starts_with(BinaryPropertyListMagic))
        return parseBinaryPropertyList(bytes);
    return parseXMLPropertyList(bytes);
}

} // namespace spectrel
