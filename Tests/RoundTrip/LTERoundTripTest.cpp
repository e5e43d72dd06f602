// What the simulated LTE phone knows is what the display shows, within half a step of each field.

#include "Telephony/Encoders/LTERecords.h"
#include "Telephony/Simulator/LTE/LTEWorld.h"
#include "Tests/RoundTrip/RoundTripFixture.h"

#include <cmath>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

class LTERoundTripTest : public RoundTripFixture {
protected:
    LTERoundTripTest()
        : RoundTripFixture(Technology::LTE)
    {
    }
    /// Ten minutes, a look each second.
    template <typename Look> static void drive(std::uint32_t seed, Look look)
    {
        LTEWorld world(Scene::Drive, seed);
        for (int step = 1; step <= 6000; ++step) {
            world.advance(100ms);
            if (step % 10 == 0)
                look(world);
        }
    }
    static std::string optional(const std::optional<int>& number, const char* unit)
    {
        return number ? std::to_string(*number) + unit : "Not Present";
    }
};

constexpr const char* Serving = "Serving Cell Measurements";

TEST_F(LTERoundTripTest, ServingCell)
{
    drive(2, [this](const LTEWorld& world) {
        const LTECell& cell = world.servingCell();
        deliver(lteServingCellRecord(cell, Time));
        deliver(lteAntennasRecord(cell, Time));
        EXPECT_EQ(number("Serving Cell Info", "Physical Cell ID"), cell.physicalCellId);
        EXPECT_EQ(number("Serving Cell Info", "Cell Identity"), cell.identity);
        EXPECT_EQ(number("Serving Cell Info", "Download Frequency"), cell.downlinkChannel);
        EXPECT_EQ(number("Serving Cell Info", "Upload Frequency"), cell.uplinkChannel);
        EXPECT_EQ(number("Serving Cell Info", "Download Bandwidth"), cell.resourceBlocks / 5);
        EXPECT_EQ(number("Serving Cell Info", "Tracking Area Code"), cell.trackingArea);
        EXPECT_EQ(number("Serving Cell Info", "Freq Band Indicator"), cell.band);
        EXPECT_EQ(number("Serving Cell Info", "Num Tx Antennas"), cell.antennas);
    });
}

TEST_F(LTERoundTripTest, ServingMeasurement)
{
    drive(2, [this](const LTEWorld& world) {
        const LTEServingReport& report = world.idleMode().serving();
        deliver(lteServingMeasurementRecord(report, Time));
        EXPECT_EQ(number(Serving, "E-ARFCN"), report.channel);
        EXPECT_EQ(number(Serving, "Physical Cell ID"), report.physicalCellId);
        EXPECT_EQ(number(Serving, "Serving Layer Priority"), report.priority);
        EXPECT_NEAR(number(Serving, "Measured RSRP"), report.measured.rsrp, 0.13);
        EXPECT_NEAR(number(Serving, "Average RSRP"), report.average.rsrp, 0.13);
        EXPECT_NEAR(number(Serving, "Measured RSRQ"), report.measured.rsrq, 0.13);
        EXPECT_NEAR(number(Serving, "Average RSRQ"), report.average.rsrq, 0.13);
        EXPECT_NEAR(number(Serving, "Measured RSSI"), report.measured.rssi, 0.26);
        EXPECT_EQ(number(Serving, "Qrxlevmin"), report.qRxLevMin);
        EXPECT_EQ(text(Serving, "P_Max"), optional(report.pMax, " dBm"));
        EXPECT_EQ(number(Serving, "Max UE Tx Power"), report.maxUETransmitPower);
        EXPECT_EQ(number(Serving, "Srxlev"), report.srxlev);
        EXPECT_EQ(number(Serving, "Num of Consecutive DRX Cycles of S < 0"), report.cyclesBelowZero);
        EXPECT_EQ(text(Serving, "S Intra Search"), optional(report.sIntraSearch, " dB"));
        EXPECT_EQ(text(Serving, "S Non Intra Search"), optional(report.sNonIntraSearch, " dBm"));
        EXPECT_EQ(text(Serving, "Measurement Rules Updated"), report.areRulesUpdated ? "True" : "False");
        EXPECT_EQ(number(Serving, "Measurement Rules"), report.rules);
    });
}

TEST_F(LTERoundTripTest, LevelsShownAgree)
{
    drive(2, [this](const LTEWorld& world) {
        const LTEServingReport& report = world.idleMode().serving();
        deliver(lteServingMeasurementRecord(report, Time));
        const int resourceBlocks = report.channel == 1300 ? 100 : report.channel == 6300 ? 50 : 75;
        EXPECT_NEAR(number(Serving, "Measured RSRQ"),
            10 * std::log10(resourceBlocks) + number(Serving, "Measured RSRP") - number(Serving, "Measured RSSI"),
            0.51);
    });
}

TEST_F(LTERoundTripTest, IdleNeighbours)
{
    std::size_t shown = 0;
    drive(2, [&](const LTEWorld& world) {
        const LTENeighbourReport report = world.idleMode().neighbours();
        if (report.neighbours.empty())
            return;
        deliver(lteNeighbourMeasurementRecord(report, Time));
        EXPECT_EQ(number("Neighbor Measurements", "E-ARFCN"), report.channel);
        EXPECT_EQ(number("Neighbor Measurements", "Qrxlevmin"), report.qRxLevMin);
        const List& cells = list("Neighbor Cells List");
        ASSERT_EQ(cells.count(), report.neighbours.size());
        for (std::size_t index = 0; index < cells.count(); ++index, ++shown) {
            const Dictionary& cell = *cells[index].dictionary();
            const LTEIdleNeighbour& truth = report.neighbours[index];
            EXPECT_EQ(numberOf(cell, "Physical Cell ID"), truth.physicalCellId);
            EXPECT_NEAR(numberOf(cell, "Measured RSSI"), truth.measured.rssi, 0.26);
            EXPECT_NEAR(numberOf(cell, "Measured RSRP"), truth.measured.rsrp, 0.26);
            EXPECT_NEAR(numberOf(cell, "Average RSRP"), truth.average.rsrp, 0.26);
            EXPECT_NEAR(numberOf(cell, "Measured RSRQ"), truth.measured.rsrq, 0.13);
            EXPECT_NEAR(numberOf(cell, "Average RSRQ"), truth.average.rsrq, 0.13);
            EXPECT_EQ(numberOf(cell, "Srxlev"), std::max(truth.srxlev, -30));
            EXPECT_EQ(numberOf(cell, "Frequency Offset"), truth.frequencyOffset);
            EXPECT_EQ(numberOf(cell, "Ant 0 Frame Offset"), truth.antennas[0].frames);
            EXPECT_EQ(numberOf(cell, "Ant 0 Sample Offset"), truth.antennas[0].samples);
            EXPECT_EQ(numberOf(cell, "Ant 1 Frame Offset"), truth.antennas[0].frames);
            EXPECT_EQ(numberOf(cell, "Ant 1 Sample Offset"), truth.antennas[0].samples)
                << "the display repeats the first antenna";
        }
    });
    EXPECT_GT(shown, 500u);
}

TEST_F(LTERoundTripTest, ConnectedMode)
{
    constexpr const char* Section = "Connected mode LTE Intra-frequency Measurement";
    std::size_t measured = 0;
    std::size_t detected = 0;
    drive(2, [&](const LTEWorld& world) {
        const LTEConnectedReport report = world.connectedReport();
        deliver(lteConnectedModeRecord(report, Time));
        EXPECT_EQ(number(Section, "E-ARFCN"), report.channel);
        EXPECT_EQ(number(Section, "Serving Physical Cell ID"), report.physicalCellId);
        EXPECT_EQ(number(Section, "Subframe Number"), report.subframe);
        EXPECT_NEAR(number(Section, "Serving Filtered RSRP"), report.filtered.rsrp, 0.13);
        EXPECT_NEAR(number(Section, "Serving Filtered RSRQ"), std::max(report.filtered.rsrq, -20.0), 0.07);
        const List& cells = list("Measured Neighbor Cells");
        ASSERT_EQ(cells.count(), report.measured.size());
        for (std::size_t index = 0; index < cells.count(); ++index, ++measured) {
            const Dictionary& cell = *cells[index].dictionary();
            EXPECT_EQ(numberOf(cell, "Physical Cell ID"), report.measured[index].physicalCellId);
            EXPECT_NEAR(numberOf(cell, "Filtered RSRP"), report.measured[index].filtered.rsrp, 0.13);
            EXPECT_NEAR(numberOf(cell, "Filtered RSRQ"), report.measured[index].filtered.rsrq, 0.07);
        }
        const List& others = list("Detected Cells");
        ASSERT_EQ(others.count(), report.detected.size());
        for (std::size_t index = 0; index < others.count(); ++index, ++detected)
            EXPECT_EQ(numberOf(*others[index].dictionary(), "Physical Cell ID"), report.detected[index]);
    });
    EXPECT_GT(measured, 50u);
    EXPECT_GT(detected, 10u);
}

TEST_F(LTERoundTripTest, CandidatesOfEveryTechnology)
{
    using Technology = ReselectionTechnology;
    const std::pair<Technology, std::pair<const char*, std::array<const char*, 2>>> keys[] {
        {Technology::LTE, {"LTE", {"E ARFCN", "Cell ID"}}},
        {Technology::UTRAN, {"UTRAN", {"U ARFCN", "PSC"}}},
        {Technology::GERAN, {"GERAN", {"ARFCN", "BSIC ID"}}},
        {Technology::CDMA1xRTT, {"CDMA1XRTT", {"Channel", "Pilot"}}},
        {Technology::CDMAHRPD, {"CDMAHRPD", {"Channel", "Pilot"}}},
    };
    std::array<int, 5> shown {};
    drive(2, [&](const LTEWorld& world) {
        const ReselectionReport report = world.idleMode().candidate();
        deliver(lteReselectionRecord(report, Time));
        EXPECT_EQ(number("Reselection Candidates", "Serving EARFCN"), report.servingChannel);
        EXPECT_EQ(number("Reselection Candidates", "Serving Cell ID"), report.servingCellId);
        const List& candidates = list("Reselection Candidates List");
        ASSERT_EQ(candidates.count(), report.candidates.size());
        if (candidates.count() == 0)
            return;
        const ReselectionCandidate& truth = report.candidates[0];
        const Dictionary& candidate = *candidates[0].dictionary();
        const auto& [name, further] = keys[static_cast<std::size_t>(truth.technology)].second;
        EXPECT_EQ(numberOf(candidate, "Candidate Priority"), truth.priority);
        EXPECT_EQ(textOf(candidate, "Candidate RAT Type"), name);
        EXPECT_EQ(numberOf(candidate, further[0]), truth.channel);
        EXPECT_EQ(numberOf(candidate, further[1]), truth.code);
        if (truth.technology >= Technology::GERAN) {
            EXPECT_EQ(numberOf(candidate, "Band"), truth.band);
        }
        ++shown[static_cast<std::size_t>(truth.technology)];
    });
    for (const int times : shown)
        EXPECT_GT(times, 0);
}

} // namespace
} // namespace spectrel
