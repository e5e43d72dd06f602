#include "Sections/GSMUMTS/Mobility/EquivalentPLMNList.h"

#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

class EquivalentPLMNListTest : public SectionFixture<EquivalentPLMNList> {
protected:
    EquivalentPLMNListTest()
        : SectionFixture(List::make({"old"}))
    {
    }
};

constexpr const char* Trace = "<4>Equivalent PLMN List\n";

TEST_F(EquivalentPLMNListTest, SubscribesToItsCode)
{
    EXPECT_EQ(section.getSectionName(), "Equivalent PLMN List");
    EXPECT_EQ(section.getLogCodeArray(), (std::vector<std::uint32_t> {0x7150}));
}

TEST_F(EquivalentPLMNListTest, EntriesShareThreeOfTheirBytes)
{
    RecordBuilder record(0x7150, 26);
    record.u8(16, 2);
    const std::uint32_t digits[] = {3, 1, 0, 2, 6, 0, 0, 0};
    for (std::size_t i = 0; i < std::size(digits); ++i)
        record.u8(17 + i, digits[i]);
    deliver(0x7150, record);
    EXPECT_EQ(display(), // the second from the bytes 2, 6, 0, 0, 0, 0
        "[{\"Mobile Country Code\": \"306\", \"Mobile Network Code\": \"120\"}, "
        "{\"Mobile Country Code\": \"200\", \"Mobile Network Code\": \"600\"}]");
    EXPECT_EQ(log(), Trace);
}

TEST_F(EquivalentPLMNListTest, BytesThatAreNoDigitsCountAllTheSame)
{
    deliver(0x7150,
        RecordBuilder(0x7150, 23).u8(16, 1).u8(17, 255).u8(18, 10).u8(19, 255).u8(20, 0).u8(21, 255).u8(22, 11));
    EXPECT_EQ(display(), "[{\"Mobile Country Code\": \"28305\", \"Mobile Network Code\": \"1011\"}]");
}

TEST_F(EquivalentPLMNListTest, NoEntriesEmptyTheList)
{
    deliver(0x7150, RecordBuilder(0x7150, 17));
    EXPECT_EQ(display(), "[]");
}

TEST_F(EquivalentPLMNListTest, RecordOneByteTooShortLeavesTheList)
{
    deliver(0x7150, RecordBuilder(0x7150, 16));
    EXPECT_EQ(display(), "[\"old\"]");
    EXPECT_EQ(log(), Trace);
}

TEST_F(EquivalentPLMNListTest, EntriesPastTheEndOfTheRecordReadAsZeros)
{
    deliver(0x7150, RecordBuilder(0x7150, 18).u8(16, 3).u8(17, 2));
    EXPECT_EQ(display(),
        "[{\"Mobile Country Code\": \"200\", \"Mobile Network Code\": \"0\"}, "
        "{\"Mobile Country Code\": \"0\", \"Mobile Network Code\": \"0\"}, "
        "{\"Mobile Country Code\": \"0\", \"Mobile Network Code\": \"0\"}]");
}

TEST_F(EquivalentPLMNListTest, OtherCodeIsLoggedAsUnknownAndLeavesTheList)
{
    deliver(0x7151, RecordBuilder(0x7151, 40));
    EXPECT_EQ(display(), "[\"old\"]");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: 29009\n");
}

} // namespace
} // namespace spectrel
