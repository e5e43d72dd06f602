#include "Sections/GSMUMTS/Mobility/MobilityManagement.h"

#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

class ProcessCOTest : public SectionFixture<ProcessCO> {
protected:
    ProcessCOTest()
        : SectionFixture(Dictionary::make())
    {
    }
};

constexpr const char* Trace = "<4>ProcessCS\n"; // the sibling's name

TEST_F(ProcessCOTest, SubscribesToMobilityManagementAndRegistration)
{
    EXPECT_EQ(section.getSectionName(), "Process CO");
    EXPECT_EQ(section.getLogCodeArray(), (std::vector<std::uint32_t> {0x7131, 0x7132}));
}

TEST_F(ProcessCOTest, EveryMMStateHasItsName)
{
    EXPECT_EQ(shownForEachByte(0x7131, RecordBuilder(0x7131, 16), 13, "MM State"),
        textsForEachByte(
            {"MM_NULL", "Unknown", "Unknown", "MM_LOCATION_UPDATE_INITIATED", "Unknown",
                "MM_WAIT_FOR_OUTGOING_MM_CONNECTION", "MM_CONNECTION_ACTIVE", "MM_IMSI_DETACH_INITIATED",
                "MM_PROCESS_CM_SERVICE_PROMPT", "MM_WAIT_FOR_NETWORK_COMMAND", "MM_LOCATION_UPDATE_REJECTED", "Unknown",
                "Unknown", "MM_WAIT_FOR_RR_CONNECTION_LU", "MM_WAIT_FOR_RR_CONNECTION_MM",
                "MM_WAIT_FOR_RR_CONNECTION_IMSI_DETACH", "Unknown", "MM_REESTABLISHMENT_INITIATED",
                "MM_WAIT_FOR_RR_ACTIVE", "MM_IDLE", "MM_WAIT_FOR_ADDITIONAL_OUTGOING_MM_ CONNECTION",
                "MM_WAIT_FOR_RR_CONNECTION_ REESTABLISHMENT", "MM_WAIT_FOR_REESTABLISH_DECISION",
                "MM_LOCATION_UPDATING_PENDING", "Unknown", "MM_RR_CONNECTION_RELEASE_NOT_ALLOWED"},
            "Unknown"));
}

TEST_F(ProcessCOTest, IdleIsNamedAndTheGapsAndTheEndAreUnknown)
{
    deliver(0x7131, RecordBuilder(0x7131, 16).u8(13, 19));
    EXPECT_EQ(shown("MM State"), "\"MM_IDLE\"");
    deliver(0x7131, RecordBuilder(0x7131, 16).u8(13, 24));
    EXPECT_EQ(shown("MM State"), "\"Unknown\"");
    deliver(0x7131, RecordBuilder(0x7131, 16).u8(13, 26));
    EXPECT_EQ(shown("MM State"), "\"Unknown\"");
    EXPECT_EQ(log(), std::string(Trace) + Trace + Trace);
}

TEST_F(ProcessCOTest, OfTheMobilityManagementRecordOnlyTheStateIsShown)
{
    deliver(0x7131, RecordBuilder(0x7131, 16).u8(13, 0).u8(14, 8).u8(15, 3));
    EXPECT_EQ(display(), "{\"MM State\": \"MM_NULL\"}");
}

TEST_F(ProcessCOTest, EveryRegistrationStateHasItsName)
{
    EXPECT_EQ(shownForEachByte(0x7132, RecordBuilder(0x7132, 16), 13, "MM Service State"),
        textsForEachByte({"REG_STATE_INACTIVE", "REG_STATE_IDLE", "REG_STATE_REGISTERING", "REG_STATE_DEREGISTERING",
                             "REG_STATE_MANUAL_SEARCH", "REG_STATE_AUTOMATIC_SEARCH", "REG_STATE_OFFLINE"},
            "Unknown"));
    EXPECT_EQ(display(), "{\"MM Service State\": \"Unknown\"}");
}

TEST_F(ProcessCOTest, RecordsOneByteTooShortChangeNothing)
{
    deliver(0x7131, RecordBuilder(0x7131, 15).u8(13, 19));
    deliver(0x7132, RecordBuilder(0x7132, 15).u8(13, 1));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(Trace) + Trace);
}

TEST_F(ProcessCOTest, OtherCodeIsLoggedAsUnknown)
{
    deliver(0x7130, RecordBuilder(0x7130, 16));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: 28976\n");
}

} // namespace
} // namespace spectrel
