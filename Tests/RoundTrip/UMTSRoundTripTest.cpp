#include "Telephony/Encoders/GSMUMTSPropertyLists.h"
#include "Telephony/Encoders/UMTSRecords.h"
#include "Tests/RoundTrip/GSMUMTSRoundTrip.h"

#include <cmath>

namespace spectrel {
namespace {

class UMTSRoundTripTest : public GSMUMTSRoundTrip {
protected:
    void expectActiveCell(const UMTSCell& cell, const Dictionary& shownCell)
    {
        EXPECT_EQ(text(shownCell, "Scrambling Code"), std::to_string(cell.scramblingCode));
        const std::string ecno = text(shownCell, "Energy Per Chip");
        EXPECT_EQ(unit(ecno), "dB");
        EXPECT_NEAR(number(ecno), cell.ecno - 0.7, 0.75) << "rounded down, by rungs that drift at the lower end";
        const std::string rscp = text(shownCell, "RSCP");
        EXPECT_EQ(unit(rscp), "dB");
        EXPECT_NEAR(number(rscp), cell.rscp - 1.2, 1.3) << "the carrier's level and the ratio, each rounded down";
    }
    void expectRanked(const RankedUMTSCell& cell, const Dictionary& shownCell)
    {
        EXPECT_EQ(text(shownCell, "Scrambling Code"), std::to_string(cell.scramblingCode));
        EXPECT_EQ(text(shownCell, "Downlink Frequency"), std::to_string(cell.downlinkChannel));
        EXPECT_EQ(text(shownCell, "RSCP"), std::to_string(std::lround(cell.rscp)) + " dB");
        EXPECT_EQ(text(shownCell, "Rank Cell RSCP"), std::to_string(std::lround(cell.rankedRscp)) + " dB");
        EXPECT_EQ(text(shownCell, "Ranking Value"), std::to_string(std::lround(cell.rank)));
        EXPECT_NEAR(number(text(shownCell, "Energy Per Chip")), cell.ecno, 0.26);
        EXPECT_EQ(unit(text(shownCell, "Energy Per Chip")), "dB");
    }
};

TEST_F(UMTSRoundTripTest, ActiveSetShowsItsCellsWithTheServingOneFirst)
{
    for (std::uint32_t seed = 1; seed <= 3; ++seed) {
        drive(seed, 8, [&](const GSMUMTSWorld& world) {
            deliver(cellSetsRecord(world.umts().cellSets(), Now));
            const auto active = world.umts().activeSet();
            ASSERT_EQ(list("Active Set").count(), active.size());
            for (std::size_t cell = 0; cell < active.size(); ++cell)
                expectActiveCell(*active[cell], entry("Active Set", cell));
            if (world.now().umtsCell) {
                EXPECT_EQ(
                    number(text(entry("Active Set", 0), "Scrambling Code")), world.now().umtsCell->scramblingCode);
            }
            for (const char* set : {"Monitored Set", "Detected Set", "Virtual Active Set"})
                EXPECT_EQ(list(set).count(), 0u) << set;
        });
    }
}

TEST_F(UMTSRoundTripTest, RankedNeighboursShowTheirLevels)
{
    drive(6, 8, [&](const GSMUMTSWorld& world) {
        const RankingReport ranking = world.ranking();
        deliver(rankingRecord(ranking, Now));
        ASSERT_EQ(list("UMTS Set").count(), ranking.umts.size());
        for (std::size_t cell = 0; cell < ranking.umts.size(); ++cell)
            expectRanked(ranking.umts[cell], entry("UMTS Set", cell));
    });
}

TEST_F(UMTSRoundTripTest, RankedGSMNeighboursShowTheirLevelsWhereNoUMTSCellIsReported)
{
    std::size_t reported = 0;
    for (std::uint32_t seed = 1; seed <= 6; ++seed) {
        drive(seed, 6, [&](const GSMUMTSWorld& world) {
            const RankingReport ranking = world.ranking();
            deliver(rankingRecord(ranking, Now));
            ASSERT_EQ(list("GSM Set").count(), ranking.gsm.size());
            for (std::size_t index = 0; index < ranking.gsm.size() && ranking.umts.empty(); ++index, ++reported) {
                const RankedGSMCell& cell = ranking.gsm[index];
                const Dictionary& shownCell = entry("GSM Set", index);
                EXPECT_EQ(text(shownCell, "ARFCN"), std::to_string(cell.arfcn));
                EXPECT_EQ(text(shownCell, "BSIC"), std::to_string(cell.bsic));
                EXPECT_EQ(text(shownCell, "RSSI"), std::to_string(std::lround(cell.rssi)) + " dBm");
                EXPECT_EQ(text(shownCell, "Ranking Value"), std::to_string(std::lround(cell.rank)));
            }
        });
    }
    EXPECT_GT(reported, 0u);
}

TEST_F(UMTSRoundTripTest, GSMNeighboursBehindUMTSCellsShowTheBytesOfThose)
{
    RankingReport ranking;
    ranking.umts = {{10612, 200, -95, -95, -12, -95}};
    ranking.gsm = {{62, 21, -70, -77}};
    deliver(rankingRecord(ranking, Now));
    expectRanked(ranking.umts[0], entry("UMTS Set", 0));
    EXPECT_EQ(displayText(section("GSM Set")),
        "[{\"ARFCN\": \"10612\", \"BSIC\": \"200\", \"RSSI\": \"-74 dBm\", \"Ranking Value\": \"-95\"}]");
}

TEST_F(UMTSRoundTripTest, ConnectionShowsItsStateCellAndCiphering)
{
    constexpr std::array<const char*, 6> Names {
        "Disconnected", "Connecting", "CELL_FACH", "CELL_DCH", "CELL_PCH", "URA_PCH"};
    drive(2, 8, [&](const GSMUMTSWorld& world) {
        const Situation& now = world.now();
        deliver(rrcStateRecord(now.rrc, Now));
        deliver(cipheringRecord(now.isCiphering, Now));
        EXPECT_EQ(shown("UMTS RR Info", "RRC State"), Names.at(static_cast<std::size_t>(now.rrc)));
        EXPECT_EQ(shown("UMTS RR Info", "Ciphering"), now.isCiphering ? "Enabled" : "Disabled");
        if (!now.umtsCell)
            return;
        deliver(umtsServingCellRecord(*now.umtsCell, Now));
        EXPECT_EQ(shown("UMTS RR Info", "Cell ID"), std::to_string(now.umtsCell->identity));
        EXPECT_EQ(shown("UMTS RR Info", "Downlink Frequency"), std::to_string(now.umtsCell->downlinkChannel));
        EXPECT_EQ(shown("UMTS RR Info", "Uplink Frequency"), std::to_string(now.umtsCell->uplinkChannel));
        EXPECT_EQ(shown("UMTS RR Info", "URA ID"), std::to_string(now.umtsCell->registrationArea));
    });
}

TEST_F(UMTSRoundTripTest, TransmitPowerShowsTheMeanOfItsSamples)
{
    drive(2, 8, [&](const GSMUMTSWorld& world) {
        double sum = 0;
        double samples = 0;
        for (const auto& power : world.traffic().powers()) {
            sum += power.value_or(0);
            samples += power ? 1 : 0;
        }
        deliver(transmitPowerRecord(world.traffic().powers(), Now));
        const std::string power = shown("UMTS RR Info", "Transmit Power");
        EXPECT_TRUE(power.ends_with(" dBm")) << power;
        if (samples > 0) {
            EXPECT_NEAR(number(power), sum / samples, 1.01) << "each sample is cut to whole dBm towards -70 or up";
        } else {
            EXPECT_NE(power.find("nan"), std::string::npos) << power;
        }
    });
}

TEST_F(UMTSRoundTripTest, BlockErrorsShowEachChannelsCounts)
{
    drive(2, 8, [&](const GSMUMTSWorld& world) {
        const BlockErrorReport& blocks = world.traffic().blocks();
        deliver(blockErrorRecord(blocks, Now));
        EXPECT_EQ(shown("BLER", "Window Size"), "100");
        ASSERT_EQ(list("Transport Channels").count(), blocks.channels.size());
        for (std::size_t index = 0; index < blocks.channels.size(); ++index) {
            const Dictionary& channel = entry("Transport Channels", index);
            EXPECT_EQ(text(channel, "Transport Channel ID"), std::to_string(blocks.channels[index].identity));
            EXPECT_EQ(text(channel, "CRC Received"), std::to_string(blocks.channels[index].received));
            EXPECT_EQ(text(channel, "CRC Received in Error"), std::to_string(blocks.channels[index].wrong));
        }
    });
}

TEST_F(UMTSRoundTripTest, HSDPAShowsBothCarriersProcesses)
{
    const auto expectProcesses = [this](const char* name, const std::vector<HARQProcess>& processes) {
        if (processes.empty())
            return; // what was shown stays
        ASSERT_EQ(list(name).count(), processes.size());
        for (std::size_t index = 0; index < processes.size(); ++index) {
            EXPECT_EQ(text(entry(name, index), "Process ID"), std::to_string(processes[index].identity));
            EXPECT_EQ(text(entry(name, index), "No Rx Bits"), std::to_string(processes[index].bits));
            EXPECT_EQ(text(entry(name, index), "New Tx"), std::to_string(processes[index].newTransmissions));
            EXPECT_EQ(text(entry(name, index), "Block Errors"), std::to_string(processes[index].blockErrors));
        }
    };
    constexpr std::array<const char*, 3> Carriers {"Single Carrier", "MIMO", "Dual Carrier"};
    std::set<std::string> seen;
    for (std::uint32_t seed = 1; seed <= 3; ++seed) {
        drive(seed, 8, [&](const GSMUMTSWorld& world) {
            const HSDPAReport& hsdpa = world.traffic().hsdpa();
            deliver(hsdpaRecord(hsdpa, Now));
            EXPECT_EQ(shown("HSDPA Info", "Sub Frames"), std::to_string(hsdpa.subFrames));
            EXPECT_EQ(shown("HSDPA Info", "Carrier Info"), Carriers.at(static_cast<std::size_t>(hsdpa.carriers)));
            expectProcesses("Primary HARQ Process", hsdpa.primary);
            expectProcesses("Secondary HARQ Process", hsdpa.secondary);
            seen.insert(shown("HSDPA Info", "Carrier Info"));
        });
    }
    EXPECT_EQ(seen.size(), Carriers.size());
}

TEST_F(UMTSRoundTripTest, CellInformationShowsTheServingCellAndItsNeighbours)
{
    drive(1, 8, [&](const GSMUMTSWorld& world) {
        deliver(gsmumtsCellInformationRecord(world.cellInformation(), Now));
        if (const UMTSCell* cell = world.now().umtsCell) {
            EXPECT_EQ(shown("UMTS RR Info", "Cell ID"), std::to_string(cell->identity));
            EXPECT_EQ(shown("UMTS RR Info", "UARFCN"), std::to_string(cell->downlinkChannel));
            EXPECT_EQ(shown("UMTS RR Info", "Scrambling Code"), std::to_string(cell->scramblingCode));
            EXPECT_EQ(shown("Serving PLMN", "Location Area Code"), std::to_string(cell->locationArea));
            EXPECT_EQ(shown("Serving PLMN", "Mobile Country Code"), "1");
            EXPECT_EQ(shown("Serving PLMN", "Mobile Network Code"), "1");
        }
        const auto neighbours = world.umts().ranking();
        ASSERT_EQ(list("UMTS Set").count(), world.system() == RadioSystem::None ? 0 : neighbours.size());
        for (std::size_t index = 0; index < list("UMTS Set").count(); ++index) {
            const RankedUMTSCell& cell = neighbours[index];
            const Dictionary& shownCell = entry("UMTS Set", index);
            const auto level = [&cell](double value, const char* suffix) {
                return cell.isMeasured ? std::to_string(std::lround(value)) + suffix : "";
            };
            EXPECT_EQ(text(shownCell, "UARFCN"), std::to_string(cell.downlinkChannel));
            EXPECT_EQ(text(shownCell, "Scrambling Code"), std::to_string(cell.scramblingCode));
            EXPECT_EQ(text(shownCell, "RSCP"), level(cell.rscp, " dBm"));
            EXPECT_EQ(text(shownCell, "Energy Per Chip"), level(cell.ecno, " dB"));
        }
    });
}

} // namespace
} // namespace spectrel
