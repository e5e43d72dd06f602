#include "Tests/Values/PropertyList/ValueText.h"
#include "Values/Dictionary.h"
#include "Values/PropertyList/PropertyList.h"

#include <gtest/gtest.h>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

namespace {

using namespace std::string_literals;

constexpr const char* Refused = "does not parse";

std::string bigEndian(std::uint64_t number, std::size_t width)
{
    std::string bytes;
    for (std::size_t i = width; i > 0; --i)
        bytes += i > 8 ? char(0) : static_cast<char>(number >> (8 * (i - 1)));
    return bytes;
}

std::string parsed(std::string_view bytes)
{
    const auto value = parsePropertyList({reinterpret_cast<const std::uint8_t*>(bytes.data()), bytes.size()});
    return value ? valueText(*value) : Refused;
}

/// A binary list in the making; what the trailer says can be falsified.
struct BinaryList {
    std::vector<std::string> objects;
    std::size_t offsetWidth = 2;
    std::size_t referenceWidth = 1;
    std::uint64_t top = 0;
    std::int64_t moreObjects = 0;
    std::int64_t tableShift = 0;

    std::string bytes() const
    {
        std::string bytes = "bplist00";
        std::string table;
        for (const std::string& object : objects) {
            table += bigEndian(bytes.size(), offsetWidth);
            bytes += object;
        }
        const std::uint64_t place = bytes.size() + static_cast<std::uint64_t>(tableShift);
        bytes += table + std::string(6, '\0') + bigEndian(offsetWidth, 1) + bigEndian(referenceWidth, 1);
        return bytes + bigEndian(objects.size() + static_cast<std::uint64_t>(moreObjects), 8) + bigEndian(top, 8)
            + bigEndian(place, 8);
    }
    std::string parsed() const
    {
        return spectrel::parsed(bytes());
    }
};

std::string single(const std::string& object)
{
    return BinaryList {{object}}.parsed();
}

/// A reference of two bytes.
std::string to(std::uint64_t object)
{
    return bigEndian(object, 2);
}

} // namespace

TEST(BinaryPropertyListTest, EveryKindIsRead)
{
    EXPECT_EQ(single("\x08"), "F");
    EXPECT_EQ(single("\x09"), "T");
    EXPECT_EQ(single("\x22\x3F\x80\0\0"s), "r3ff0000000000000");
    EXPECT_EQ(single("\x23\x3F\xF0\0\0\0\0\0\0"s), "r3ff0000000000000");
    EXPECT_EQ(single("\x33\x3F\xF0\0\0\0\0\0\0"s), "t1");
    EXPECT_EQ(single("\x42\x01\xFE"), "d01fe");
    EXPECT_EQ(single("\x40"), "d");
    EXPECT_EQ(single("\x52hi"), "s6869");
    EXPECT_EQ(single("\x61\0\xE4"s), "sc3a4");
    EXPECT_EQ(single("\x62\xD8\x3D\xDC\xF6"), "sf09f93b6");
    EXPECT_EQ((BinaryList {{"\xA2\x01\x01", "\x09"}}.parsed()), "[T,T]");
    EXPECT_EQ((BinaryList {{"\xD1\x01\x02", "\x51k", "\x08"}}.parsed()), "{6b:F}");
}

TEST(BinaryPropertyListTest, IntegersOfEveryWidthAreRead)
{
    EXPECT_EQ(single("\x10\xFF"), "i255");
    EXPECT_EQ(single("\x11\xFF\xFF"), "i65535");
    EXPECT_EQ(single("\x12\xFF\xFF\xFF\xFF"), "i4294967295");
    EXPECT_EQ(single("\x13\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFE"), "i-2");
    EXPECT_EQ(single("\x14" + bigEndian(0, 8) + bigEndian(~0ull, 8)), "i18446744073709551615");
    EXPECT_EQ(single("\x14" + bigEndian(~0ull, 8) + bigEndian(1ull << 63, 8)), "i-9223372036854775808");
}

TEST(BinaryPropertyListTest, WideIntegersThatDoNotFitDoNotParse)
{
    EXPECT_EQ(single("\x14" + bigEndian(1, 8) + bigEndian(0, 8)), Refused);
    EXPECT_EQ(single("\x14" + bigEndian(~0ull, 8) + bigEndian((1ull << 63) - 1, 8)), Refused);
    EXPECT_EQ(single("\x15" + std::string(32, '\0')), Refused);
}

TEST(BinaryPropertyListTest, CountsMayStandInAWholeNumber)
{
    const std::string text(300, 'x');
    EXPECT_EQ(
        single("\x5F\x11\x01\x2C" + text), "s" + [] {
            std::string digits;
            for (int i = 0; i < 300; ++i)
                digits += "78";
            return digits;
        }());
    EXPECT_EQ(single("\x5F\x10\x02hi"), "s6869");
    EXPECT_EQ(single("\x5F\x13\0\0\0\0\0\0\0\x02hi"s), "s6869");
    EXPECT_EQ(single("\x5F\x22\0\0\0\x02hi"s), Refused); // a real
    EXPECT_EQ(single("\x5F\x14" + bigEndian(0, 8) + bigEndian(2, 8) + "hi"), Refused);
    EXPECT_EQ(single("\x5F\x10"), Refused);
    EXPECT_EQ(single("\x5F"), Refused);
}

TEST(BinaryPropertyListTest, OverlongCountsDoNotParse)
{
    EXPECT_EQ(single("\x53hi"), Refused);
    EXPECT_EQ(single("\x43\x01\x02"), Refused);
    EXPECT_EQ(single("\x62\0\x41\0"s), Refused);
    EXPECT_EQ(single("\x4F\x13" + bigEndian(~0ull, 8)), Refused);
    EXPECT_EQ(single("\x6F\x13" + bigEndian(1ull << 63, 8)), Refused);
    EXPECT_EQ((BinaryList {{"\xA9\x01", "\x09"}}.parsed()), Refused);
    EXPECT_EQ((BinaryList {{"\xAF\x13" + bigEndian(1ull << 62, 8), "\x09"}}.parsed()), Refused);
    EXPECT_EQ((BinaryList {{"\xDF\x13" + bigEndian(1ull << 62, 8), "\x09"}}.parsed()), Refused);
}

TEST(BinaryPropertyListTest, KindsThatNoListHoldsDoNotParse)
{
    for (const char* object : {"\x0F", "\x01", "\x0C", "\x21\x01\x01", "\x24", "\x30", "\x32\x01\x01\x01\x01", "\x71x",
             "\x80\x01", "\xB0", "\xC0", "\xE0", "\xF0", "\x90"})
        EXPECT_EQ(single(object), Refused) << object;
    EXPECT_EQ(single("\0"s), Refused); // null
}

TEST(BinaryPropertyListTest, MalformedTextsDoNotParse)
{
    EXPECT_EQ(single("\x51\x80"), Refused);
    EXPECT_EQ(single("\x61\xD8\x3D"), Refused);
    EXPECT_EQ(single("\x61\xDC\x3D"), Refused);
    EXPECT_EQ(single("\x62\xD8\x3D\0\x41"s), Refused);
}

TEST(BinaryPropertyListTest, DatesThatAreNoMomentDoNotParse)
{
    EXPECT_EQ(single("\x33\x7F\xF8\0\0\0\0\0\0"s), Refused);
    EXPECT_EQ(single("\x33\x7F\xF0\0\0\0\0\0\0"s), Refused);
}

TEST(BinaryPropertyListTest, KeysMustBeTexts)
{
    EXPECT_EQ((BinaryList {{"\xD1\x01\x02", "\x10\x01", "\x08"}}.parsed()), Refused);
    EXPECT_EQ((BinaryList {{"\xD1\x07\x01", "\x08"}}.parsed()), Refused);
}

TEST(BinaryPropertyListTest, KeyGivenTwiceKeepsItsPlaceAndTheLastValue)
{
    EXPECT_EQ(
        (BinaryList {{"\xD3\x01\x02\x01\x03\x03\x04", "\x51k", "\x51m", "\x08", "\x09"}}.parsed()), "{6b:T,6d:F}");
}

TEST(BinaryPropertyListTest, ReferencesOutOfRangeDoNotParse)
{
    EXPECT_EQ((BinaryList {{"\xA1\x02", "\x09"}}.parsed()), Refused);
    EXPECT_EQ((BinaryList {.objects = {"\x09"}, .top = 1}.parsed()), Refused);
}

TEST(BinaryPropertyListTest, OffsetsOutOfRangeDoNotParse)
{
    for (const std::uint64_t offset : {0, 7, 9, 10, 0xFFFF}) {
        std::string bytes = BinaryList {{"\x09"}}.bytes();
        bytes.replace(9, 2, bigEndian(offset, 2));
        EXPECT_EQ(parsed(bytes), Refused) << offset;
    }
}

TEST(BinaryPropertyListTest, WrongTrailersDoNotParse)
{
    EXPECT_EQ((BinaryList {.objects = {"\x09"}, .moreObjects = 1}.parsed()), Refused);
    EXPECT_EQ((BinaryList {.objects = {"\x09"}, .moreObjects = -1}.parsed()), Refused);
    EXPECT_EQ((BinaryList {.objects = {"\x09"}, .tableShift = 1}.parsed()), Refused);
    EXPECT_EQ((BinaryList {.objects = {"\x09"}, .tableShift = -1}.parsed()), Refused);
    EXPECT_EQ((BinaryList {.objects = {"\x09"}, .tableShift = 1000}.parsed()), Refused);
    EXPECT_EQ((BinaryList {.objects = {"\x09"}, .offsetWidth = 9}.parsed()), Refused);
    EXPECT_EQ((BinaryList {.objects = {"\x09"}, .referenceWidth = 0}.parsed()), Refused);
    EXPECT_EQ((BinaryList {.objects = {"\x09"}, .referenceWidth = 9}.parsed()), Refused);
    EXPECT_EQ(BinaryList {}.parsed(), Refused);
    EXPECT_EQ(parsed("bplist00"), Refused);
    EXPECT_EQ(parsed("bplist00" + std::string(32, '\0')), Refused);
    EXPECT_EQ(parsed("bplist00" + std::string(32, '\xFF')), Refused);
    EXPECT_EQ(parsed("bplist01" + BinaryList {{"\x09"}}.bytes().substr(8)), Refused);
}

TEST(BinaryPropertyListTest, TruncationAndTrailingGarbageDoNotParse)
{
    const std::string whole = BinaryList {{"\xD1\x01\x02", "\x51k", "\x5F\x10\x10sixteen letters!"}}.bytes();
    ASSERT_NE(parsed(whole), Refused);
    for (std::size_t length = 0; length < whole.size(); ++length)
        EXPECT_EQ(parsed(whole.substr(0, length)), Refused) << length;
    EXPECT_EQ(parsed(whole + "x"), Refused);
    EXPECT_EQ(parsed(whole + std::string(32, '\0')), Refused);
}

TEST(BinaryPropertyListTest, CyclesDoNotParse)
{
    EXPECT_EQ((BinaryList {{"\xA1"s + '\0'}}.parsed()), Refused);
    EXPECT_EQ((BinaryList {{"\xA2"s + '\0' + '\0'}}.parsed()), Refused);
    EXPECT_EQ((BinaryList {{"\xD1\x01"s + '\0', "\x51k"}}.parsed()), Refused);
}

TEST(BinaryPropertyListTest, SharedContainersThatMultiplyDoNotParse)
{
    BinaryList list {.objects = {}, .referenceWidth = 2};
    for (std::uint64_t i = 0; i < 40; ++i)
        list.objects.push_back("\xA2" + to(i + 1) + to(i + 1));
    list.objects.push_back("\x09");
    EXPECT_EQ(list.parsed(), Refused);
}

TEST(BinaryPropertyListTest, SharedTextsAreCountedEachTime)
{
    const auto times = [](std::size_t count) {
        const std::string megabyte = "\x5F\x12" + bigEndian(1024 * 1024, 4) + std::string(1024 * 1024, 'x');
        std::string references = "\xAF\x11" + bigEndian(count, 2);
        for (std::size_t i = 0; i < count; ++i)
            references += to(1);
        const BinaryList list {.objects = {references, megabyte}, .offsetWidth = 4, .referenceWidth = 2};
        const std::string bytes = list.bytes();
        return parsePropertyList({reinterpret_cast<const std::uint8_t*>(bytes.data()), bytes.size()}).has_value();
    };
    EXPECT_TRUE(times(64));
    EXPECT_FALSE(times(65));
}

TEST(BinaryPropertyListTest, DepthIsBounded)
{
    const auto nested = [](std::uint64_t depth) {
        BinaryList list {.objects = {}, .referenceWidth = 2};
        for (std::uint64_t i = 1; i < depth; ++i)
            list.objects.push_back("\xA1" + to(i));
        list.objects.push_back("\xA0");
        return list.parsed();
    };
    EXPECT_EQ(nested(128), std::string(128, '[') + std::string(128, ']'));
    EXPECT_EQ(nested(129), Refused);
}

TEST(BinaryPropertyListTest, WideReferencesAndOffsetsAreRead)
{
    EXPECT_EQ(
        (BinaryList {.objects = {"\xA1" + bigEndian(1, 8), "\x09"}, .offsetWidth = 8, .referenceWidth = 8}.parsed()),
        "[T]");
    EXPECT_EQ(
        (BinaryList {.objects = {"\xA1" + bigEndian(1, 3), "\x09"}, .offsetWidth = 1, .referenceWidth = 3}.parsed()),
        "[T]");
}

} // namespace spectrel
