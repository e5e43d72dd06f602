#include "Tests/Analysis/AnalysisFixture.h"

namespace spectrel {
namespace {

class IFXCellsTest : public AnalysisFixture {
protected:
    IFXCellsTest()
        : AnalysisFixture("GSMLogGenerator")
    {
    }
    void showReport(std::string_view identity = "20010", std::string_view code = "3-7")
    {
        message([&](Dictionary& root) {
            root.removeAll();
            store(root, "/Registration/State", "Registered, home");
            store(root, "/Registration/Network/PLMN", "001-01");
            store(root, "/Registration/Network/Name", "Test Network");
            store(root, "/Registration/Area/LAC", "1201");
            store(root, "/Serving Cell/Cell Identity", identity);
            store(root, "/Serving Cell/BSIC", code);
            store(root, "/Serving Cell/Carrier/ARFCN", "12");
            store(root, "/Serving Cell/Level/RxLev", "-74 dBm");
            store(root, "/Serving Cell/Level/C1", "30");
            list(root, "/Neighbour Cells",
                {{{"ARFCN", "59"}, {"BSIC", "3-4"}, {"RxLev", "-96 dBm"}, {"C1", "8"}},
                    {{"ARFCN", "35"}, {"BSIC", "3-5"}, {"RxLev", "-84 dBm"}, {"C1", "20"}}});
            store(root, "/Call/State", "No call");
            store(root, "/Packet Data/State", "Attached");
        });
    }
};

TEST_F(IFXCellsTest, AReportTellsEverything)
{
    showReport();
    EXPECT_EQ(serving(),
        "gsm plmn=001-01 operator=Test Network area=1201 cell=20010 id=31 channel=12 band=P-GSM 900 down=937.4 "
        "up=892.4 RSSI=-74 C1=30");
    EXPECT_EQ(neighbours(),
        "gsm id=29 channel=35 band=P-GSM 900 down=942 up=897 RSSI=-84 C1=20; "
        "gsm id=28 channel=59 band=P-GSM 900 down=946.8 up=901.8 RSSI=-96 C1=8");
    EXPECT_EQ(connection(), "idle");
    EXPECT_EQ(analysis.report().registration, "Registered, home");
}

TEST_F(IFXCellsTest, AnotherCellBeginsAnew)
{
    showReport();
    later(std::chrono::seconds(2));
    showReport("20011", "3-1");
    EXPECT_EQ(analysis.serving()->id, 25u);
    EXPECT_EQ(analysis.serving()->plmn, "001-01");
    EXPECT_EQ(analysis.serving()->since, now);
}

TEST_F(IFXCellsTest, HalfAReportTellsHalf)
{
    show({{"/Serving Cell/BSIC", "9-9"}, {"/Serving Cell/Carrier/ARFCN", "12"}, {"/Registration/Network/PLMN", "00101"},
        {"/Serving Cell/Level/RxLev", "99999 dBm"}});
    EXPECT_EQ(serving(), "gsm channel=12 band=P-GSM 900 down=937.4 up=892.4");
}

} // namespace
} // namespace spectrel
