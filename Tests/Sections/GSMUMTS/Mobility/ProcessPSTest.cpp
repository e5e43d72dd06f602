#include "Sections/GSMUMTS/Mobility/MobilityManagement.h"

#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

class ProcessPSTest : public SectionFixture<ProcessPS> {
protected:
    ProcessPSTest()
        : SectionFixture(Dictionary::make())
    {
    }
};

constexpr const char* Trace = "<4>ProcessPS\n";

TEST_F(ProcessPSTest, SubscribesToMobilityManagementAndRegistration)
{
    EXPECT_EQ(section.getSectionName(), "Process PS");
    EXPECT_EQ(section.getLogCodeArray(), (std::vector<std::uint32_t> {0x7130, 0x7132}));
}

TEST_F(ProcessPSTest, StateSubStateAndUpdateStatusAreShownInOrder)
{
    deliver(0x7130, RecordBuilder(0x7130, 16).u8(13, 3).u8(14, 0).u8(15, 0));
    EXPECT_EQ(display(),
        "{\"MM State\": \"GMM_REGISTERED\", \"MM Sub State\": \"GMM_NORMAL_SERVICE\", "
        "\"Attach Reject Cause\": \"GMM_GU1_UPDATED\"}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(ProcessPSTest, MisspelledSubStateAndUnknownUpdateStatusAreShownAsTheyAre)
{
    deliver(0x7130, RecordBuilder(0x7130, 16).u8(14, 9).u8(15, 4));
    EXPECT_EQ(shown("MM Sub State"), "\"GMM_ATTEMPING_TO_UPDATE\"");
    EXPECT_EQ(shown("Attach Reject Cause"), "\"Unknown\"");
}

TEST_F(ProcessPSTest, EveryGMMStateHasItsName)
{
    EXPECT_EQ(shownForEachByte(0x7130, RecordBuilder(0x7130, 16), 13, "MM State"),
        textsForEachByte(
            {"GMM_NULL", "GMM_DEREGISTERED", "GMM_REGISTERED_INITIATED", "GMM_REGISTERED", "GMM_DEREGISTERED_INITIATED",
                "GMM_ROUTING_AREA_UPDATE_INITIATED", "GMM_SERVICE_REQUEST_INITIATED"},
            "Unknown"));
}

TEST_F(ProcessPSTest, EveryGMMSubStateHasItsName)
{
    EXPECT_EQ(shownForEachByte(0x7130, RecordBuilder(0x7130, 16), 14, "MM Sub State"),
        textsForEachByte({"GMM_NORMAL_SERVICE", "GMM_LIMITED_SERVICE", "GMM_ATTACH_NEEDED", "GMM_ATTEMPTING_TO_ATTACH",
                             "GMM_NO_IMSI", "GMM_NO_CELL_AVAILABLE", "GMM_PLMN_SEARCH", "GMM_SUSPENDED",
                             "GMM_UPDATE_NEEDED", "GMM_ATTEMPING_TO_UPDATE", "GMM_ATTEMPTING_TO_UPDATE_MM",
                             "GMM_IMSI_DETACH_INITIATED", "GMM_NULL_SUBSTATE"},
            "Unknown"));
}

TEST_F(ProcessPSTest, EveryUpdateStatusHasItsName)
{
    EXPECT_EQ(shownForEachByte(0x7130, RecordBuilder(0x7130, 16), 15, "Attach Reject Cause"),
        textsForEachByte(
            {"GMM_GU1_UPDATED", "GMM_GU2_NOT_UPDATED", "GMM_GU3_PLMN_NOT_ALLOWED", "GMM_GU3_ROUTING_AREA_NOT_ALLOWED"},
            "Unknown"));
}

TEST_F(ProcessPSTest, RegistrationRecordOf15BytesChangesNothingAndOneOf16IsShown)
{
    deliver(0x7132, RecordBuilder(0x7132, 15).u8(13, 7));
    EXPECT_EQ(display(), "{}");
    deliver(0x7132, RecordBuilder(0x7132, 16).u8(13, 7));
    EXPECT_EQ(display(), "{\"MM Service State\": \"Unknown\"}");
    deliver(0x7132, RecordBuilder(0x7132, 16).u8(13, 6));
    EXPECT_EQ(display(), "{\"MM Service State\": \"REG_STATE_OFFLINE\"}");
}

TEST_F(ProcessPSTest, MobilityManagementRecordOf15BytesChangesNothing)
{
    deliver(0x7130, RecordBuilder(0x7130, 15).u8(13, 3));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(ProcessPSTest, OtherCodeIsLoggedAsUnknown)
{
    deliver(0x7131, RecordBuilder(0x7131, 16));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: 28977\n");
}

} // namespace
} // namespace spectrel
