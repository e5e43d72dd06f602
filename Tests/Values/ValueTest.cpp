#include "Values/Dictionary.h"
#include "Values/List.h"

#include <gtest/gtest.h>
#include <limits>

namespace spectrel {

namespace {

DataRef data(Bytes bytes)
{
    return std::make_shared<const Bytes>(std::move(bytes));
}

} // namespace

TEST(ValueTest, DefaultMadeValueIsAbsent)
{
    EXPECT_TRUE(Value().isAbsent());
    EXPECT_EQ(Value().kind(), Kind::Absent);
    EXPECT_EQ(Value(), Value());
}

TEST(ValueTest, AbsentReferencesMakeAbsentValues)
{
    EXPECT_TRUE(Value(DictionaryRef()).isAbsent());
    EXPECT_TRUE(Value(ListRef()).isAbsent());
    EXPECT_TRUE(Value(DataRef()).isAbsent());
}

TEST(ValueTest, EachKindAnswersOnlyItsOwnQuestion)
{
    const Value values[] = {"text", Dictionary::make(), List::make(), Value::integer(1), Value::real(1),
        Value::boolean(true), Date {1}, data({1})};
    for (const Value& value : values) {
        const int answers = (value.string() != nullptr) + (value.dictionary() != nullptr) + (value.list() != nullptr)
            + value.integer().has_value() + value.real().has_value() + value.boolean().has_value()
            + value.date().has_value() + (value.data() != nullptr);
        EXPECT_EQ(answers, 1) << static_cast<int>(value.kind());
    }
    EXPECT_TRUE(values[0].string());
    EXPECT_TRUE(values[1].dictionary());
    EXPECT_TRUE(values[2].list());
    EXPECT_TRUE(values[3].integer());
    EXPECT_TRUE(values[4].real());
    EXPECT_TRUE(values[5].boolean());
    EXPECT_TRUE(values[6].date());
    EXPECT_TRUE(values[7].data());
}

TEST(ValueTest, IntegralNumbersInSigned32BitRangeReadAsNumbers)
{
    EXPECT_EQ(Value::integer(-2147483648).int32(), -2147483647 - 1);
    EXPECT_EQ(Value::integer(2147483647).int32(), 2147483647);
    EXPECT_EQ(Value::real(12.0).int32(), 12);
    EXPECT_EQ(Value::real(-2147483648.0).int32(), -2147483647 - 1);
    EXPECT_EQ(Value::real(-0.0).int32(), 0);
}

TEST(ValueTest, NothingElseReadsAsANumber)
{
    EXPECT_FALSE(Value::integer(2147483648).int32());
    EXPECT_FALSE(Value::integer(-2147483649).int32());
    EXPECT_FALSE(Value(Integer::fromUnsigned(std::numeric_limits<std::uint64_t>::max())).int32());
    EXPECT_FALSE(Value(Integer::fromUnsigned(0xFFFF'FFFF'8000'0000)).int32());
    EXPECT_FALSE(Value::real(12.5).int32());
    EXPECT_FALSE(Value::real(2147483648.0).int32());
    EXPECT_FALSE(Value::real(std::numeric_limits<double>::quiet_NaN()).int32());
    EXPECT_FALSE(Value::real(std::numeric_limits<double>::infinity()).int32());
    EXPECT_FALSE(Value("12").int32());
    EXPECT_FALSE(Value::boolean(true).int32());
    EXPECT_FALSE(Value().int32());
}

TEST(ValueTest, AssignedTextReplacesAnyKindAndKeepsItsMemory)
{
    Value value = Value::integer(5);
    value.assignText("a text long enough to live on the heap, for sure");
    const char* memory = value.string()->data();
    value.assignText("short");
    EXPECT_EQ(*value.string(), "short");
    EXPECT_EQ(value.string()->data(), memory);
}

TEST(ValueTest, EqualityIsDeepAndIgnoresTheOrderOfKeys)
{
    const Value left = Dictionary::make({{"a", "1"}, {"b", List::make({"x", Dictionary::make()})}});
    const Value right = Dictionary::make({{"b", List::make({"x", Dictionary::make()})}, {"a", "1"}});
    EXPECT_EQ(left, right);
    right.dictionary()->setText("a", "2");
    EXPECT_NE(left, right);
    EXPECT_EQ(Value(data({1, 2})), Value(data({1, 2})));
    EXPECT_NE(Value(List::make({"a", "b"})), Value(List::make({"b", "a"})));
}

TEST(ValueTest, IntegersOfOtherSignOrKindAreUnequal)
{
    EXPECT_NE(Value::integer(-1), Value(Integer::fromUnsigned(std::numeric_limits<std::uint64_t>::max())));
    EXPECT_NE(Value::integer(1), Value::real(1));
    EXPECT_NE(Value::integer(1), Value::boolean(true));
    EXPECT_EQ(Value::integer(7), Value(Integer::fromUnsigned(7)));
}

TEST(ValueTest, CopiesShareContainers)
{
    const Value first = Dictionary::make();
    const Value second = first;
    first.dictionary()->setText("k", "v");
    EXPECT_EQ(*(*second.dictionary())["k"].string(), "v");
}

} // namespace spectrel
