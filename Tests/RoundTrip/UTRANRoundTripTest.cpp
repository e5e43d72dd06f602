// What the simulated UTRAN phone knows is what the display shows.

#include "Telephony/Encoders/UTRANRecords.h"
#include "Telephony/Simulator/UTRAN/UTRANWorld.h"
#include "Tests/RoundTrip/RoundTripFixture.h"

#include <cmath>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

class UTRANRoundTripTest : public RoundTripFixture {
protected:
    UTRANRoundTripTest()
        : RoundTripFixture(Technology::UTRAN)
    {
    }
    /// Ten minutes, a look each half second.
    template <typename Look> static void drive(std::uint32_t seed, Look look)
    {
        UTRANWorld world(Scene::Drive, seed);
        for (int step = 1; step <= 6000; ++step) {
            world.advance(100ms);
            if (step % 5 == 0)
                look(world);
        }
    }
};

TEST_F(UTRANRoundTripTest, RadioResourceControlAndAccess)
{
    const char* const names[] {"Disconnected", "Connecting", "Cell Fach", "Cell DCH", "Cell PCH", "Cell URA PCH"};
    drive(1, [&](const UTRANWorld& world) {
        const bool isInService = world.isInService();
        deliver(utranRRCRecord(world.mode(), isInService, Time));
        deliver(utranServingCellRecord(world.servingCell(), isInService, Time));
        EXPECT_EQ(text("RRC Info", "State"), isInService ? names[static_cast<int>(world.mode())] : "Unknown RRC Mode");
        EXPECT_EQ(text("Serving Cell Info", "Allowed Access"), isInService ? "All Calls" : "Emergency Calls Only");
    });
}

TEST_F(UTRANRoundTripTest, ServingCellFromBothRecords)
{
    drive(1, [this](const UTRANWorld& world) {
        const UTRANCell& cell = world.servingCell();
        deliver(utranCellInformationRecord(world.servingCell(), world.otherCells(), Time));
        EXPECT_EQ(number("Serving Cell Info", "Cell ID"), cell.identity);
        EXPECT_EQ(number("Serving Cell Info", "Local Area Code"), cell.locationArea);
        EXPECT_EQ(number("Serving Cell Info", "Cell Scrambling Code"), cell.cellParameterId);
        EXPECT_EQ(number("Serving Cell Info", "Uplink UARFCN"), cell.channel);
        deliver(utranServingCellRecord(cell, true, Time));
        EXPECT_EQ(number("Serving Cell Info", "Cell ID"), cell.identity);
        EXPECT_EQ(number("Serving Cell Info", "URA ID"), cell.registrationArea);
        EXPECT_EQ(number("Serving Cell Info", "Downlink UARFCN"), cell.channel);
    });
}

TEST_F(UTRANRoundTripTest, Neighbours)
{
    const char* const sets[] {"ASET", "MSET", "DSET"};
    std::array<int, 3> shown {};
    drive(1, [&](const UTRANWorld& world) {
        const auto truth = world.neighbours();
        deliver(utranNeighbourRecord(truth, Time));
        const List& cells = list("Neighbor Cell List");
        ASSERT_EQ(cells.count(), truth.size());
        for (std::size_t index = 0; index < cells.count(); ++index) {
            const Dictionary& cell = *cells[index].dictionary();
            EXPECT_EQ(numberOf(cell, "UARFCN"), truth[index].channel);
            EXPECT_EQ(numberOf(cell, "Cell ID"), truth[index].cellParameterId);
            EXPECT_NEAR(numberOf(cell, "Filter RSCP") * 256 - 116, truth[index].rscp, 1.01);
            EXPECT_EQ(textOf(cell, "Status"), sets[static_cast<int>(truth[index].set)]);
            EXPECT_EQ(textOf(cell, "inJDCS"), truth[index].isJointlyDetected ? "TRUE" : "FALSE");
            ++shown[static_cast<std::size_t>(truth[index].set)];
        }
    });
    for (const int times : shown)
        EXPECT_GT(times, 0);
}

TEST_F(UTRANRoundTripTest, GSMNeighbours)
{
    drive(1, [this](const UTRANWorld& world) {
        const auto truth = world.gsmNeighbours();
        deliver(utranGSMNeighbourRecord(truth, Time));
        const List& cells = list("GSM Neighbor Cell List");
        ASSERT_EQ(cells.count(), truth.size());
        for (std::size_t index = 0; index < cells.count(); ++index) {
            const Dictionary& cell = *cells[index].dictionary();
            EXPECT_EQ(numberOf(cell, "Cell ID"), truth[index].identity);
            EXPECT_EQ(numberOf(cell, "Band Indicator"), truth[index].isPCSBand ? 1 : 0);
            EXPECT_EQ(numberOf(cell, "NCC"), truth[index].networkColour);
            EXPECT_EQ(numberOf(cell, "BCC"), truth[index].stationColour);
            EXPECT_EQ(numberOf(cell, "ARFCN"), truth[index].channel);
            EXPECT_EQ(numberOf(cell, "RSSI"), std::trunc(truth[index].rssi));
        }
    });
}

TEST_F(UTRANRoundTripTest, TransportChannels)
{
    int shown = 0;
    drive(1, [&](const UTRANWorld& world) {
        const TransportReport truth = world.transportChannels();
        deliver(utranTransportChannelRecord(truth, Time));
        const List& channels = list("TRCH BLER");
        ASSERT_EQ(channels.count(), truth.channels.size());
        for (std::size_t index = 0; index < channels.count(); ++index, ++shown) {
            EXPECT_EQ(numberOf(*channels[index].dictionary(), "TRCH ID"), truth.channels[index].number);
            EXPECT_EQ(
                numberOf(*channels[index].dictionary(), "TRCH BLER Measurement"), truth.channels[index].blockErrors);
        }
        const List& composites = list("CCTRCH SIR");
        ASSERT_EQ(composites.count(), truth.composites.size());
        for (std::size_t index = 0; index < composites.count(); ++index) {
            const Dictionary& composite = *composites[index].dictionary();
            EXPECT_EQ(numberOf(composite, "CCTRCH ID"), truth.composites[index].number);
            EXPECT_EQ(numberOf(composite, "TSNUM"), truth.composites[index].slots);
            const List& ratios = *composite["SIR"].list();
            ASSERT_EQ(ratios.count(), 6u);
            for (std::size_t slot = 0; slot < 6; ++slot)
                EXPECT_EQ(*ratios[slot].string(), std::to_string(truth.composites[index].signalToInterference[slot]));
        }
    });
    EXPECT_GT(shown, 100);
}

} // namespace
} // namespace spectrel
