#include "Telephony/Encoders/GPRSRecords.h"
#include "Telephony/Encoders/GSMRecords.h"
#include "Telephony/Encoders/GSMUMTSPropertyLists.h"
#include "Tests/RoundTrip/GSMUMTSRoundTrip.h"

#include <cmath>
#include <map>
#include <set>

namespace spectrel {
namespace {

class GSMRoundTripTest : public GSMUMTSRoundTrip {
protected:
    /// Some drives, as far as they are on GSM.
    template <typename Look> static void driveOnGSM(Look look)
    {
        for (std::uint32_t seed = 1; seed <= 6; ++seed) {
            drive(seed, 8, [&look](const GSMUMTSWorld& world) {
                if (world.system() == RadioSystem::GSM)
                    look(world);
            });
        }
    }
};

TEST_F(GSMRoundTripTest, ServingCellShowsItsIdentity)
{
    std::set<std::string> cells;
    driveOnGSM([&](const GSMUMTSWorld& world) {
        const GSMCell& cell = *world.now().gsmCell;
        deliver(gsmServingCellRecord(cell, Now));
        EXPECT_EQ(shown("GSM Serving Cell", "Cell ID"), std::to_string(cell.identity));
        EXPECT_EQ(shown("GSM Serving Cell", "ARFCN"), std::to_string(cell.arfcn));
        EXPECT_EQ(shown("GSM Serving Cell", "BSIC"), std::to_string(cell.bsic));
        cells.insert(shown("GSM Serving Cell", "Cell ID"));
    });
    EXPECT_GE(cells.size(), 3u);
}

TEST_F(GSMRoundTripTest, OneFieldShowsAsCriterionAndAsQuality)
{
    std::set<bool> modes;
    driveOnGSM([&](const GSMUMTSWorld& world) {
        const GSMMeasurement measured = world.gsm().measurement();
        deliver(gsmMeasurementRecord(measured, Now));
        const std::string level = std::to_string(measured.rxLevel);
        const std::string first = std::to_string(measured.isDedicated ? measured.fullQuality : measured.c1);
        const std::string second = std::to_string(measured.isDedicated ? measured.subQuality : measured.c2);
        EXPECT_EQ(shown("GSM Serving Cell", "RSSI"), level + " dBm");
        EXPECT_EQ(shown("GSM RR Info", "Serving Rx Level"), level);
        EXPECT_NEAR(measured.rxLevel - 110, world.now().gsmCell->rssi, measured.rxLevel == 63 ? 30 : 0.51);
        EXPECT_EQ(shown("GSM Serving Cell", "C1 Value"), first);
        EXPECT_EQ(shown("GSM Serving Cell", "C2 Value"), second);
        EXPECT_EQ(shown("GSM RR Info", "Rx Quality Full"), first);
        EXPECT_EQ(shown("GSM RR Info", "Rx Quality Sub"), second);
        EXPECT_EQ(
            shown("GPRS Information", "Cell Reselect Hysteresis"), world.now().hasSession ? "Applied" : "Not Applied");
        modes.insert(measured.isDedicated);
    });
    EXPECT_EQ(modes.size(), 2u);
}

TEST_F(GSMRoundTripTest, NeighboursShowTheColourOfTheCellsThatAreIdentified)
{
    std::set<bool> known;
    driveOnGSM([&](const GSMUMTSWorld& world) {
        const GSMMeasurement measured = world.gsm().measurement();
        std::map<std::uint16_t, std::string> colours;
        for (const IdentifiedGSMCell& cell : world.gsm().identified())
            colours[cell.arfcn] = std::to_string(cell.bsic);
        deliver(neighbourIdentitiesRecord(world.gsm().identified(), Now));
        deliver(gsmMeasurementRecord(measured, Now));
        ASSERT_EQ(list("Neighboring Cells").count(), measured.neighbours.size());
        for (std::size_t index = 0; index < measured.neighbours.size(); ++index) {
            const auto& neighbour = measured.neighbours[index];
            const Dictionary& shownCell = entry("Neighboring Cells", index);
            EXPECT_EQ(text(shownCell, "ARFCN"), std::to_string(neighbour.arfcn));
            EXPECT_EQ(text(shownCell, "RSSI"), std::to_string(neighbour.rxLevel));
            EXPECT_EQ(text(shownCell, "C1 Value"), std::to_string(neighbour.c1));
            const bool isKnown = colours.contains(neighbour.arfcn);
            EXPECT_EQ(text(shownCell, "BSIC"), isKnown ? colours[neighbour.arfcn] : "none");
            known.insert(isKnown);
        }
    });
    EXPECT_EQ(known.size(), 2u);
}

TEST_F(GSMRoundTripTest, StatesShowByTheirNames)
{
    const std::map<RRState, std::string> names {{RRState::Inactive, "RR_INACTIVE"},
        {RRState::CellSelection, "RR_CELL_SELECTION"}, {RRState::PLMNListConstruction, "RR_PLMN_LIST_CONSTRUCTION"},
        {RRState::Idle, "RR_IDLE"}, {RRState::CellReselection, "RR_CELL_RESELECTION"},
        {RRState::ConnectionPending, "RR_CONNECTION_PENDING"}, {RRState::DataTransfer, "RR_DATA_TRANSFER"},
        {RRState::ConnectionRelease, "RR_CONNECTION_RELEASE"},
        {RRState::FromUMTSByHandover, "RR_W2G_INTERRAT_HANDOVER_ PROGRESS"},
        {RRState::FromUMTSByReselection, "RR_W2G_INTERRAT_RESELECTION_PROGRESS"},
        {RRState::ToUMTSByReselection, "RR_G2W_INTERRAT_RESELECTION_PROGRESS"},
        {RRState::ToUMTSByHandover, "RR_G2W_INTERRAT_HANDOVER_ PROGRESS"},
        {RRState::FromUMTSByOrder, "RR_W2G_INTERRAT_CC_ORDER_ PROGRESS"}};
    driveOnGSM([&](const GSMUMTSWorld& world) {
        const RRReport& rr = world.now().rr;
        deliver(rrStateRecord(rr, Now));
        EXPECT_EQ(shown("GSM RR Info", "RR State"), names.at(rr.state));
        EXPECT_EQ(shown("GSM RR Info", "RR Sub State"), std::to_string(rr.subState));
        EXPECT_EQ(shown("GSM RR Info", "RR Status"), std::to_string(rr.status));
        EXPECT_EQ(shown("GSM RR Info", "RR Mode"), rr.isData ? "Data" : "Voice");
    });
}

TEST_F(GSMRoundTripTest, DedicatedChannelShowsItsFrequenciesAndTransmission)
{
    std::set<bool> wide;
    std::set<bool> hopping;
    driveOnGSM([&](const GSMUMTSWorld& world) {
        deliver(dtxRecord(world.now().usesDTX, Now));
        EXPECT_EQ(shown("GSM RR Info", "DTX Used"), world.now().usesDTX ? "ON" : "OFF");
        const HoppingReport hops = world.gsm().hopping();
        deliver(mobileAllocationRecord(hops, Now));
        EXPECT_EQ(shown("Mobile Allocation", "HSN"), std::to_string(hops.sequenceNumber));
        ASSERT_EQ(list("ARFCNs").count(), hops.arfcns.size());
        for (std::size_t hop = 0; hop < hops.arfcns.size(); ++hop)
            EXPECT_EQ(list("ARFCNs")[hop], Value(std::to_string(hops.arfcns[hop])));
        hopping.insert(!hops.arfcns.empty());
        const std::uint16_t arfcn = world.gsm().dedicatedArfcn();
        deliver(dedicatedChannelRecord(arfcn, Now));
        EXPECT_EQ(shown("GSM Serving Cell", "MA Dedicated ARFCN"), std::to_string(arfcn % 256)) << "its low byte";
        wide.insert(arfcn > 255);
    });
    EXPECT_EQ(hopping.size(), 2u);
    EXPECT_EQ(wide.size(), 2u) << "both bands";
}

TEST_F(GSMRoundTripTest, ParametersOfTheCellShowOnceTheyHaveBeenRead)
{
    std::set<std::string> positions;
    const auto expectFlag = [this](const char* key, bool flag, const char* yes, const char* no) {
        EXPECT_EQ(shown("GPRS Information", key), flag ? yes : no) << key;
    };
    driveOnGSM([&](const GSMUMTSWorld& world) {
        const GPRSParameters gprs = world.gsm().gprs();
        deliver(gprsSystemInformationRecord(gprs, Now));
        deliver(gprsAccessRecord(gprs, Now));
        deliver(gprsTimersRecord(gprs, Now));
        deliver(gprsBroadcastRecord(gprs, Now));
        deliver(gprsStatusRecord(gprs, Now));
        const bool isRead = gprs.si13Position != 255;
        if (isRead) {
            expectFlag("SI13 Position", gprs.si13Position == 0, "Located on BCCH", "Located on Extended BCCH");
            expectFlag("Network Control Order", gprs.networkControlOrder == 0, "NC0", "NC2");
            expectFlag("PFC Supported", gprs.packetFlowContexts == 1, "Supported", "Not Supported");
            expectFlag("Priority Access Threshold", gprs.priorityAccessThreshold == 7, "Allowed", "1 to 4");
        } else {
            for (const char* key : {"SI13 Position", "Network Control Order", "Priority Access Threshold"})
                EXPECT_EQ(shown("GPRS Information", key), "Not Available");
            EXPECT_EQ(shown("GPRS Information", "PFC Supported"), "Available");
        }
        EXPECT_EQ(shown("GPRS Information", "T3192"), gprs.t3192 == 0 ? "500 ms" : "1000 ms");
        EXPECT_EQ(shown("GPRS Information", "DRX Timer Max"), std::to_string(gprs.drxTimerMax));
        EXPECT_EQ(shown("GSM RR Info", "DRX Used"), std::to_string(gprs.drxTimerMax) + " sec");
        expectFlag("Access Burst Type", gprs.elevenBitAccessBursts, "11-bit format", "8-bit format");
        expectFlag("PBCCH Present", gprs.hasPBCCH, "1", "0");
        expectFlag("Packet SI Status", gprs.packetSIStatus, "Supported", "Not Supported");
        EXPECT_EQ(shown("GPRS Information", "Packet PSI Status"), std::to_string(gprs.psiStatus));
        EXPECT_EQ(shown("GPRS Information", "Count LR"), std::to_string(gprs.countLR));
        EXPECT_EQ(shown("GPRS Information", "Count HR"), std::to_string(gprs.countHR));
        EXPECT_EQ(shown("GPRS Information", "Ext Measurement Order"), std::to_string(gprs.extendedMeasurementOrder));
        positions.insert(shown("GPRS Information", "SI13 Position"));
    });
    EXPECT_EQ(positions.size(), 3u);
}

TEST_F(GSMRoundTripTest, CellInformationShowsTheServingCellAndItsNeighbours)
{
    for (std::uint32_t seed = 1; seed <= 2; ++seed) {
        drive(seed, 8, [&](const GSMUMTSWorld& world) {
            deliver(gsmumtsCellInformationRecord(world.cellInformation(), Now));
            if (const GSMCell* cell = world.now().gsmCell) {
                EXPECT_EQ(shown("GSM Serving Cell", "Cell ID"), std::to_string(cell->identity));
                EXPECT_EQ(shown("GSM Serving Cell", "ARFCN"), std::to_string(cell->arfcn));
                EXPECT_EQ(shown("Serving PLMN", "Location Area Code"), std::to_string(cell->locationArea));
            }
            const auto neighbours = world.gsm().neighbours();
            ASSERT_EQ(list("Neighboring Cells").count(), world.system() == RadioSystem::None ? 0 : neighbours.size());
            for (std::size_t index = 0; index < list("Neighboring Cells").count(); ++index) {
                const Dictionary& shownCell = entry("Neighboring Cells", index);
                EXPECT_EQ(text(shownCell, "ARFCN"), std::to_string(neighbours[index]->arfcn));
                const std::string level = text(shownCell, "RSSI");
                if (world.measuresGSM()) {
                    EXPECT_NEAR(number(level), neighbours[index]->rssi, 1.01) << "in steps of 2 dB";
                } else {
                    EXPECT_EQ(level, "");
                }
            }
        });
    }
}

} // namespace
} // namespace spectrel
