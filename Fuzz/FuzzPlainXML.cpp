// A property list in XML through both readers, the quick one writing over the list before. What it reads, the strict
// one reads as the same, kind for kind, bit for bit and in the same order; what somebody holds of the list before
// stays.
#include "Values/Description.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PlainXMLReader.h"
#include "Values/PropertyList/XMLPropertyListReader.h"

#include <algorithm>
#include <bit>
#include <cstdlib>
#include <string>

namespace {

using namespace spectrel;

bool isSame(const Value& left, const Value& right)
{
    if (left.kind() != right.kind())
        return false;
    if (left.kind() == Kind::Real)
        return std::bit_cast<std::uint64_t>(*left.real()) == std::bit_cast<std::uint64_t>(*right.real());
    if (left.list())
        return std::ranges::equal(left.list()->elements(), right.list()->elements(), isSame);
    if (left.dictionary())
        return std::ranges::equal(left.dictionary()->entries(), right.dictionary()->entries(),
            [](const auto& one, const auto& other) { return one.key == other.key && isSame(one.value, other.value); });
    return left == right;
}

/// The first container inside.
Value innerOf(const Value& value)
{
    if (const auto& list = value.list(); list && list->count() > 0)
        return (*list)[0];
    if (const auto& dictionary = value.dictionary(); dictionary && dictionary->count() > 0)
        return dictionary->entries().front().value;
    return {};
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size)
{
    static Value value; // over which the next one is read
    const Value held = innerOf(value);
    const std::string before = describe(held);
    const auto strict = parseXMLPropertyList({bytes, size});
    const bool isPlain = readPlainXML({reinterpret_cast<const char*>(bytes), size}, value);
    if ((isPlain && (!strict || !isSame(value, *strict))) || describe(held) != before)
        std::abort();
    return 0;
}
