#include "Sections/GSMUMTS/GSM/GSMRRInfo.h"

#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

class GSMRRInfoTest : public SectionFixture<GSMRRInfo> {
protected:
    GSMRRInfoTest()
        : SectionFixture(Dictionary::make())
    {
    }
};

constexpr const char* Trace = "<4>GSMRRInfo\n";

TEST_F(GSMRRInfoTest, SubscribesToItsFourCodes)
{
    EXPECT_EQ(section.getSectionName(), "GSM RR Info");
    EXPECT_EQ(section.getLogCodeArray(), (std::vector<std::uint32_t> {0x512C, 0x5137, 0x5072, 0x51F6}));
}

TEST_F(GSMRRInfoTest, StateIsShownInOrder)
{
    deliver(0x512C, RecordBuilder(0x512C, 17).u8(13, 16).u8(14, 2).u8(15, 0).u8(16, 1));
    EXPECT_EQ(
        display(), "{\"RR State\": \"GRR51\", \"RR Sub State\": \"2\", \"RR Status\": \"0\", \"RR Mode\": \"Data\"}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(GSMRRInfoTest, EveryRRStateHasItsName)
{
    EXPECT_EQ(shownForEachByte(0x512C, RecordBuilder(0x512C, 17), 13, "RR State"),
        textsForEachByte(
            {"RR_INACTIVE", "RR_GOING_ACTIVE", "RR_GOING_INACTIVE", "RR_CELL_SELECTION", "RR_PLMN_LIST_CONSTRUCTION",
                "RR_IDLE", "RR_CELL_RESELECTION", "RR_CONNECTION_PENDING", "RR_CHOOSE_CELL", "RR_DATA_TRANSFER",
                "RR_NO_CHANNELS", "RR_CONNECTION_RELEASE", "RR_EARLY_CAMPED_WAIT_FOR_SI",
                "RR_W2G_INTERRAT_HANDOVER_ PROGRESS", "RR_W2G_INTERRAT_RESELECTION_PROGRESS", "RR_WAIT_FOR_EARLY_PSCAN",
                "GRR51", "GRR52", "RR_G2W_INTERRAT_RESELECTION_PROGRESS", "RR_G2W_INTERRAT_HANDOVER_ PROGRESS",
                "RR_CELL_REEST", "RR_W2G_INTERRAT_CC_ORDER_ PROGRESS"},
            "Unknown"));
}

TEST_F(GSMRRInfoTest, ModeIsDataForAnythingButZero)
{
    std::vector<std::string> expected = textsForEachByte({"Voice"}, "Data");
    EXPECT_EQ(shownForEachByte(0x512C, RecordBuilder(0x512C, 17), 16, "RR Mode"), expected);
}

TEST_F(GSMRRInfoTest, State22IsUnknownAndARecordOf16BytesChangesNothing)
{
    deliver(0x512C, RecordBuilder(0x512C, 16).u8(13, 5));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
    deliver(0x512C, RecordBuilder(0x512C, 17).u8(13, 22));
    EXPECT_EQ(shown("RR State"), "\"Unknown\"");
}

TEST_F(GSMRRInfoTest, MeasurementIsShownInOrder)
{
    deliver(0x5137, RecordBuilder(0x5137, 28).u8(15, 63));
    EXPECT_EQ(display(), "{}");
    deliver(0x5137, RecordBuilder(0x5137, 29).u8(15, 63).u32(16, 0x12345678).u32(20, 0xFFFFFFFF));
    EXPECT_EQ(
        display(), "{\"Serving Rx Level\": \"63\", \"Rx Quality Full\": \"305419896\", \"Rx Quality Sub\": \"-1\"}");
    EXPECT_EQ(log(), std::string(Trace) + Trace);
}

TEST_F(GSMRRInfoTest, DTXIsOffForZeroAndARecordOf19BytesChangesNothing)
{
    deliver(0x5072, RecordBuilder(0x5072, 19));
    EXPECT_EQ(display(), "{}");
    deliver(0x5072, RecordBuilder(0x5072, 20));
    EXPECT_EQ(display(), "{\"DTX Used\": \"OFF\"}");
    EXPECT_EQ(shownForEachByte(0x5072, RecordBuilder(0x5072, 20), 19, "DTX Used"), textsForEachByte({"OFF"}, "ON"));
}

TEST_F(GSMRRInfoTest, DRXIsShownInSeconds)
{
    deliver(0x51F6, RecordBuilder(0x51F6, 23).u8(16, 2));
    EXPECT_EQ(display(), "{}");
    deliver(0x51F6, RecordBuilder(0x51F6, 24).u8(16, 2));
    EXPECT_EQ(display(), "{\"DRX Used\": \"2 sec\"}");
    deliver(0x51F6, RecordBuilder(0x51F6, 24).u8(16, 255));
    EXPECT_EQ(display(), "{\"DRX Used\": \"255 sec\"}");
}

TEST_F(GSMRRInfoTest, BytesAreUnsigned)
{
    deliver(0x512C, RecordBuilder(0x512C, 17).u8(14, 254).u8(15, 255));
    deliver(0x5137, RecordBuilder(0x5137, 29).u8(15, 253));
    EXPECT_EQ(shown("RR Sub State"), "\"254\"");
    EXPECT_EQ(shown("RR Status"), "\"255\"");
    EXPECT_EQ(shown("Serving Rx Level"), "\"253\"");
}

TEST_F(GSMRRInfoTest, OtherCodeIsLoggedAsUnknown)
{
    deliver(0x51F5, RecordBuilder(0x51F5, 60));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: 20981\n");
}

} // namespace
} // namespace spectrel
