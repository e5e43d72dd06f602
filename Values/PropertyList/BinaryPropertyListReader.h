#pragma once

#include "Values/Bytes.h"
#include "Values/Value.h"

#include <optional>
#include <string_view>

namespace spectrel {

constexpr std::string_view BinaryPropertyListMagic = "bplist00";

/// Reads the binary form. None when it does not parse; sets, unique identifiers and nulls are no property-list values.
///
/// Layout, all numbers big-endian: the magic; the objects; the table of their offsets; a trailer of 32 bytes, which
/// ends the file: 6 unused, 1 width of an offset, 1 width of a reference, 8 number of objects, 8 the top object, 8
/// where the table starts.
std::optional<Value> parseBinaryPropertyList(ByteView bytes);

} // namespace spectrel
