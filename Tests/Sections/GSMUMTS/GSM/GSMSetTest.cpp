#include "Sections/GSMUMTS/GSM/GSMSet.h"

#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

class GSMSetTest : public SectionFixture<GSMSet> {
protected:
    GSMSetTest()
        : SectionFixture(List::make({"old"}))
    {
    }
};

constexpr const char* Trace = "<4>GSMSet\n";

TEST_F(GSMSetTest, SubscribesToItsCode)
{
    EXPECT_EQ(section.getSectionName(), "GSM Set");
    EXPECT_EQ(section.getLogCodeArray(), (std::vector<std::uint32_t> {0x4005}));
}

TEST_F(GSMSetTest, CellsAreListedWithTheirKeysInOrder)
{
    RecordBuilder record(0x4005, 15 + 2 * 7);
    record.u8(14, 2);
    record.u16(15, 62).u16(17, 41).u8(19, 0x100 - 83).u16(20, 0x10000 - 12);
    record.u16(22, 65534).u16(24, 65535).u8(26, 5).u16(27, 300);
    deliver(0x4005, record);
    EXPECT_EQ(display(),
        "[{\"ARFCN\": \"62\", \"BSIC\": \"41\", \"RSSI\": \"-83 dBm\", \"Ranking Value\": \"-12\"}, "
        "{\"ARFCN\": \"65534\", \"BSIC\": \"65535\", \"RSSI\": \"5 dBm\", \"Ranking Value\": \"300\"}]");
    EXPECT_EQ(log(), Trace);
}

TEST_F(GSMSetTest, UMTSCellsBeforeThemAreNotSkipped)
{
    RecordBuilder record(0x4005, 15 + 10 + 7);
    record.u8(13, 1).u8(14, 1);
    record.u16(15, 10700).u16(17, 300).u8(19, 0x100 - 80).u16(20, 0x10000 - 99).u8(22, 1).u16(23, 7); // UMTS
    record.u16(25, 62).u16(27, 41).u8(29, 0x100 - 83).u16(30, 3); // GSM
    deliver(0x4005, record);
    EXPECT_EQ(
        display(), "[{\"ARFCN\": \"10700\", \"BSIC\": \"300\", \"RSSI\": \"-80 dBm\", \"Ranking Value\": \"-99\"}]");
}

TEST_F(GSMSetTest, NoCellsEmptyTheList)
{
    deliver(0x4005, RecordBuilder(0x4005, 15).u8(13, 3));
    EXPECT_EQ(display(), "[]");
}

TEST_F(GSMSetTest, RecordOneByteTooShortLeavesTheList)
{
    deliver(0x4005, RecordBuilder(0x4005, 14));
    EXPECT_EQ(display(), "[\"old\"]");
    EXPECT_EQ(log(), Trace);
}

TEST_F(GSMSetTest, CellsPastTheEndOfTheRecordReadAsZeros)
{
    deliver(0x4005, RecordBuilder(0x4005, 16).u8(14, 2).u8(15, 9));
    EXPECT_EQ(display(),
        "[{\"ARFCN\": \"9\", \"BSIC\": \"0\", \"RSSI\": \"0 dBm\", \"Ranking Value\": \"0\"}, "
        "{\"ARFCN\": \"0\", \"BSIC\": \"0\", \"RSSI\": \"0 dBm\", \"Ranking Value\": \"0\"}]");
}

TEST_F(GSMSetTest, OtherCodeIsLoggedAsUnknownAndLeavesTheList)
{
    deliver(0xFF0001, RecordBuilder(0xFF0001, 40));
    EXPECT_EQ(display(), "[\"old\"]");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: 16711681\n");
}

} // namespace
} // namespace spectrel
