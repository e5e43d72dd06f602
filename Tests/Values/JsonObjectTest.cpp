#include "Values/JsonObject.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(JsonObjectTest, NumbersAndTextsAreRead)
{
    const auto object = JsonObject::parse(R"( {"a": 1, "b": -2.5e1, "c": "x\ny", "d": 1733000000.123456} )");
    ASSERT_TRUE(object);
    EXPECT_EQ(object->number("a"), 1.0);
    EXPECT_EQ(object->number("b"), -25.0);
    EXPECT_EQ(object->number("d"), 1733000000.123456);
    ASSERT_TRUE(object->text("c"));
    EXPECT_EQ(*object->text("c"), "x\ny");
}

TEST(JsonObjectTest, MemberOfAnotherKindIsNone)
{
    const auto object = JsonObject::parse(R"({"a": "1", "b": 1, "c": null, "d": true, "e": {"f": 2}, "g": [3]})");
    ASSERT_TRUE(object);
    EXPECT_FALSE(object->number("a"));
    EXPECT_FALSE(object->text("b"));
    for (const char* key : {"c", "d", "e", "f", "g", "h"}) {
        EXPECT_FALSE(object->number(key)) << key;
        EXPECT_FALSE(object->text(key)) << key;
    }
}

TEST(JsonObjectTest, OfAMemberThatStandsTwiceTheLastCounts)
{
    EXPECT_EQ(JsonObject::parse(R"({"a": 1, "a": 2})")->number("a"), 2.0);
}

TEST(JsonObjectTest, AnythingElseIsNone)
{
    for (const char* text : {"", "{", "1", "\"a\"", "null", "true", "[1]", "[{\"a\": 1}]", "{\"a\": 1} x",
             "{\"a\": 1}{}", "{\"a\"}", "{a: 1}", "{\"a\": 1,}", "{\"a\": 01}", "{\"a\": nan}", "{\"a\": 1e999}",
             "{\"a\": \"\xFF\"}", "{\"a\": \"\\ud800\"}"})
        EXPECT_FALSE(JsonObject::parse(text)) << text;
    EXPECT_FALSE(JsonObject::parse(std::string("{\"a\": 1}\0x", 10)));
}

TEST(JsonObjectTest, DepthIsBounded)
{
    const auto nested = [](std::size_t depth) {
        return "{\"a\": " + std::string(depth, '[') + std::string(depth, ']') + "}";
    };
    EXPECT_TRUE(JsonObject::parse(nested(16)));
    EXPECT_FALSE(JsonObject::parse(nested(17)));
    EXPECT_FALSE(JsonObject::parse(nested(1'000'000)));
}

} // namespace
} // namespace spectrel
