#include "Values/Base64.h"

#include <array>
#include <cstddef>
#include <cstdint>

namespace spectrel {

namespace {

constexpr std::string_view Alphabet = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
constexpr std::uint8_t Wrong = 0xFF;
constexpr std::uint8_t Space = 0xFE;
constexpr std::uint8_t Padding = 0xFD;

constexpr std::array<std::uint8_t, 256> makeSextets()
{
    std::array<std::uint8_t, 256> sextets {};
    sextets.fill(Wrong);
    for (std::size_t i = 0; i < Alphabet.size(); ++i)
        sextets[static_cast<std::uint8_t>(Alphabet[i])] = static_cast<std::uint8_t>(i);
    for (const char space : {' ', '\t', '\n', '\r'})
        sextets[static_cast<std::uint8_t>(space)] = Space;
    sextets['='] = Padding;
    return sextets;
}

constexpr auto Sextets = makeSextets();

} // namespace

std::optional<Bytes> decodeBase64(std::string_view text)
{
    Bytes bytes;
    bytes.reserve(text.size() / 4 * 3);
    std::uint32_t bits = 0; // not yet put out, in the low end
    int bitCount = 0;
    std::size_t digits = 0;
    std::size_t paddings = 0;
    for (const char character : text) {
        const std::uint8_t sextet = Sextets[static_cast<std::uint8_t>(character)];
        if (sextet == Space)
            continue;
        if (sextet == Padding) {
            ++paddings;
            continue;
        }
        if (sextet == Wrong || paddings > 0)
            return std::nullopt;
        ++digits;
        bits = bits << 6 | sextet;
        bitCount += 6;
        if (bitCount >= 8) {
            bitCount -= 8;
            bytes.push_back(static_cast<std::uint8_t>(bits >> bitCount));
            bits &= (1u << bitCount) - 1;
        }
    }
    if (bits != 0 || paddings > 2 || (digits + paddings) % 4 != 0 || digits % 4 == 1)
        return std::nullopt;
    return bytes;
}

void appendBase64(std::string& text, ByteView bytes)
{
    for (std::size_t start = 0; start < bytes.size(); start += 3) {
        const std::size_t count = bytes.size() - start < 3 ? bytes.size() - start : 3;
        std::uint32_t bits = 0;
        for (std::size_t i = 0; i < 3; ++i)
            bits = bits << 8 | (i < count ? bytes[start + i] : 0u);
        for (std::size_t i = 0; i < 4; ++i)
            text += i <= count ? Alphabet[bits >> (18 - 6 * i) & 63] : '=';
    }
}

} // namespace spectrel
