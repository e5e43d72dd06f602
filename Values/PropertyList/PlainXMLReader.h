#pragma once

#include "Values/Value.h"

#include <string_view>

namespace spectrel {

/// Reads in one pass the XML form as the serialiser writes it: its head and foot, elements apart by line ends and tabs,
/// UTF-8, no comments, and no escapes but the three that it uses. `parseXMLPropertyList` reads the same value.
///
/// `value` may hold an earlier list: its containers and texts are used again, as far as nobody else holds them. False
/// when the document is not of this form, whether or not it is a property list; then `value` holds anything.
bool readPlainXML(std::string_view document, Value& value);

} // namespace spectrel
