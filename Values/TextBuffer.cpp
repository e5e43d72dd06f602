#include "Values/TextBuffer.h"

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
    return fixed(number, 4, 2);
}

TextBuffer& TextBuffer::fixed6(double number)
{
    return fixed(number, 0, 6);
}

TextBuffer& TextBuffer::fixed(double number, std::size_t leastLength, int decimals)
{
    char digits[340] = "nan"; // 309 digits of the largest double, the point and six decimals
    std::size_t length = 3;
    if (!std::isnan(number)) {
        const auto result = std::to_chars(digits, digits + sizeof digits, number, std::chars_format::fixed, decimals);
        length = static_cast<std::size_t>(result.ptr - digits);
    }
    if (length < leastLength) // only "nan" and "inf", one short of four
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
