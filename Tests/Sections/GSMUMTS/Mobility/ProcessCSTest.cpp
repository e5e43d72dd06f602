#include "Sections/GSMUMTS/Mobility/MobilityManagement.h"

#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

class ProcessCSTest : public SectionFixture<ProcessCS> {
protected:
    ProcessCSTest()
        : SectionFixture(Dictionary::make())
    {
    }
};

constexpr const char* Trace = "<4>ProcessCS\n";

TEST_F(ProcessCSTest, SubscribesToMobilityManagementAndRegistration)
{
    EXPECT_EQ(section.getSectionName(), "Process CS");
    EXPECT_EQ(section.getLogCodeArray(), (std::vector<std::uint32_t> {0x7131, 0x7132}));
}

TEST_F(ProcessCSTest, IdleIsNamedAndTheGapsAndTheEndAreUnknown)
{
    const std::vector<std::string> states =
        shownForEachByte(0x7131, RecordBuilder(0x7131, 16).u8(14, 1).u8(15, 1), 13, "MM State");
    EXPECT_EQ(states[0], "MM_NULL");
    EXPECT_EQ(states[19], "MM_IDLE");
    EXPECT_EQ(states[20], "MM_WAIT_FOR_ADDITIONAL_OUTGOING_MM_ CONNECTION");
    EXPECT_EQ(states[21], "MM_WAIT_FOR_RR_CONNECTION_ REESTABLISHMENT");
    EXPECT_EQ(states[25], "MM_RR_CONNECTION_RELEASE_NOT_ALLOWED");
    for (const std::size_t nameless : {1u, 2u, 4u, 11u, 12u, 16u, 24u, 26u, 255u})
        EXPECT_EQ(states[nameless], "Unknown") << nameless;
}

TEST_F(ProcessCSTest, StateSubStateAndUpdateStatusAreShownInOrder)
{
    deliver(0x7131, RecordBuilder(0x7131, 16).u8(13, 0).u8(14, 8).u8(15, 3));
    EXPECT_EQ(display(),
        "{\"MM State\": \"MM_NULL\", \"MM Sub State\": \"MM_NORMAL_SERVICE\", "
        "\"LU Reject Cause\": \"LOCATION_AREA_NOT_ALLOWED\"}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(ProcessCSTest, EveryMMSubStateHasItsName)
{
    EXPECT_EQ(shownForEachByte(0x7131, RecordBuilder(0x7131, 16), 14, "MM Sub State"),
        textsForEachByte({"MM_NULL_SUBSTATE", "MM_NO_IMSI", "MM_PLMN_SEARCH", "MM_LIMITED_SERVICE",
                             "MM_ATTEMPTING_TO_UPDATE", "MM_LOCATION_UPDATE_NEEDED", "MM_NO_CELL_AVAILABLE",
                             "MM_PLMN_SEARCH_NORMAL_SERVICE", "MM_NORMAL_SERVICE"},
            "Unknown"));
}

TEST_F(ProcessCSTest, EveryLocationUpdateStatusHasItsName)
{
    EXPECT_EQ(shownForEachByte(0x7131, RecordBuilder(0x7131, 16), 15, "LU Reject Cause"),
        textsForEachByte({"UPDATED", "NOT_UPDATED", "ROAMING_NOT_ALLOWED", "LOCATION_AREA_NOT_ALLOWED"}, "Unknown"));
}

TEST_F(ProcessCSTest, RegistrationStateLeavesTheOtherKeys)
{
    deliver(0x7131, RecordBuilder(0x7131, 16).u8(13, 19).u8(14, 8).u8(15, 0));
    deliver(0x7132, RecordBuilder(0x7132, 16).u8(13, 1));
    EXPECT_EQ(display(),
        "{\"MM State\": \"MM_IDLE\", \"MM Sub State\": \"MM_NORMAL_SERVICE\", \"LU Reject Cause\": \"UPDATED\", "
        "\"MM Service State\": \"REG_STATE_IDLE\"}");
}

TEST_F(ProcessCSTest, RegistrationRecordOf15BytesChangesNothingAndOneOf16IsShown)
{
    deliver(0x7132, RecordBuilder(0x7132, 15).u8(13, 7));
    EXPECT_EQ(display(), "{}");
    deliver(0x7132, RecordBuilder(0x7132, 16).u8(13, 7));
    EXPECT_EQ(display(), "{\"MM Service State\": \"Unknown\"}");
}

TEST_F(ProcessCSTest, MobilityManagementRecordOf15BytesChangesNothing)
{
    deliver(0x7131, RecordBuilder(0x7131, 15).u8(13, 19));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(ProcessCSTest, PacketSwitchedRecordIsLoggedAsUnknown)
{
    deliver(0x7130, RecordBuilder(0x7130, 16));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: 28976\n");
}

} // namespace
} // namespace spectrel
