#include "LogGenerator/Template/Fields.h"

#include "Tests/Fakes/DisplayText.h"

#include <array>
#include <gtest/gtest.h>

namespace spectrel {
namespace {

constexpr std::array<std::uint8_t, 8> Raw {0x81, 0xFE, 0x7F, 0xC0, 0xFF, 0xFF, 0xFF, 0xFF};

std::uint32_t valueOf(std::uint16_t offset, Width width, std::size_t start = 0)
{
    return fieldValue(ByteView(Raw), {offset, width, "key", decimal}, start);
}

TEST(FieldsTest, WholeFieldsAreLittleEndianAndMayBeUnaligned)
{
    EXPECT_EQ(valueOf(0, Width::U8), 0x81u);
    EXPECT_EQ(valueOf(1, Width::U16), 0x7FFEu);
    EXPECT_EQ(valueOf(1, Width::U32), 0xFFC07FFEu);
    EXPECT_EQ(valueOf(0, Width::U16, 1), 0x7FFEu) << "offsets of an entry count from its start";
}

TEST(FieldsTest, SignedFieldsComeExtended)
{
    EXPECT_EQ(valueOf(0, Width::S8), static_cast<std::uint32_t>(-127));
    EXPECT_EQ(valueOf(2, Width::S8), 0x7Fu);
    EXPECT_EQ(valueOf(0, Width::S16), static_cast<std::uint32_t>(-383));
    EXPECT_EQ(valueOf(3, {6, 2, true}), static_cast<std::uint32_t>(-1));
}

TEST(FieldsTest, BitFieldsTakeLowBitsFromTheLowerByte)
{
    EXPECT_EQ(valueOf(0, bits(0, 1)), 1u);
    EXPECT_EQ(valueOf(0, bits(1, 6)), 0u);
    EXPECT_EQ(valueOf(0, bits(7, 1)), 1u);
    EXPECT_EQ(valueOf(0, bits(6, 4)), 0xAu) << "bits 6 and 7 of 0x81, then 0 and 1 of 0xFE";
    EXPECT_EQ(valueOf(0, bits(7, 17)), 0xFFFDu);
    EXPECT_EQ(valueOf(4, bits(0, 32)), 0xFFFFFFFFu);
}

TEST(FieldsTest, WalkingOneShowsInItsFieldOnly)
{
    for (unsigned bit = 0; bit < 32; ++bit) {
        std::array<std::uint8_t, 4> raw {};
        raw[bit / 8] = static_cast<std::uint8_t>(1 << bit % 8);
        const std::uint32_t value = fieldValue(ByteView(raw), {0, bits(5, 14), "key", decimal});
        EXPECT_EQ(value, bit >= 5 && bit < 19 ? 1u << (bit - 5) : 0u) << bit;
    }
}

TEST(FieldsTest, BytesPastTheEndReadAsZero)
{
    EXPECT_EQ(valueOf(7, Width::U32), 0xFFu);
    EXPECT_EQ(valueOf(8, bits(3, 5)), 0u);
}

TEST(FieldsTest, EntryHoldsTheFieldsInTableOrder)
{
    constexpr std::array<Field, 2> Entry {{{1, Width::U8, "B", decimal}, {0, Width::S8, "A", decimal}}};
    EXPECT_EQ(displayText(Value(entryWithFields(ByteView(Raw), Entry, 0))), "{\"B\": \"254\", \"A\": \"-127\"}");
    EXPECT_EQ(displayText(Value(entryWithFields(ByteView(Raw), Entry, 2))), "{\"B\": \"192\", \"A\": \"127\"}");
}

std::string formatted(Formatter format, std::uint32_t value)
{
    TextBuffer buffer;
    return std::string(format(value, buffer));
}

TEST(FieldsTest, NumbersAreSignedUnlessTheFormatSaysOtherwise)
{
    EXPECT_EQ(formatted(decimal, 0xFFFFFFFF), "-1");
    EXPECT_EQ(formatted(unsignedDecimal, 0xFFFFFFFF), "4294967295");
    EXPECT_EQ(formatted(decimalDB, static_cast<std::uint32_t>(-7)), "-7 dB");
    EXPECT_EQ(formatted(decimalDBm, static_cast<std::uint32_t>(-93)), "-93 dBm");
}

constexpr std::array<std::string_view, 2> Names {{"None", "Some"}};

TEST(FieldsTest, CodeIsNamedByItsPlaceInTheTable)
{
    EXPECT_EQ(formatted(named<Names>, 0), "None");
    EXPECT_EQ(formatted(named<Names>, 1), "Some");
    EXPECT_EQ(formatted(named<Names>, 2), "Unknown");
    EXPECT_EQ(formatted(named<Names>, 0xFFFFFFFF), "Unknown");
}

TEST(FieldsTest, FlagIsOneOfTwoTexts)
{
    EXPECT_EQ(formatted(flagged<Names>, 0), "None");
    EXPECT_EQ(formatted(flagged<Names>, 1), "Some");
    EXPECT_EQ(formatted(flagged<Names>, 255), "Some");
}

constexpr CodeTexts<3> Sparse {{{1, "One"}, {4, "Four"}, {255, "Last"}}, "Other"};

TEST(FieldsTest, CodeIsFoundInATableWithGaps)
{
    EXPECT_EQ(formatted(named<Sparse>, 1), "One");
    EXPECT_EQ(formatted(named<Sparse>, 4), "Four");
    EXPECT_EQ(formatted(named<Sparse>, 255), "Last");
    for (const std::uint32_t code : {0u, 2u, 3u, 5u, 254u, 256u, 0xFFFFFFFFu})
        EXPECT_EQ(formatted(named<Sparse>, code), "Other") << code;
}

} // namespace
} // namespace spectrel
