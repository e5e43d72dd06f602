#include "Platform/TextBuffer.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstring>

namespace spectrel {

TextBuffer& TextBuffer::decimal(std::int64_t number)
{
    const auto result = std::to_chars(_characters + _length, _characters + sizeof _characters, number);
    if (result.ec == std::errc())
        _length = static_cast<std::size_t>(result.ptr - _characters);
    return *this;
}

TextBuffer& TextBuffer::fixed2(double number)
{
    if (std::isnan(number))
        return text(" nan");
    char digits[340]; // 309 digits of the largest double, the point and two decimals
    const auto result = std::to_chars(digits, digits + sizeof digits, number, std::chars_format::fixed, 2);
    const auto length = static_cast<std::size_t>(result.ptr - digits);
    if (length < 4) // only "inf"
        text(" ");
    return text({digits, length});
}

TextBuffer& TextBuffer::text(std::string_view text)
{
    const std::size_t fitting = std::min(text.size(), sizeof _characters - _length);
    std::memcpy(_characters + _length, text.data(), fitting);
    _length += fitting;
    return *this;
}

} // namespace spectrel
