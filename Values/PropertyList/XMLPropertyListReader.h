#pragma once

#include "Values/Bytes.h"
#include "Values/Value.h"

#include <optional>

namespace spectrel {

/// Reads the XML form in any encoding that the document declares or its byte-order mark says (UTF-8, UTF-16,
/// ISO 8859-1, ASCII). None when it does not parse.
std::optional<Value> parseXMLPropertyList(ByteView bytes);

} // namespace spectrel
