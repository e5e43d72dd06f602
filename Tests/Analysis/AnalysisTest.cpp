#include "Analysis/Analysis.h"

#include "Analysis/OperatorNames.h"
#include "Tests/Analysis/AnalysisFixture.h"

namespace spectrel {
namespace {

class Listener final : public AnalysisListener {
public:
    void messageAnalysed(
        const AppliedMessage& message, const Journal&, const Analysis&, const AnalysedChanges& changes) override
    {
        text += std::to_string(message.number) + ":";
        text += std::string(changes.serving ? " serving" : "") + (changes.surroundings ? " surroundings" : "");
        text += std::string(changes.connection ? " connection" : "") + (changes.registration ? " registration" : "");
        text += changes.contexts ? " contexts\n" : "\n";
    }
    void refreshed(const CellReport& report, const Analysis&) override
    {
        text += "refresh " + std::to_string(report.n) + "\n";
    }
    std::string text;
};

class AnalysisTest : public AnalysisFixture {
protected:
    AnalysisTest()
        : AnalysisFixture("LTELogGenerator")
    {
    }
    void showCounters(std::string_view received, std::string_view sent)
    {
        showList("/PDP Context Info",
            {{{"APN", "internet.test"}, {"State", "Active"}, {"Bytes Received", received}, {"Bytes Sent", sent}}});
    }
};

TEST_F(AnalysisTest, ListenersHearOfEveryMessageWhatItChanged)
{
    Listener listener;
    analysis.addListener(listener);
    show({{"/Serving Cell Info/Physical Cell ID", "52"}});
    show({{"/SIM Info/EF-ICCID", "89"}});
    show({{"/Serving Cell Measurements/Physical Cell ID", "52"}});
    showList("/Neighbor Cells List", {{{"Physical Cell ID", "12"}}});
    showCounters("1", "2");
    analysis.refresh(now);
    EXPECT_EQ(
        listener.text, "0: serving\n1:\n2: serving connection\n3: surroundings connection\n4: contexts\nrefresh 5\n");
    analysis.removeListener(listener);
}

TEST_F(AnalysisTest, AnotherTechnologyBeginsAnew)
{
    show({{"/Serving Cell Info/Physical Cell ID", "52"}});
    use("UTRANLogGenerator");
    show({});
    EXPECT_EQ(serving(), "none");
    show({{"/Serving Cell Info/Cell ID", "306"}});
    EXPECT_EQ(serving(), "umts cell=306");
}

TEST_F(AnalysisTest, RatesAreWhatCountersGrewByBetweenStores)
{
    showCounters("1000", "500");
    EXPECT_EQ(analysis.report().contexts.at(0).downlinkKbps, std::nullopt);
    later(std::chrono::seconds(2));
    showCounters("251000", "500");
    const DataContext data = analysis.report().contexts.at(0);
    EXPECT_EQ(data.name, "internet.test");
    EXPECT_EQ(data.state, "Active");
    EXPECT_EQ(data.downlinkKbps, 1000);
    EXPECT_EQ(data.uplinkKbps, 0);
    later(std::chrono::seconds(2));
    showCounters("5", "-");
    EXPECT_EQ(analysis.report().contexts.at(0).downlinkKbps, std::nullopt) << "counted anew";
    EXPECT_EQ(analysis.report().contexts.at(0).uplinkKbps, std::nullopt);
}

TEST_F(AnalysisTest, ListStoredTwiceAtOnceKeepsItsRates)
{
    showCounters("0", "0");
    later(std::chrono::seconds(1));
    showCounters("125", "0");
    showCounters("125", "0");
    EXPECT_EQ(analysis.report().contexts.at(0).downlinkKbps, 1);
}

class Names final : public OperatorNames {
public:
    std::string nameOf(std::string_view plmn) override
    {
        ++asked;
        return plmn == "001-01" ? "Test Network" : "";
    }
    int asked = 0;
};

TEST_F(AnalysisTest, OperatorsNamesAreAskedForOnceANetwork)
{
    Names names;
    use("ZPH_GSMLogGenerator");
    const Analysis named(display, &names);
    for (int message = 0; message < 3; ++message) {
        show({{"/GSM/GSM Serving Cell/ARFCN", "12"}, {"/Network/Serving PLMN/Mobile Country Code", "001"},
            {"/Network/Serving PLMN/Mobile Network Code", "01 "}});
    }
    EXPECT_EQ(named.serving()->operatorName, "Test Network");
    EXPECT_EQ(names.asked, 1);
}

} // namespace
} // namespace spectrel
