#include "Telephony/Encoders/GSMRecords.h"
#include "Telephony/Encoders/GSMUMTSPropertyLists.h"
#include "Telephony/Encoders/MobilityRecords.h"
#include "Telephony/Encoders/UMTSRecords.h"
#include "Telephony/Encoders/UTRANRecords.h"
#include "Telephony/Reports/GSMCell.h"
#include "Telephony/Reports/UMTSCell.h"
#include "Tests/Analysis/Events/EventFixture.h"

#include <gmock/gmock.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

/// A GSM/UMTS phone.
class GSMUMTSMovesTest : public EventFixture {
protected:
    GSMUMTSMovesTest()
        : EventFixture(Technology::GSM)
    {
    }

    void serveGSM(std::uint16_t arfcn, std::uint16_t identity)
    {
        GSMCell cell;
        cell.arfcn = arfcn;
        cell.identity = identity;
        cell.bsic = 12;
        deliver(gsmServingCellRecord(cell, time));
    }
    void measureGSM(std::uint16_t arfcn, std::int32_t c1, std::uint16_t neighbour, std::int32_t neighbourC1)
    {
        GSMMeasurement measured;
        measured.arfcn = arfcn;
        measured.rxLevel = static_cast<std::uint8_t>(c1 + 6);
        measured.c1 = measured.c2 = c1;
        measured.neighbours.push_back(
            {neighbour, static_cast<std::uint8_t>(neighbourC1 + 6), neighbourC1, neighbourC1});
        deliver(gsmMeasurementRecord(measured, time));
    }
    void rr(RRState state, bool isData = false)
    {
        deliver(rrStateRecord({state, 0, 1, isData}, time));
    }
    void serveUMTS(std::uint32_t identity)
    {
        UMTSCell cell;
        cell.identity = identity;
        cell.downlinkChannel = 10612;
        cell.uplinkChannel = 9662;
        deliver(umtsServingCellRecord(cell, time));
    }
    void rrc(RRCState state)
    {
        deliver(rrcStateRecord(state, time));
    }
    /// From one GSM cell to the next in a state.
    std::string causeOnGSM(RRState state, bool isData = false)
    {
        serveGSM(20, 101);
        rr(state, isData);
        pass(1s);
        serveGSM(45, 102);
        finish();
        return causeOfMove();
    }
    std::string causeOnUMTS(RRCState state)
    {
        serveUMTS(0x0021'0001);
        rrc(state);
        pass(1s);
        serveUMTS(0x0021'0002);
        finish();
        return causeOfMove();
    }
    /// Between the systems.
    std::string causeToGSM(RRState state)
    {
        serveUMTS(0x0021'0001);
        rrc(RRCState::CellDCH);
        pass(1s);
        rr(state);
        serveGSM(45, 102);
        finish();
        return causeOfMove();
    }
    std::string causeToUMTS(RRState state)
    {
        serveGSM(45, 102);
        pass(1s);
        rr(state);
        pass(1s);
        serveUMTS(0x0021'0001);
        finish();
        return causeOfMove();
    }
};

TEST_F(GSMUMTSMovesTest, AnIdleGSMPhoneReselects)
{
    EXPECT_EQ(causeOnGSM(RRState::Idle), "reselection unknown");
}

TEST_F(GSMUMTSMovesTest, APacketTransferReselectsToo)
{
    EXPECT_EQ(causeOnGSM(RRState::DataTransfer, true), "reselection unknown");
}

TEST_F(GSMUMTSMovesTest, AGSMCallIsHandedOver)
{
    EXPECT_EQ(causeOnGSM(RRState::DataTransfer), "handover");
}

TEST_F(GSMUMTSMovesTest, TheGSMCellWithTheHigherC2IsTaken)
{
    serveGSM(20, 101);
    rr(RRState::Idle);
    for (int count = 0; count < 4; ++count) {
        pass(1s);
        measureGSM(20, 20, 45, 26);
    }
    pass(1s);
    serveGSM(45, 102);
    measureGSM(45, 27, 20, 20);
    finish();
    EXPECT_EQ(causeOfMove(), "reselection equal-priority");
    EXPECT_THAT(moves()[0].cause->text, testing::HasSubstr("C2 26 over 20 dB, for 4 s"));
}

TEST_F(GSMUMTSMovesTest, AGSMCellWithALowerC2SpeaksForNoRule)
{
    serveGSM(20, 101);
    rr(RRState::Idle);
    measureGSM(20, 20, 45, 18);
    pass(1s);
    serveGSM(45, 102);
    finish();
    EXPECT_EQ(causeOfMove(), "reselection unknown");
}

TEST_F(GSMUMTSMovesTest, AGSMCellWithANegativeC1IsLeft)
{
    serveGSM(20, 101);
    rr(RRState::Idle);
    measureGSM(20, -2, 60, -3); // shown as an unsigned number
    pass(1s);
    serveGSM(45, 102);
    finish();
    EXPECT_EQ(causeOfMove(), "reselection not-suitable");
}

TEST_F(GSMUMTSMovesTest, CellsChangeInFACHAndPCHByReselection)
{
    EXPECT_EQ(causeOnUMTS(RRCState::CellFACH), "reselection unknown");
}

TEST_F(GSMUMTSMovesTest, CellsChangeInPCHByReselection)
{
    EXPECT_EQ(causeOnUMTS(RRCState::URAPCH), "reselection unknown");
}

TEST_F(GSMUMTSMovesTest, CellsChangeInDCHByHandover)
{
    EXPECT_EQ(causeOnUMTS(RRCState::CellDCH), "handover");
}

TEST_F(GSMUMTSMovesTest, TheRRStateSaysHowThePhoneCameFromUMTS)
{
    EXPECT_EQ(causeToGSM(RRState::FromUMTSByHandover), "handover");
}

TEST_F(GSMUMTSMovesTest, ACellChangeOrderIsARedirection)
{
    EXPECT_EQ(causeToGSM(RRState::FromUMTSByOrder), "redirection");
}

TEST_F(GSMUMTSMovesTest, FromUMTSByReselection)
{
    EXPECT_EQ(causeToGSM(RRState::FromUMTSByReselection), "reselection unknown");
}

TEST_F(GSMUMTSMovesTest, ToUMTSByReselectionOrHandover)
{
    EXPECT_EQ(causeToUMTS(RRState::ToUMTSByReselection), "reselection unknown");
}

TEST_F(GSMUMTSMovesTest, ToUMTSByHandover)
{
    EXPECT_EQ(causeToUMTS(RRState::ToUMTSByHandover), "handover");
}

TEST_F(GSMUMTSMovesTest, TheRegistrationOfOneMomentIsOneEvent)
{
    const auto network = [this](ServiceType service) {
        NetworkReport report;
        report.service = service;
        report.network = TestNetwork;
        report.locationArea = 1201;
        deliver(servingNetworkRecord(report, time));
    };
    network(ServiceType::CircuitAndPacket);
    pass(1s);
    network(ServiceType::Limited);
    network(ServiceType::CircuitOnly);
    pass(1s);
    network(ServiceType::CircuitOnly);
    const auto found = all(EventKind::Registration);
    ASSERT_EQ(found.size(), 1u);
    EXPECT_EQ(found[0].from, "CS_PS_SERVICE");
    EXPECT_EQ(found[0].to, "CS_ONLY");
    EXPECT_EQ(found[0].n, 1u);
}

TEST_F(GSMUMTSMovesTest, NoServiceIsLostAtOnce)
{
    serveUMTS(0x0021'0001);
    pass(1s);
    deliver(servingNetworkRecord({}, time));
    finish();
    ASSERT_EQ(all(EventKind::ServiceLost).size(), 1u);
    EXPECT_EQ(all(EventKind::ServiceLost)[0].n, 1u);
}

TEST_F(GSMUMTSMovesTest, ContextsComeAndGo)
{
    deliver(packetContextsRecord(std::nullopt, time));
    pass(11s);
    deliver(packetContextsRecord(PacketTransfer {100, 10}, time));
    pass(1s);
    deliver(packetContextsRecord(PacketTransfer {200, 20}, time));
    pass(1s);
    deliver(packetContextsRecord(std::nullopt, time));
    const auto found = all(EventKind::Context);
    ASSERT_EQ(found.size(), 2u);
    EXPECT_EQ(found[0].context, "internet.test");
    EXPECT_EQ(found[0].from, "none");
    EXPECT_EQ(found[0].to, "Active");
    EXPECT_EQ(found[1].to, "none");
}

TEST_F(GSMUMTSMovesTest, ContextsThatAreThereAtFirstDoNotCome)
{
    deliver(packetContextsRecord(std::nullopt, time));
    pass(5s);
    deliver(packetContextsRecord(PacketTransfer {100, 10}, time));
    finish();
    EXPECT_TRUE(all(EventKind::Context).empty());
}

/// A UTRAN phone.
class UTRANMovesTest : public EventFixture {
protected:
    UTRANMovesTest()
        : EventFixture(Technology::UTRAN)
    {
    }
    void serve(std::uint32_t identity, bool isInService = true)
    {
        UTRANCell cell;
        cell.identity = identity;
        cell.channel = 10054;
        deliver(utranServingCellRecord(cell, isInService, time));
    }
    void mode(RRCMode mode, bool isInService = true)
    {
        deliver(utranRRCRecord(mode, isInService, time));
    }
    std::string causeIn(RRCMode state)
    {
        mode(state);
        serve(0xC0001);
        pass(1s);
        mode(state);
        serve(0xC0002);
        finish();
        return causeOfMove();
    }
};

TEST_F(UTRANMovesTest, WithAChannelOfItsOwnThePhoneIsHandedOver)
{
    EXPECT_EQ(causeIn(RRCMode::CellDCH), "handover");
}

TEST_F(UTRANMovesTest, WithoutItReselects)
{
    EXPECT_EQ(causeIn(RRCMode::CellPCH), "reselection unknown");
}

TEST_F(UTRANMovesTest, ServiceIsLostWhereTheDisplayShowsIt)
{
    mode(RRCMode::Disconnected);
    serve(0xC0001);
    pass(1s);
    mode(RRCMode::Disconnected, false);
    serve(0xC0001, false);
    pass(3s);
    mode(RRCMode::Disconnected);
    serve(0xC0002);
    finish();
    EXPECT_EQ(all(EventKind::ServiceLost).size(), 1u);
    EXPECT_EQ(causeOfMove(), "service-lost");
    ASSERT_EQ(all(EventKind::ServiceBack).size(), 1u);
    EXPECT_EQ(all(EventKind::ServiceBack)[0].seconds, 3);
}

} // namespace
} // namespace spectrel
