#include "Tests/Analysis/AnalysisFixture.h"

namespace spectrel {
namespace {

class CDMACellsTest : public AnalysisFixture {
protected:
    CDMACellsTest()
        : AnalysisFixture("C2KLogGenerator")
    {
    }
    /// As the searcher's record does it: names have their order before them.
    void showOneX(const Fields& pilots, std::string_view state = "Paging [6]")
    {
        message([&](Dictionary& root) {
            sort(root, "2;1x");
            store(root, "/2;1x/01;State", state);
            store(root, "/2;1x/02;Rx 0 Band Class", "1.8 to 2.0GHz PCS band [1]");
            store(root, "/2;1x/03;Rx 0 Channel", "425");
            store(root, "/2;1x/04;Rx 0 Power", "-71.26 dBm");
            storePilots(root, "2;1x", "10;Active Set", pilots);
        });
    }
    void showDataOnly(
        const Fields& pilots, std::string_view state = "Idle [3]", std::string_view offset = "136 × 64chips")
    {
        message([&](Dictionary& root) {
            sort(root, "3;EV-DO");
            store(root, "/3;EV-DO/01;State", state);
            store(root, "/3;EV-DO/02;Band Class", "1.8 to 2.0GHz PCS band [1]");
            store(root, "/3;EV-DO/03;Channel", "325");
            store(root, "/3;EV-DO/04;Serving PN Offset", offset);
            store(root, "/3;EV-DO/05;Rx AGC 0", "-70 dBm");
            storePilots(root, "3;EV-DO", "10;Active Set", pilots);
        });
    }
    static void sort(Dictionary& root, std::string_view section)
    {
        root.setText("_sorted", "_sorted");
        store(root, "/" + std::string(section) + "/_sorted", "_sorted");
    }
    static void storePilots(Dictionary& root, std::string_view section, std::string_view key, const Fields& pilots)
    {
        const auto set = Dictionary::make({{"_sorted", "_sorted"}});
        for (const auto& [pilot, value] : pilots)
            set->set(pilot, value);
        root[section].dictionary()->set(key, set);
    }
};

TEST_F(CDMACellsTest, TheReferencePilotServes)
{
    showOneX({{"0;148", "-9.10 dB"}, {"1;136", "(ref pilot) -7.49 dB"}});
    EXPECT_EQ(serving(), "cdma id=136 channel=425 band=1 down=1951.25 up=1871.25 RSSI=-71.26 EcIo=-7.49");
    EXPECT_EQ(active(),
        "cdma id=148 channel=425 band=1 down=1951.25 up=1871.25 EcIo=-9.1; "
        "cdma id=136 channel=425 band=1 down=1951.25 up=1871.25 EcIo=-7.49");
    EXPECT_EQ(sourceOf(cellKeyOf(Level::EcIo)), "/1x/Active Set/136");
    EXPECT_EQ(sourceOf(CellKey::Channel), "/1x/Rx 0 Channel");
}

TEST_F(CDMACellsTest, BaseStationIsTheCellUnlessItIsZero)
{
    showOneX({{"0;136", "(ref pilot) -7.49 dB"}});
    show({{"/2;1x/11;System/_sorted", "_sorted"}, {"/2;1x/11;System/1;Roaming Indicator", "OFF [0]"},
        {"/2;1x/11;System/4;Base Station ID", "1777"}});
    EXPECT_EQ(analysis.serving()->cell, 1777u);
    EXPECT_EQ(analysis.report().registration, "OFF [0]");
    show({{"/2;1x/11;System/4;Base Station ID", "0"}});
    EXPECT_EQ(analysis.serving()->cell, std::nullopt);
}

TEST_F(CDMACellsTest, ThePilotFloorIsNoMeasurement)
{
    showOneX({{"0;136", "(ref pilot) -50.00 dB"}});
    EXPECT_EQ(analysis.serving()->level(Level::EcIo), std::nullopt);
}

TEST_F(CDMACellsTest, AnotherReferencePilotIsAnotherCell)
{
    showOneX({{"0;136", "(ref pilot) -7.49 dB"}});
    show({{"/2;1x/11;System/4;Base Station ID", "1777"}});
    showOneX({{"0;148", "(ref pilot) -6.00 dB"}, {"1;136", "-9.00 dB"}});
    EXPECT_EQ(analysis.serving()->id, 148u);
    EXPECT_EQ(analysis.serving()->cell, std::nullopt);
}

TEST_F(CDMACellsTest, TheDataSectorStandsFirstOfItsKindAmongTheActive)
{
    showDataOnly({{"0;148", "-3.00 dB"}, {"1;136", "-0.50 dB"}});
    EXPECT_EQ(serving(), "none");
    EXPECT_EQ(active(),
        "evdo id=136 channel=325 band=1 down=1946.25 up=1866.25 RSSI=-70 EcIo=-0.5; "
        "evdo id=148 channel=325 band=1 down=1946.25 up=1866.25 EcIo=-3");
}

TEST_F(CDMACellsTest, AnInactiveDataRadioHasNoSector)
{
    showDataOnly({{"0;136", "-0.50 dB"}});
    showDataOnly({}, "Inactive [0]", "Invalid Value");
    EXPECT_EQ(active(), "");
}

TEST_F(CDMACellsTest, ContradictingBandClassLeavesBandAndFrequenciesOut)
{
    showOneX({{"0;136", "(ref pilot) -7.49 dB"}});
    show({{"/2;1x/02;Rx 0 Band Class", "1.8 to 2.0GHz PCS band [1]"}, {"/2;1x/03;Rx 0 Channel", "1201"}});
    EXPECT_EQ(serving(), "cdma channel=1201");
}

TEST_F(CDMACellsTest, ConnectedIsEitherRadio)
{
    showOneX({{"0;136", "(ref pilot) -7.49 dB"}});
    EXPECT_EQ(connection(), "idle");
    showDataOnly({{"0;136", "-0.50 dB"}}, "Connected [5]");
    EXPECT_EQ(connection(), "connected");
    showDataOnly({{"0;136", "-0.50 dB"}});
    showOneX({{"0;136", "(ref pilot) -7.49 dB"}}, "Traffic [8]");
    EXPECT_EQ(connection(), "connected");
}

TEST_F(CDMACellsTest, WithoutAPilotNothingServes)
{
    showOneX({{"0;136", "(ref pilot) -7.49 dB"}});
    showOneX({}, "Acquisition [3]");
    EXPECT_EQ(serving(), "none");
}

} // namespace
} // namespace spectrel
