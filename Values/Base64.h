#pragma once

#include "Values/Bytes.h"

#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// The bytes that a base64 text stands for. White space may stand anywhere; wrong characters, missing padding, anything
/// behind the padding and unused bits that are not zero give none.
std::optional<Bytes> decodeBase64(std::string_view text);

/// Appends the base64 form of the bytes, padded, without line breaks.
void appendBase64(std::string& text, ByteView bytes);

} // namespace spectrel
