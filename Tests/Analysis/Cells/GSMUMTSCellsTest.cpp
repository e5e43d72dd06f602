#include "Tests/Analysis/AnalysisFixture.h"

namespace spectrel {
namespace {

class GSMUMTSCellsTest : public AnalysisFixture {
protected:
    GSMUMTSCellsTest()
        : AnalysisFixture("ZPH_GSMLogGenerator")
    {
    }
    void showUMTS()
    {
        show({{"/UMTS/UMTS RR Info/Cell ID", "2163729"}, {"/UMTS/UMTS RR Info/Downlink Frequency", "10612"},
            {"/UMTS/UMTS RR Info/Uplink Frequency", "9662"}, {"/UMTS/UMTS RR Info/UARFCN", "(gone)"}});
    }
    void showGSM()
    {
        show({{"/GSM/GSM Serving Cell/Cell ID", "20061"}, {"/GSM/GSM Serving Cell/ARFCN", "68"},
            {"/GSM/GSM Serving Cell/BSIC", "11"}});
    }
    void showGSMLevels()
    {
        show({{"/GSM/GSM Serving Cell/RSSI", "52 dBm"}, {"/GSM/GSM Serving Cell/C1 Value", "46"},
            {"/GSM/GSM Serving Cell/C2 Value", "65530"}});
    }
    void showNetwork(std::string_view country, std::string_view network, std::string_view area)
    {
        show({{"/Network/Serving PLMN/Mobile Country Code", country},
            {"/Network/Serving PLMN/Mobile Network Code", network},
            {"/Network/Serving PLMN/Location Area Code", area}});
    }
};

TEST_F(GSMUMTSCellsTest, UMTSServingCellIsPutTogetherFromItsRecordsAndTheActiveSet)
{
    showUMTS();
    showList("/UMTS/Active Set", {{{"Scrambling Code", "196"}, {"RSCP", "-71 dB"}, {"Energy Per Chip", "-8 dB"}}});
    EXPECT_EQ(serving(),
        "umts cell=2163729 rnc=33 sector=1041 id=196 channel=10612 band=1 down=2122.4 up=1932.4 RSCP=-71 EcNo=-8");
    EXPECT_EQ(active(), "umts id=196 channel=10612 band=1 down=2122.4 up=1932.4 RSCP=-71 EcNo=-8");
}

TEST_F(GSMUMTSCellsTest, GSMLevelsAreRXLEVAndSigned)
{
    showGSM();
    showGSMLevels();
    EXPECT_EQ(serving(), "gsm cell=20061 id=11 channel=68 band=P-GSM 900 down=948.6 up=903.6 RSSI=-58 C1=46 C2=-6");
}

TEST_F(GSMUMTSCellsTest, WhileConnectedTheCriteriaAreReceptionQualities)
{
    showGSM();
    showGSMLevels();
    show({{"/GSM/GSM RR Info/RR State", "RR_DATA_TRANSFER"}});
    showGSMLevels();
    EXPECT_EQ(connection(), "connected");
    EXPECT_EQ(serving(), "gsm cell=20061 id=11 channel=68 band=P-GSM 900 down=948.6 up=903.6 RSSI=-58");
    show({{"/GSM/GSM RR Info/RR State", "RR_IDLE"}});
    showGSMLevels();
    EXPECT_EQ(analysis.serving()->level(Level::C1), 46);
}

TEST_F(GSMUMTSCellsTest, WhatWasStoredLastServesAndLeavesNothingOfTheOther)
{
    showUMTS();
    showGSM();
    EXPECT_EQ(serving(), "gsm cell=20061 id=11 channel=68 band=P-GSM 900 down=948.6 up=903.6");
    showUMTS();
    EXPECT_EQ(serving(), "umts cell=2163729 rnc=33 sector=1041 channel=10612 band=1 down=2122.4 up=1932.4");
}

TEST_F(GSMUMTSCellsTest, ConnectionIsThatOfTheServingTechnology)
{
    showUMTS();
    show({{"/UMTS/UMTS RR Info/RRC State", "CELL_PCH"}, {"/GSM/GSM RR Info/RR State", "RR_INACTIVE"}});
    EXPECT_EQ(connection(), "connected");
    show({{"/UMTS/UMTS RR Info/RRC State", "Connecting"}});
    EXPECT_EQ(connection(), "idle");
    showGSM();
    EXPECT_EQ(connection(), "unknown");
}

TEST_F(GSMUMTSCellsTest, DigitsOfTheNetworkWinOverPlainNumbers)
{
    showUMTS();
    showNetwork("001", "01 ", "1202");
    EXPECT_EQ(analysis.serving()->plmn, "001-01");
    EXPECT_EQ(analysis.serving()->area, 1202u);
    showNetwork("1", "1", "1202");
    EXPECT_EQ(analysis.serving()->plmn, "001-01");
    showNetwork("   ", "   ", "65534");
    EXPECT_EQ(analysis.serving()->plmn, "");
    EXPECT_EQ(analysis.serving()->area, std::nullopt) << "a reserved code";
    showNetwork("310", "26", "7");
    EXPECT_EQ(analysis.serving()->plmn, "310-026") << "where all codes have three digits";
}

TEST_F(GSMUMTSCellsTest, AreaToldAheadOfItsCellIsNotMixedIntoTheOneBefore)
{
    showUMTS();
    showNetwork("001", "01 ", "1202");
    showNetwork("001", "01 ", "1211");
    EXPECT_EQ(analysis.serving()->area, 1202u);
    showGSM();
    EXPECT_EQ(serving(), "gsm plmn=001-01 area=1211 cell=20061 id=11 channel=68 band=P-GSM 900 down=948.6 up=903.6");
    EXPECT_EQ(analysis.serving()->sinceMessage, 2u) << "which showed the area";
}

TEST_F(GSMUMTSCellsTest, MeasuredGSMNeighboursAreRXLEVAndThoseOfTheCellInformationDBm)
{
    showGSM();
    showGSMLevels();
    showList("/GSM/Neighboring Cells",
        {{{"ARFCN", "40"}, {"RSSI", "42"}, {"C1 Value", "-6"}, {"BSIC", "12"}}, {{"ARFCN", "575"}, {"RSSI", ""}},
            {{"ARFCN", "55"}, {"RSSI", "-66 dBm"}}, {{"ARFCN", "68"}, {"RSSI", "52"}},
            {{"ARFCN", "12"}, {"RSSI", "200"}}});
    EXPECT_EQ(neighbours(),
        "gsm channel=55 band=P-GSM 900 down=946 up=901 RSSI=-66; "
        "gsm id=12 channel=40 band=P-GSM 900 down=943 up=898 RSSI=-68 C1=-6; "
        "gsm channel=12 band=P-GSM 900 down=937.4 up=892.4; gsm channel=575")
        << "68 serves; 575 is of DCS 1800 or PCS 1900";
    EXPECT_EQ(analysis.report().neighbours.front().difference, -8);
}

TEST_F(GSMUMTSCellsTest, RankedUMTSCellsAreNeighboursButForTheServingOne)
{
    showUMTS();
    show({{"/UMTS/UMTS RR Info/Scrambling Code", "196"}});
    showList("/UMTS/UMTS Set",
        {{{"Scrambling Code", "196"}, {"RSCP", "-70 dB"}, {"Energy Per Chip", "-7.500000 dB"},
             {"Downlink Frequency", "10612"}, {"Rank Cell RSCP", "-60 dB"}},
            {{"Scrambling Code", "25"}, {"RSCP", "-80 dB"}, {"Downlink Frequency", "10612"}},
            {{"UARFCN", "10587"}, {"Scrambling Code", "25"}, {"RSCP", ""}, {"Energy Per Chip", ""}}});
    EXPECT_EQ(analysis.serving()->level(Level::RSCP), -70);
    EXPECT_EQ(analysis.serving()->level(Level::EcNo), -7.5);
    EXPECT_EQ(neighbours(),
        "umts id=25 channel=10612 band=1 down=2122.4 up=1932.4 RSCP=-80; "
        "umts id=25 channel=10587 band=1 down=2117.4 up=1927.4");
}

TEST_F(GSMUMTSCellsTest, RankedGSMCellsCountOnlyWhereNoUMTSCellWasRankedBesideThem)
{
    showUMTS();
    const auto rank = [this](const std::vector<Fields>& umts) {
        message([&](Dictionary& root) {
            list(root, "/GSM/GSM Set", {{{"ARFCN", "40"}, {"BSIC", "11"}, {"RSSI", "-77 dBm"}}});
            list(root, "/UMTS/UMTS Set", umts);
        });
    };
    rank({{{"Scrambling Code", "25"}, {"Downlink Frequency", "10612"}}});
    EXPECT_EQ(neighbours(), "umts id=25 channel=10612 band=1 down=2122.4 up=1932.4");
    rank({});
    EXPECT_EQ(neighbours(), "gsm id=11 channel=40 band=P-GSM 900 down=943 up=898 RSSI=-77");
}

TEST_F(GSMUMTSCellsTest, RegistrationIsTheServiceWithWhatHindersIt)
{
    show({{"/Network/Serving PLMN/Service Type", "CS_PS_SERVICE"}, {"/Network/Process CS/LU Reject Cause", "UPDATED"},
        {"/Network/Process PS/Attach Reject Cause", "GMM_GU1_UPDATED"}});
    EXPECT_EQ(analysis.report().registration, "CS_PS_SERVICE");
    show({{"/Network/Process CS/LU Reject Cause", "ROAMING_NOT_ALLOWED"}});
    EXPECT_EQ(analysis.report().registration, "CS_PS_SERVICE, ROAMING_NOT_ALLOWED");
}

TEST_F(GSMUMTSCellsTest, WithoutServiceNoCellServes)
{
    showGSM();
    show({{"/Network/Serving PLMN/Service Type", "NO_SERVICE"}});
    EXPECT_EQ(serving(), "none");
    show({{"/Network/Serving PLMN/Service Type", "LIMITED_SERVICE"}});
    EXPECT_EQ(serving(), "none") << "until a record names it";
    showGSM();
    EXPECT_EQ(analysis.serving()->cell, 20061u);
}

TEST_F(GSMUMTSCellsTest, DashesSayNothing)
{
    show({{"/UMTS/UMTS RR Info/Cell ID", "-"}, {"/GSM/GSM Serving Cell/ARFCN", "-"},
        {"/Network/Serving PLMN/Service Type", "-"}});
    EXPECT_EQ(serving(), "none");
    EXPECT_EQ(analysis.report().registration, "");
}

} // namespace
} // namespace spectrel
