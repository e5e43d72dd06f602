#include "Values/TextBuffer.h"

#include <algorithm>
#include <bit>
#include <charconv>
#include <cmath>
#include <cstring>
#include <limits>
#include <optional>

namespace spectrel {

namespace {

constexpr int FractionBits = 52; // of a double
constexpr int LargestExponent = 0x7FF; // that its bits can hold: infinity, or no number
constexpr int ExponentOfOne = 0x3FF;

/// The magnitude of `number`, `factor` times, rounded to a whole number exactly as printf rounds: a half to the even
/// one. None where 64 bits do not hold what that takes.
std::optional<std::uint64_t> roundedProduct(double number, std::uint64_t factor)
{
    const auto bits = std::bit_cast<std::uint64_t>(number);
    const int exponent = static_cast<int>(bits >> FractionBits) & LargestExponent;
    const int shift = ExponentOfOne + FractionBits - exponent; // the magnitude is significand / 2^shift
    if (exponent == 0 || shift <= 0)
        return number == 0 ? std::optional<std::uint64_t>(0) : std::nullopt;
    const std::uint64_t one = std::uint64_t(1) << FractionBits;
    const std::uint64_t significand = (bits & (one - 1)) | one;
    const int zeros = std::min(std::countr_zero(significand), shift);
    const int binary = shift - zeros; // binary places behind the point
    if (significand >> zeros > std::numeric_limits<std::uint64_t>::max() / factor || binary > 63)
        return std::nullopt;
    const std::uint64_t product = (significand >> zeros) * factor;
    if (binary == 0)
        return product;
    const std::uint64_t whole = product >> binary;
    const std::uint64_t rest = product - (whole << binary);
    const std::uint64_t half = std::uint64_t(1) << (binary - 1);
    return whole + (rest > half || (rest == half && whole % 2 == 1) ? 1 : 0);
}

} // namespace

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
    std::uint64_t factor = 1;
    for (int place = 0; place < decimals; ++place)
        factor *= 10;
    if (const auto product = roundedProduct(number, factor)) {
        if (std::signbit(number))
            text("-");
        decimal(static_cast<std::int64_t>(*product / factor)).text(".");
        for (factor /= 10; factor > 0; factor /= 10)
            text(std::string_view("0123456789").substr(*product / factor % 10, 1));
        return *this; // with two decimals never shorter than four characters
    }
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
