#include "Tests/Analysis/AnalysisFixture.h"

namespace spectrel {
namespace {

class LTECellsTest : public AnalysisFixture {
protected:
    LTECellsTest()
        : AnalysisFixture("LTELogGenerator")
    {
    }
    void showConfiguration()
    {
        show({{"/Serving Cell Info/Physical Cell ID", "52"}, {"/Serving Cell Info/Download Frequency", "1300"},
            {"/Serving Cell Info/Upload Frequency", "19300"}, {"/Serving Cell Info/Download Bandwidth", "20 MHz"},
            {"/Serving Cell Info/Cell Identity", "1049857"}, {"/Serving Cell Info/Tracking Area Code", "1201"},
            {"/Serving Cell Info/Freq Band Indicator", "3"}});
    }
    void showIdle(std::string_view rsrp = "-104.50 dBm")
    {
        show({{"/Serving Cell Measurements/E-ARFCN", "1300"}, {"/Serving Cell Measurements/Physical Cell ID", "52"},
            {"/Serving Cell Measurements/Measured RSRP", rsrp},
            {"/Serving Cell Measurements/Average RSRP", "-100.00 dBm"},
            {"/Serving Cell Measurements/Measured RSRQ", "-9.50 dB"},
            {"/Serving Cell Measurements/Average RSRQ", "-8.00 dB"},
            {"/Serving Cell Measurements/Measured RSSI", "-75.00 dBm"},
            {"/Serving Cell Measurements/Srxlev", "16 dBm"}});
    }
    void showConnected(std::string_view id = "52")
    {
        constexpr std::string_view Section = "/Connected mode LTE Intra-frequency Measurement/";
        const std::string section(Section);
        message([&](Dictionary& root) {
            store(root, section + "E-ARFCN", "1300");
            store(root, section + "Serving Physical Cell ID", id);
            store(root, section + "Serving Filtered RSRP", "-101.25 dBm");
            store(root, section + "Serving Filtered RSRQ", "-10.38 dB");
            list(root, "/Measured Neighbor Cells",
                {{{"Physical Cell ID", "203"}, {"Filtered RSRP", "-98.75 dBm"}, {"Filtered RSRQ", "-9.00 dB"}}});
            list(root, "/Detected Cells", {{{"Physical Cell ID", "17"}}});
        });
    }
};

TEST_F(LTECellsTest, ConfigurationTellsIdentityChannelAndBand)
{
    showConfiguration();
    EXPECT_EQ(serving(),
        "lte area=1201 cell=1049857 site=4101 sector=1 id=52 channel=1300 band=3 down=1815 up=1720 width=20");
    EXPECT_EQ(sourceOf(CellKey::Site), "/Serving Cell Info/Cell Identity");
    EXPECT_EQ(sourceOf(CellKey::DownlinkMHz), "/Serving Cell Info/Download Frequency");
    EXPECT_EQ(connection(), "unknown");
}

TEST_F(LTECellsTest, MeasuredLevelsCountBeforeAverages)
{
    showIdle();
    EXPECT_EQ(serving(), "lte id=52 channel=1300 band=3 down=1815 up=1720 RSRP=-104.5 RSRQ=-9.5 RSSI=-75 Srxlev=16");
    EXPECT_EQ(sourceOf(CellKey::FirstLevel), "/Serving Cell Measurements/Measured RSRP");
    EXPECT_EQ(connection(), "idle");
}

TEST_F(LTECellsTest, AnAverageCountsWhereNothingIsMeasured)
{
    showIdle("-");
    EXPECT_EQ(analysis.serving()->level(Level::RSRP), -100);
}

TEST_F(LTECellsTest, ConnectedModeLeavesNothingOfTheIdleLevels)
{
    showConfiguration();
    showIdle();
    showConnected();
    EXPECT_EQ(connection(), "connected");
    EXPECT_EQ(serving(),
        "lte area=1201 cell=1049857 site=4101 sector=1 id=52 channel=1300 band=3 down=1815 up=1720 width=20 "
        "RSRP=-101.25 RSRQ=-10.38");
    showIdle();
    EXPECT_EQ(connection(), "idle");
    EXPECT_EQ(neighbours(), "") << "those of connected mode";
}

TEST_F(LTECellsTest, AnotherCellHasNothingOfTheOneBefore)
{
    showConfiguration();
    showConnected("53");
    EXPECT_EQ(serving(), "lte id=53 channel=1300 band=3 down=1815 up=1720 RSRP=-101.25 RSRQ=-10.38");
    EXPECT_EQ(analysis.serving()->sinceMessage, 1u);
    showConfiguration();
    EXPECT_EQ(analysis.serving()->level(Level::RSRP), std::nullopt);
}

TEST_F(LTECellsTest, EqualValuesStoredAgainAreToldAgain)
{
    showConfiguration();
    showConnected("53");
    showConfiguration(); // nothing of it has changed in the display
    EXPECT_EQ(analysis.serving()->area, 1201u);
    later(std::chrono::seconds(3));
    showConfiguration();
    EXPECT_EQ(analysis.serving()->stored, now);
}

TEST_F(LTECellsTest, TheChannelIsThatOfTheLastRecord)
{
    showConfiguration();
    show({{"/Serving Cell Info/Physical Cell ID", "99"}, {"/Serving Cell Info/UARFCN", "6300"}});
    EXPECT_EQ(serving(), "lte id=99 channel=6300 band=20 down=806 up=847");
    show({{"/Serving Cell Info/Physical Cell ID", "52"}, {"/Serving Cell Info/Download Frequency", "1300"},
        {"/Serving Cell Info/UARFCN", "(gone)"}});
    EXPECT_EQ(serving(), "lte id=52 channel=1300 band=3 down=1815 up=1720");
}

TEST_F(LTECellsTest, ContradictingBandIndicatorLeavesBandAndFrequenciesOut)
{
    show({{"/Serving Cell Info/Physical Cell ID", "52"}, {"/Serving Cell Info/Download Frequency", "1300"},
        {"/Serving Cell Info/Freq Band Indicator", "7"}});
    EXPECT_EQ(serving(), "lte id=52 channel=1300");
    show({{"/Serving Cell Info/Freq Band Indicator", "3"}});
    EXPECT_EQ(serving(), "lte id=52 channel=1300 band=3 down=1815 up=1720");
}

TEST_F(LTECellsTest, AbsurdNumbersAreUnknown)
{
    show({{"/Serving Cell Info/Physical Cell ID", "504"}, {"/Serving Cell Info/Download Frequency", "1300"},
        {"/Serving Cell Info/Cell Identity", "-1"}, {"/Serving Cell Info/Tracking Area Code", "65534"},
        {"/Serving Cell Info/Download Bandwidth", "Unknown"},
        {"/Connected mode LTE Intra-frequency Measurement/Serving Filtered RSRP", "16243.75 dBm"},
        {"/Connected mode LTE Intra-frequency Measurement/Serving Filtered RSRQ", "nan dB"}});
    EXPECT_EQ(serving(), "lte channel=1300 band=3 down=1815 up=1720");
}

TEST_F(LTECellsTest, IdleNeighboursAreOnTheRecordsChannelStrongestFirst)
{
    showIdle();
    message([&](Dictionary& root) {
        store(root, "/Neighbor Measurements/E-ARFCN", "3350");
        list(root, "/Neighbor Cells List",
            {{{"Physical Cell ID", "12"}, {"Measured RSRP", "-110.00 dBm"}},
                {{"Physical Cell ID", "9"}, {"Measured RSRP", "-102.00 dBm"}, {"Average RSRP", "-90.00 dBm"},
                    {"Measured RSRQ", "-8.75 dB"}, {"Measured RSSI", "-63.00 dBm"}, {"Srxlev", "18 dBm"}},
                {{"Physical Cell ID", "7"}, {"Measured RSRP", "-110.00 dBm"}},
                {{"Physical Cell ID", "510"}, {"Measured RSRP", "-80.00 dBm"}}});
    });
    EXPECT_EQ(neighbours(),
        "lte id=9 channel=3350 band=7 down=2680 up=2560 RSRP=-102 RSRQ=-8.75 RSSI=-63 Srxlev=18; "
        "lte id=7 channel=3350 band=7 down=2680 up=2560 RSRP=-110; "
        "lte id=12 channel=3350 band=7 down=2680 up=2560 RSRP=-110");
    EXPECT_EQ(analysis.report().neighbours.front().difference, 2.5);
}

TEST_F(LTECellsTest, ConnectedNeighboursAreTheMeasuredAndDetectedOnes)
{
    showConnected();
    EXPECT_EQ(neighbours(),
        "lte id=203 channel=1300 band=3 down=1815 up=1720 RSRP=-98.75 RSRQ=-9; "
        "lte id=17 channel=1300 band=3 down=1815 up=1720");
    showConnected("203");
    EXPECT_EQ(neighbours(), "lte id=17 channel=1300 band=3 down=1815 up=1720") << "203 serves";
}

TEST_F(LTECellsTest, ReselectionRecordNamesTheServingCell)
{
    show({{"/Reselection Candidates/Serving EARFCN", "1300"}, {"/Reselection Candidates/Serving Cell ID", "52"}});
    EXPECT_EQ(serving(), "lte id=52 channel=1300 band=3 down=1815 up=1720");
}

TEST_F(LTECellsTest, WithoutADisplayNothingIsKnown)
{
    EXPECT_EQ(serving(), "none");
    show({});
    EXPECT_EQ(serving(), "none");
    EXPECT_EQ(analysis.report().n, 1u);
    EXPECT_TRUE(analysis.report().neighbours.empty());
}

} // namespace
} // namespace spectrel
