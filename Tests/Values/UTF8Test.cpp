#include "Values/UTF8.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

std::string encoded(char32_t character)
{
    std::string text;
    appendUTF8(text, character);
    return text;
}

TEST(UTF8Test, EveryCharacterIsReadAsItIsWritten)
{
    for (char32_t character = 0; character <= 0x10FFFF; ++character) {
        if (!isCharacter(character))
            continue;
        const std::string text = encoded(character);
        const auto decoded = decodeUTF8(text + "more");
        ASSERT_TRUE(decoded) << std::hex << static_cast<unsigned>(character);
        ASSERT_EQ(decoded->character, character);
        ASSERT_EQ(decoded->bytes, text.size());
    }
}

TEST(UTF8Test, FormsHaveTheirLengths)
{
    EXPECT_EQ(encoded(0x7F), "\x7F");
    EXPECT_EQ(encoded(0x80), "\xC2\x80");
    EXPECT_EQ(encoded(0x7FF), "\xDF\xBF");
    EXPECT_EQ(encoded(0x800), "\xE0\xA0\x80");
    EXPECT_EQ(encoded(0xFFFF), "\xEF\xBF\xBF");
    EXPECT_EQ(encoded(0x10000), "\xF0\x90\x80\x80");
    EXPECT_EQ(encoded(0x10FFFF), "\xF4\x8F\xBF\xBF");
}

TEST(UTF8Test, WhatIsNoCharacterIsWrittenAsItsReplacement)
{
    for (const char32_t point : {0xD800, 0xDFFF, 0x110000}) {
        EXPECT_FALSE(isCharacter(point));
        EXPECT_EQ(encoded(point), "\xEF\xBF\xBD");
    }
}

TEST(UTF8Test, MalformedBytesAreNoCharacter)
{
    for (const char* text : {
             "", // nothing
             "\x80", "\xBF", "\xFE", "\xFF", // no first byte
             "\xC2", "\xE2\x82", "\xF0\x9F\x98", // cut
             "\xC2\x41", "\xE2\x41\x80", "\xF0\x9F\x98\x41", // broken off
             "\xC0\x80", "\xC1\xBF", "\xE0\x9F\xBF", "\xF0\x8F\xBF\xBF", // longer than need be
             "\xED\xA0\x80", "\xED\xBF\xBF", // half of a pair
             "\xF4\x90\x80\x80", "\xF5\x80\x80\x80", // beyond Unicode
         })
        EXPECT_FALSE(decodeUTF8(text)) << text;
}

} // namespace
} // namespace spectrel
