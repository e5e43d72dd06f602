#include "Telephony/Simulator/GSMUMTS/MobilityManagement.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

constexpr Place UMTSPlace {RadioSystem::UMTS, 1201, 1};
constexpr Place OtherUMTSPlace {RadioSystem::UMTS, 1202, 2};
constexpr Place GSMPlace {RadioSystem::GSM, 1211, 11};

class MobilityManagementTest : public testing::Test {
protected:
    void pass(std::chrono::milliseconds time)
    {
        for (auto step = 0ms; step < time; step += 100ms)
            mobility.advance(100ms, inputs);
    }
    /// Gives it the connection it asks for until it is content.
    void settle()
    {
        for (int step = 0; step < 200; ++step) {
            inputs.isConnected = mobility.isSignalling() || mobility.isCalling();
            pass(100ms);
        }
    }
    void register_(const Place& place)
    {
        inputs.place = place;
        settle();
    }

    MobilityManagement::Inputs inputs;
    MobilityManagement mobility;
};

TEST_F(MobilityManagementTest, PowerOnLeadsToASearch)
{
    EXPECT_EQ(mobility.mm().state, MMState::Null);
    EXPECT_EQ(mobility.registration().state, RegistrationState::Inactive);
    pass(2s);
    EXPECT_EQ(mobility.mm(), (MMReport {MMState::Idle, MMSubState::PLMNSearch, UpdateStatus::NotUpdated}));
    EXPECT_EQ(mobility.gmm(), (GMMReport {GMMState::Deregistered, GMMSubState::PLMNSearch, UpdateStatus::NotUpdated}));
    EXPECT_EQ(mobility.registration().state, RegistrationState::AutomaticSearch);
    EXPECT_EQ(mobility.service(), ServiceType::None);
}

TEST_F(MobilityManagementTest, LocationUpdateWaitsForAConnection)
{
    inputs.place = UMTSPlace;
    pass(5s);
    EXPECT_EQ(mobility.mm().state, MMState::WaitForRRConnectionToUpdate);
    EXPECT_EQ(mobility.registration(), (RegistrationReport {RegistrationState::Registering, PLMNSelection::Limited}));
    EXPECT_EQ(mobility.service(), ServiceType::Limited);
    inputs.isConnected = true;
    pass(100ms);
    EXPECT_EQ(mobility.mm().state, MMState::LocationUpdateInitiated);
}

TEST_F(MobilityManagementTest, LostConnectionBeginsTheLocationUpdateAnew)
{
    inputs.place = UMTSPlace;
    inputs.isConnected = true;
    pass(1600ms);
    ASSERT_EQ(mobility.mm().state, MMState::LocationUpdateInitiated);
    inputs.isConnected = false;
    pass(100ms);
    EXPECT_EQ(mobility.mm(), (MMReport {MMState::Idle, MMSubState::LocationUpdateNeeded, UpdateStatus::NotUpdated}));
}

TEST_F(MobilityManagementTest, AttachFollowsTheLocationUpdate)
{
    inputs.place = UMTSPlace;
    inputs.isConnected = true;
    while (mobility.mm().status == UpdateStatus::NotUpdated) {
        pass(100ms);
        ASSERT_EQ(mobility.gmm().status, UpdateStatus::NotUpdated);
    }
    EXPECT_EQ(mobility.service(), ServiceType::CircuitOnly);
    settle();
    EXPECT_EQ(mobility.mm(), (MMReport {MMState::Idle, MMSubState::NormalService, UpdateStatus::Updated}));
    EXPECT_EQ(mobility.gmm(), (GMMReport {GMMState::Registered, GMMSubState::NormalService, UpdateStatus::Updated}));
    EXPECT_EQ(mobility.service(), ServiceType::CircuitAndPacket);
    EXPECT_TRUE(mobility.isAttached());
    EXPECT_EQ(mobility.knownLocation(), UMTSPlace);
    EXPECT_EQ(mobility.knownRouting(), UMTSPlace);
}

TEST_F(MobilityManagementTest, NewAreaIsUpdatedFirstForCallsThenForPackets)
{
    register_(UMTSPlace);
    inputs.place = OtherUMTSPlace;
    inputs.isConnected = false;
    pass(100ms);
    EXPECT_EQ(mobility.mm().subState, MMSubState::LocationUpdateNeeded);
    EXPECT_EQ(mobility.gmm().subState, GMMSubState::UpdateNeeded);
    pass(1s);
    EXPECT_EQ(mobility.mm().state, MMState::WaitForRRConnectionToUpdate);
    EXPECT_EQ(mobility.gmm().state, GMMState::Registered);
    while (mobility.gmm().state == GMMState::Registered) {
        inputs.isConnected = mobility.isSignalling();
        pass(100ms);
    }
    EXPECT_EQ(mobility.gmm().state, GMMState::RoutingAreaUpdateInitiated);
    EXPECT_EQ(mobility.knownLocation(), OtherUMTSPlace);
    settle();
    EXPECT_EQ(mobility.knownRouting(), OtherUMTSPlace);
}

TEST_F(MobilityManagementTest, CallRunsThroughItsStates)
{
    register_(UMTSPlace);
    inputs.wantsCall = true;
    inputs.isConnected = false;
    pass(1s);
    EXPECT_EQ(mobility.mm().state, MMState::WaitForRRConnectionToCall);
    EXPECT_TRUE(mobility.isCalling());
    inputs.isConnected = true;
    pass(100ms);
    EXPECT_EQ(mobility.mm().state, MMState::WaitForOutgoingConnection);
    pass(1s);
    EXPECT_EQ(mobility.mm().state, MMState::ConnectionActive);
    inputs.wantsCall = false;
    pass(100ms);
    EXPECT_EQ(mobility.mm().state, MMState::WaitForNetworkCommand);
    pass(1s);
    EXPECT_EQ(mobility.mm().state, MMState::Idle);
}

TEST_F(MobilityManagementTest, TransferOnUMTSAsksForServiceFirst)
{
    register_(UMTSPlace);
    inputs.wantsTransfer = true;
    inputs.isConnected = false;
    pass(100ms);
    EXPECT_EQ(mobility.gmm().state, GMMState::ServiceRequestInitiated);
    EXPECT_FALSE(mobility.mayTransfer());
    inputs.isConnected = true;
    pass(500ms);
    EXPECT_EQ(mobility.gmm().state, GMMState::Registered);
    EXPECT_TRUE(mobility.mayTransfer());
}

TEST_F(MobilityManagementTest, CallOnGSMSuspendsPackets)
{
    register_(GSMPlace);
    EXPECT_TRUE(mobility.mayTransfer()) << "without a service request";
    inputs.wantsCall = true;
    settle();
    EXPECT_EQ(mobility.gmm().subState, GMMSubState::Suspended);
    EXPECT_EQ(mobility.service(), ServiceType::CircuitOnly);
    EXPECT_FALSE(mobility.mayTransfer());
    inputs.wantsCall = false;
    settle();
    EXPECT_EQ(mobility.gmm().subState, GMMSubState::NormalService);
}

TEST_F(MobilityManagementTest, LostCoverageKeepsTheRegistration)
{
    register_(UMTSPlace);
    inputs.place = {};
    pass(1s);
    EXPECT_EQ(mobility.mm(), (MMReport {MMState::Idle, MMSubState::NoCellAvailable, UpdateStatus::Updated}));
    EXPECT_EQ(mobility.gmm().subState, GMMSubState::NoCellAvailable);
    EXPECT_EQ(mobility.service(), ServiceType::None);
    register_(UMTSPlace);
    EXPECT_EQ(mobility.mm().subState, MMSubState::NormalService);
}

TEST_F(MobilityManagementTest, RejectedPhoneHasLimitedServiceUntilItComesToAnotherArea)
{
    register_(UMTSPlace);
    inputs.isRejected = true;
    register_(OtherUMTSPlace);
    EXPECT_EQ(mobility.mm(), (MMReport {MMState::Idle, MMSubState::LimitedService, UpdateStatus::AreaNotAllowed}));
    EXPECT_EQ(mobility.gmm(),
        (GMMReport {GMMState::Deregistered, GMMSubState::LimitedService, UpdateStatus::AreaNotAllowed}));
    EXPECT_EQ(mobility.service(), ServiceType::Limited);
    EXPECT_EQ(mobility.registration(), (RegistrationReport {RegistrationState::Idle, PLMNSelection::Limited}));
    EXPECT_FALSE(mobility.isSignalling()) << "it does not ask again";
    inputs.isRejected = false;
    register_(GSMPlace);
    EXPECT_EQ(mobility.mm(), (MMReport {MMState::Idle, MMSubState::NormalService, UpdateStatus::Updated}));
    EXPECT_EQ(mobility.gmm().status, UpdateStatus::Updated);
}

TEST_F(MobilityManagementTest, LostCellEndsACall)
{
    register_(UMTSPlace);
    inputs.wantsCall = true;
    settle();
    EXPECT_EQ(mobility.mm().state, MMState::ConnectionActive);
    inputs.place = {};
    pass(100ms);
    EXPECT_EQ(mobility.mm(), (MMReport {MMState::Idle, MMSubState::NoCellAvailable, UpdateStatus::Updated}));
}

} // namespace
} // namespace spectrel
