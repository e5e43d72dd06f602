#include "Tests/Analysis/AnalysisFixture.h"

namespace spectrel {
namespace {

class UTRANCellsTest : public AnalysisFixture {
protected:
    UTRANCellsTest()
        : AnalysisFixture("UTRANLogGenerator")
    {
    }
    void showServing(std::string_view indicator = "34")
    {
        show({{"/Serving Cell Info/Local Area Code", "4101"}, {"/Serving Cell Info/Cell ID", "786738"},
            {"/Serving Cell Info/Freq Band Indicator", indicator}, {"/Serving Cell Info/Cell Scrambling Code", "66"},
            {"/Serving Cell Info/Uplink UARFCN", "10062"}, {"/Serving Cell Info/Downlink UARFCN", "10062"}});
    }
};

TEST_F(UTRANCellsTest, ServingCellHasTheRNCInItsIdentityAndATDDBand)
{
    showServing();
    EXPECT_EQ(
        serving(), "umts area=4101 cell=786738 rnc=12 sector=306 id=66 channel=10062 band=34 down=2012.4 up=2012.4");
}

TEST_F(UTRANCellsTest, ContradictingBandIndicatorLeavesBandAndFrequenciesOut)
{
    showServing("38");
    EXPECT_EQ(serving(), "umts area=4101 cell=786738 rnc=12 sector=306 id=66 channel=10062");
}

TEST_F(UTRANCellsTest, ShortIdentityHasNoRNC)
{
    show({{"/Serving Cell Info/Cell ID", "306"}, {"/Serving Cell Info/Downlink UARFCN", "9580"}});
    EXPECT_EQ(serving(), "umts cell=306 channel=9580 down=1916 up=1916") << "in bands 33, 37 and 39";
}

TEST_F(UTRANCellsTest, FilteredLevelsAreScaledBackAndSetsToldApart)
{
    showServing();
    showList("/Neighbor Cell List",
        {{{"UARFCN", "10062"}, {"Cell ID", "66"}, {"Filter RSCP", "0.218750"}, {"Status", "ASET"}},
            {{"UARFCN", "10071"}, {"Cell ID", "20"}, {"Filter RSCP", "0.011719"}, {"Status", "MSET"}},
            {{"UARFCN", "10062"}, {"Cell ID", "51"}, {"Filter RSCP", "0.152344"}},
            {{"UARFCN", "10062"}, {"Cell ID", "52"}, {"Filter RSCP", "0.500000"}, {"Status", "DSET"}}});
    EXPECT_EQ(analysis.serving()->level(Level::RSCP), -60);
    EXPECT_EQ(active(), "umts id=66 channel=10062 band=34 down=2012.4 up=2012.4 RSCP=-60");
    EXPECT_EQ(neighbours(),
        "umts id=51 channel=10062 band=34 down=2012.4 up=2012.4 RSCP=-77; "
        "umts id=20 channel=10071 band=34 down=2014.2 up=2014.2 RSCP=-113; "
        "umts id=52 channel=10062 band=34 down=2012.4 up=2012.4")
        << "there are 92 levels";
}

TEST_F(UTRANCellsTest, LevelGoesWithTheListThatHeldIt)
{
    showServing();
    showList("/Neighbor Cell List",
        {{{"UARFCN", "10062"}, {"Cell ID", "66"}, {"Filter RSCP", "0.218750"}, {"Status", "ASET"}}});
    showList("/Neighbor Cell List", {});
    EXPECT_EQ(analysis.serving()->level(Level::RSCP), std::nullopt);
}

TEST_F(UTRANCellsTest, OnlyActiveCellServes)
{
    showList("/Neighbor Cell List", {{{"UARFCN", "10062"}, {"Cell ID", "66"}, {"Status", "ASET"}}});
    EXPECT_EQ(serving(), "umts id=66 channel=10062 band=34 down=2012.4 up=2012.4");
}

TEST_F(UTRANCellsTest, GSMNeighboursHaveBandAndColourCodesWhereTheyWereRead)
{
    showServing();
    showList("/GSM Neighbor Cell List",
        {{{"Cell ID", "545"}, {"Band Indicator", "0"}, {"BSIC Valid", "1"}, {"NCC", "3"}, {"BCC", "4"},
             {"ARFCN", "800"}, {"RSSI", "-66"}},
            {{"Cell ID", "2232"}, {"Band Indicator", "1"}, {"BSIC Valid", "0"}, {"NCC", "1"}, {"BCC", "1"},
                {"ARFCN", "525"}, {"RSSI", "-70"}},
            {{"Band Indicator", "1"}, {"ARFCN", "12"}, {"RSSI", "-80"}}});
    EXPECT_EQ(neighbours(),
        "gsm cell=545 id=28 channel=800 band=DCS 1800 down=1862.8 up=1767.8 RSSI=-66; "
        "gsm cell=2232 channel=525 band=PCS 1900 down=1932.8 up=1852.8 RSSI=-70; "
        "gsm channel=12 band=P-GSM 900 down=937.4 up=892.4 RSSI=-80");
}

TEST_F(UTRANCellsTest, ConnectionIsTheRRCStates)
{
    showServing();
    show({{"/RRC Info/State", "Cell Fach"}});
    EXPECT_EQ(connection(), "connected");
    show({{"/RRC Info/State", "Disconnected"}});
    EXPECT_EQ(connection(), "idle");
    show({{"/RRC Info/State", "Unknown RRC Mode"}});
    EXPECT_EQ(connection(), "unknown");
}

} // namespace
} // namespace spectrel
