#include "Tests/Values/PropertyList/ValueText.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyList.h"

#include <cmath>
#include <gtest/gtest.h>
#include <limits>
#include <random>

namespace spectrel {

namespace {

Value data(std::size_t count)
{
    return std::make_shared<const Bytes>(count, std::uint8_t(0));
}

/// What stands between the plist tags; "none" when the value cannot be written.
std::string written(const Value& value)
{
    const auto text = serialisePropertyList(value);
    if (!text)
        return "none";
    const std::size_t start = text->find("<plist version=\"1.0\">\n") + 22;
    return text->substr(start, text->rfind("</plist>\n") - start);
}

std::optional<Value> readBack(const Value& value)
{
    const auto text = serialisePropertyList(value);
    if (!text)
        return std::nullopt;
    return parsePropertyList({reinterpret_cast<const std::uint8_t*>(text->data()), text->size()});
}

Value nested(std::size_t depth)
{
    Value value = List::make();
    for (std::size_t i = 1; i < depth; ++i)
        value = List::make({value});
    return value;
}

} // namespace

TEST(PropertyListWriterTest, WholeDocumentHasTheStandardHead)
{
    EXPECT_EQ(serialisePropertyList(Dictionary::make({{"b", "x"}, {"a", List::make({Value::integer(-1)})}})),
        "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
        "<!DOCTYPE plist PUBLIC \"-//Apple//DTD PLIST 1.0//EN\" \"http://www.apple.com/DTDs/PropertyList-1.0.dtd\">\n"
        "<plist version=\"1.0\">\n"
        "<dict>\n"
        "\t<key>b</key>\n"
        "\t<string>x</string>\n"
        "\t<key>a</key>\n"
        "\t<array>\n"
        "\t\t<integer>-1</integer>\n"
        "\t</array>\n"
        "</dict>\n"
        "</plist>\n");
}

TEST(PropertyListWriterTest, EmptyValuesHaveTheirForms)
{
    EXPECT_EQ(written(Dictionary::make()), "<dict/>\n");
    EXPECT_EQ(written(List::make()), "<array/>\n");
    EXPECT_EQ(written(""), "<string></string>\n");
    EXPECT_EQ(written(data(0)), "<data></data>\n");
}

TEST(PropertyListWriterTest, ScalarsHaveTheirForms)
{
    EXPECT_EQ(written(Value::boolean(true)), "<true/>\n");
    EXPECT_EQ(written(Value::boolean(false)), "<false/>\n");
    EXPECT_EQ(written(Value(Integer::fromUnsigned(~0ull))), "<integer>18446744073709551615</integer>\n");
    EXPECT_EQ(written(Value::real(0.1)), "<real>0.1</real>\n");
    EXPECT_EQ(written(Value::real(std::nan(""))), "<real>nan</real>\n");
    EXPECT_EQ(written(Value::real(-std::nan(""))), "<real>nan</real>\n");
    EXPECT_EQ(written(Date {731340451.75}), "<date>2024-03-05T14:07:31Z</date>\n");
    EXPECT_EQ(written(Date {-0.25}), "<date>2000-12-31T23:59:59Z</date>\n");
}

TEST(PropertyListWriterTest, DataIsBrokenIntoLines)
{
    EXPECT_EQ(written(List::make({data(58)})),
        "<array>\n\t<data>\n\t" + std::string(76, 'A') + "\n\tAA==\n\t</data>\n</array>\n");
}

TEST(PropertyListWriterTest, MarkupIsEscaped)
{
    EXPECT_EQ(written("<a>&\"'\r\n\t]]>"), "<string>&lt;a&gt;&amp;\"'&#13;\n\t]]&gt;</string>\n");
    EXPECT_EQ(
        written(Dictionary::make({{"<&>", ""}})), "<dict>\n\t<key>&lt;&amp;&gt;</key>\n\t<string></string>\n</dict>\n");
}

TEST(PropertyListWriterTest, RealsReadBackAsTheSameReals)
{
    std::mt19937_64 random(3);
    for (int i = 0; i < 2000; ++i) {
        const std::uint64_t bits = random();
        const Value value = Value::real(std::bit_cast<double>(bits));
        ASSERT_EQ(valueText(*readBack(value)), valueText(value));
    }
    for (const double number : {1.0, -0.0, 1e22, std::numeric_limits<double>::denorm_min(), HUGE_VAL, -HUGE_VAL})
        EXPECT_EQ(valueText(*readBack(Value::real(number))), valueText(Value::real(number)));
}

TEST(PropertyListWriterTest, TextsThatXMLCannotCarryGiveNone)
{
    for (const std::string_view text :
        {std::string_view("\0", 1), std::string_view("\x1F"), std::string_view("\x0B"), std::string_view("\x80"),
            std::string_view("\xC3"), std::string_view("\xC0\xAF"), std::string_view("\xE0\x80\x80"),
            std::string_view("\xED\xA0\x80"), std::string_view("\xEF\xBF\xBE"), std::string_view("\xEF\xBF\xBF"),
            std::string_view("\xF0\x80\x80\x80"), std::string_view("\xF4\x90\x80\x80"),
            std::string_view("\xF8\x88\x80\x80\x80"), std::string_view("\xE2\x82"), std::string_view("\xF0\x9F\x93")}) {
        EXPECT_EQ(written(text), "none");
        EXPECT_EQ(written(Dictionary::make({{std::string(text), "x"}})), "none");
    }
}

TEST(PropertyListWriterTest, EveryOtherCharacterReadsBack)
{
    const Value edges =
        "\t\n\r \x7F\xC2\x80\xDF\xBF\xE0\xA0\x80\xED\x9F\xBF\xEE\x80\x80\xEF\xBF\xBD\xF0\x90\x80\x80\xF4\x8F\xBF\xBF";
    EXPECT_EQ(*readBack(edges), edges);
}

TEST(PropertyListWriterTest, AbsentValueGivesNone)
{
    EXPECT_EQ(written(Value()), "none");
}

TEST(PropertyListWriterTest, DatesOutsideFourDigitYearsGiveNone)
{
    EXPECT_EQ(written(Date {252423993599}), "<date>9999-12-31T23:59:59Z</date>\n");
    EXPECT_EQ(written(Date {252423993600}), "none");
    EXPECT_EQ(written(Date {-63145526400}), "<date>0000-01-01T00:00:00Z</date>\n");
    EXPECT_EQ(written(Date {-63145526401}), "none");
    EXPECT_EQ(written(Date {std::nan("")}), "none");
}

TEST(PropertyListWriterTest, DepthIsBounded)
{
    EXPECT_TRUE(readBack(nested(128)));
    EXPECT_EQ(written(nested(129)), "none");
    EXPECT_EQ(written(Dictionary::make({{"k", nested(128)}})), "none");
}

TEST(PropertyListWriterTest, ContainerThatHoldsItselfGivesNone)
{
    const ListRef list = List::make();
    list->append(list);
    EXPECT_EQ(written(list), "none");
    list->removeAll();
}

TEST(PropertyListWriterTest, SharedContainersThatMultiplyGiveNone)
{
    Value value = "x";
    for (int i = 0; i < 60; ++i)
        value = List::make({value, value});
    EXPECT_EQ(written(value), "none");
}

TEST(PropertyListWriterTest, SharedTextsThatMultiplyGiveNone)
{
    const Value text = std::string(16 * 1024 * 1024, 'x');
    const ListRef all = List::make();
    for (int i = 0; i < 16; ++i)
        all->append(text); // 256 MiB and the tags
    EXPECT_EQ(written(all), "none");
}

} // namespace spectrel
