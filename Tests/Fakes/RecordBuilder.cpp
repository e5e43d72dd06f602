#include "Tests/Fakes/RecordBuilder.h"

#include "Values/PropertyList/PropertyList.h"

#include <algorithm>
#include <stdexcept>

namespace spectrel {

namespace {
constexpr std::uint32_t Extra = 0xFF0000;
constexpr std::size_t HeaderSize = 13;
} // namespace

RecordBuilder::RecordBuilder(std::uint32_t code, std::size_t size)
    : _bytes(std::max(size, HeaderSize))
{
    u8(0, code >= Extra ? 0xFF : 0x01);
    u16(1, static_cast<std::uint32_t>(_bytes.size() - 1));
    u16(3, code);
    shrink(size);
}

RecordBuilder RecordBuilder::withPropertyList(std::uint32_t code, const Value& payload)
{
    const auto text = serialisePropertyList(payload);
    if (!text)
        throw std::invalid_argument("not a property list");
    return withPayload(code, {reinterpret_cast<const std::uint8_t*>(text->data()), text->size()});
}

RecordBuilder RecordBuilder::withPayload(std::uint32_t code, ByteView payload)
{
    RecordBuilder record(code, HeaderSize + payload.size());
    std::copy(payload.begin(), payload.end(), record._bytes.begin() + HeaderSize);
    return record;
}

RecordBuilder& RecordBuilder::u8(std::size_t offset, std::uint32_t value)
{
    _bytes.at(offset) = static_cast<std::uint8_t>(value);
    return *this;
}

RecordBuilder& RecordBuilder::u16(std::size_t offset, std::uint32_t value)
{
    return u8(offset, value).u8(offset + 1, value >> 8);
}

RecordBuilder& RecordBuilder::u32(std::size_t offset, std::uint32_t value)
{
    return u16(offset, value).u16(offset + 2, value >> 16);
}

RecordBuilder& RecordBuilder::shrink(std::size_t size)
{
    _bytes.resize(std::min(size, _bytes.size()));
    return *this;
}

RecordBuilder& RecordBuilder::wrap()
{
    _bytes.insert(_bytes.begin(), {0x81, 0x00});
    return *this;
}

} // namespace spectrel
