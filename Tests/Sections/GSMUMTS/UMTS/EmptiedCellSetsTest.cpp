// The three cell sets that a cell-set record only empties.

#include "Sections/GSMUMTS/UMTS/UMTSCellSets.h"
#include "Tests/Sections/GSMUMTS/UMTS/UMTSCellSetsRecord.h"
#include "Tests/Sections/SectionFixture.h"

#include <type_traits>

namespace spectrel {
namespace {

template <typename Section> class EmptiedCellSetsTest : public SectionFixture<Section> {
protected:
    EmptiedCellSetsTest()
        : SectionFixture<Section>(List::make({"old"}))
    {
    }

    struct Expected {
        const char* name;
        const char* trace;
    };
    static Expected expected()
    {
        if constexpr (std::is_same_v<Section, DetectedSet>)
            return {"Detected Set", "<4>DetectedSet\n"};
        else if constexpr (std::is_same_v<Section, MonitoredSet>)
            return {"Monitored Set", "<4>MonitoredSet\n"};
        else
            return {"Virtual Active Set", "<4>VirtualActiveSet\n"};
    }
};

using Sections = testing::Types<DetectedSet, MonitoredSet, VirtualActiveSet>;
TYPED_TEST_SUITE(EmptiedCellSetsTest, Sections);

TYPED_TEST(EmptiedCellSetsTest, SubscribesToItsCode)
{
    EXPECT_EQ(this->section.getSectionName(), this->expected().name);
    EXPECT_EQ(this->section.getLogCodeArray(), (std::vector<std::uint32_t> {0x417A}));
}

TYPED_TEST(EmptiedCellSetsTest, RecordWithCellsOfEverySetTypeEmptiesTheList)
{
    std::vector<CellOfSet> cells;
    for (std::uint32_t type = 0; type < 8; ++type)
        cells.push_back({type, type, {1, 1, 1}});
    this->deliver(0x417A, umtsCellSets(-500, cells));
    EXPECT_EQ(this->display(), "[]");
    EXPECT_EQ(this->log(), this->expected().trace);
}

TYPED_TEST(EmptiedCellSetsTest, RecordWithoutCellsEmptiesTheList)
{
    this->deliver(0x417A, RecordBuilder(0x417A, 16));
    EXPECT_EQ(this->display(), "[]");
}

TYPED_TEST(EmptiedCellSetsTest, CountLargerThanTheRecordEmptiesTheList)
{
    this->deliver(0x417A, RecordBuilder(0x417A, 16).u8(15, 255));
    EXPECT_EQ(this->display(), "[]");
}

TYPED_TEST(EmptiedCellSetsTest, RecordOneByteTooShortLeavesTheList)
{
    this->deliver(0x417A, RecordBuilder(0x417A, 15));
    EXPECT_EQ(this->display(), "[\"old\"]");
    EXPECT_EQ(this->log(), this->expected().trace);
}

TYPED_TEST(EmptiedCellSetsTest, OtherCodeIsLoggedAsUnknownAndLeavesTheList)
{
    this->deliver(0x4005, RecordBuilder(0x4005, 80));
    EXPECT_EQ(this->display(), "[\"old\"]");
    EXPECT_EQ(this->log(), std::string(this->expected().trace) + "<3>Received an unknown log message: 16389\n");
}

} // namespace
} // namespace spectrel
