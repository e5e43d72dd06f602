#include "Telephony/Encoders/GSMUMTSPropertyLists.h"
#include "Telephony/Encoders/MobilityRecords.h"
#include "Tests/RoundTrip/GSMUMTSRoundTrip.h"

#include <map>

namespace spectrel {
namespace {

class MobilityRoundTripTest : public GSMUMTSRoundTrip { };

const std::map<MMState, std::string> MMNames {{MMState::Null, "MM_NULL"},
    {MMState::LocationUpdateInitiated, "MM_LOCATION_UPDATE_INITIATED"},
    {MMState::WaitForOutgoingConnection, "MM_WAIT_FOR_OUTGOING_MM_CONNECTION"},
    {MMState::ConnectionActive, "MM_CONNECTION_ACTIVE"},
    {MMState::WaitForNetworkCommand, "MM_WAIT_FOR_NETWORK_COMMAND"},
    {MMState::WaitForRRConnectionToUpdate, "MM_WAIT_FOR_RR_CONNECTION_LU"},
    {MMState::WaitForRRConnectionToCall, "MM_WAIT_FOR_RR_CONNECTION_MM"}, {MMState::Idle, "MM_IDLE"}};

const std::map<MMSubState, std::string> MMSubNames {{MMSubState::None, "MM_NULL_SUBSTATE"},
    {MMSubState::PLMNSearch, "MM_PLMN_SEARCH"}, {MMSubState::LocationUpdateNeeded, "MM_LOCATION_UPDATE_NEEDED"},
    {MMSubState::NoCellAvailable, "MM_NO_CELL_AVAILABLE"}, {MMSubState::NormalService, "MM_NORMAL_SERVICE"}};

const std::map<GMMState, std::string> GMMNames {{GMMState::Null, "GMM_NULL"},
    {GMMState::Deregistered, "GMM_DEREGISTERED"}, {GMMState::RegisteredInitiated, "GMM_REGISTERED_INITIATED"},
    {GMMState::Registered, "GMM_REGISTERED"},
    {GMMState::RoutingAreaUpdateInitiated, "GMM_ROUTING_AREA_UPDATE_INITIATED"},
    {GMMState::ServiceRequestInitiated, "GMM_SERVICE_REQUEST_INITIATED"}};

const std::map<GMMSubState, std::string> GMMSubNames {{GMMSubState::NormalService, "GMM_NORMAL_SERVICE"},
    {GMMSubState::AttachNeeded, "GMM_ATTACH_NEEDED"}, {GMMSubState::NoCellAvailable, "GMM_NO_CELL_AVAILABLE"},
    {GMMSubState::PLMNSearch, "GMM_PLMN_SEARCH"}, {GMMSubState::Suspended, "GMM_SUSPENDED"},
    {GMMSubState::UpdateNeeded, "GMM_UPDATE_NEEDED"}, {GMMSubState::None, "GMM_NULL_SUBSTATE"}};

const std::map<RegistrationState, std::string> RegistrationNames {{RegistrationState::Inactive, "REG_STATE_INACTIVE"},
    {RegistrationState::Idle, "REG_STATE_IDLE"}, {RegistrationState::Registering, "REG_STATE_REGISTERING"},
    {RegistrationState::AutomaticSearch, "REG_STATE_AUTOMATIC_SEARCH"}};

const std::map<ServiceType, std::string> ServiceNames {{ServiceType::None, "NO_SERVICE"},
    {ServiceType::CircuitOnly, "CS_ONLY"}, {ServiceType::CircuitAndPacket, "CS_PS_SERVICE"},
    {ServiceType::Limited, "LIMITED_SERVICE"}};

TEST_F(MobilityRoundTripTest, StatesShowByTheirNames)
{
    for (std::uint32_t seed = 1; seed <= 3; ++seed) {
        drive(seed, 8, [&](const GSMUMTSWorld& world) {
            const Situation& now = world.now();
            deliver(mmStateRecord(now.mm, Now));
            deliver(gmmStateRecord(now.gmm, Now));
            deliver(registrationRecord(now.registration, Now));
            EXPECT_EQ(shown("Process CS", "MM State"), MMNames.at(now.mm.state));
            EXPECT_EQ(shown("Process CO", "MM State"), MMNames.at(now.mm.state));
            EXPECT_EQ(shown("Process CS", "MM Sub State"), MMSubNames.at(now.mm.subState));
            EXPECT_EQ(shown("Process CS", "LU Reject Cause"),
                now.mm.status == UpdateStatus::Updated ? "UPDATED" : "NOT_UPDATED");
            EXPECT_EQ(shown("Process PS", "MM State"), GMMNames.at(now.gmm.state));
            EXPECT_EQ(shown("Process PS", "MM Sub State"), GMMSubNames.at(now.gmm.subState));
            EXPECT_EQ(shown("Process PS", "Attach Reject Cause"),
                now.gmm.status == UpdateStatus::Updated ? "GMM_GU1_UPDATED" : "GMM_GU2_NOT_UPDATED");
            for (const char* section : {"Process CS", "Process CO", "Process PS"})
                EXPECT_EQ(shown(section, "MM Service State"), RegistrationNames.at(now.registration.state));
            EXPECT_EQ(shown("Serving PLMN", "PLMN Sel Mod"),
                now.registration.selection == PLMNSelection::Automatic ? "Automatic" : "Limited");
        });
    }
}

TEST_F(MobilityRoundTripTest, ServingNetworkShowsItsDigitsAndAreas)
{
    drive(1, 8, [&](const GSMUMTSWorld& world) {
        const NetworkReport& network = world.now().network;
        deliver(servingNetworkRecord(network, Now));
        EXPECT_EQ(shown("Serving PLMN", "Mobile Country Code"), network.network ? "001" : "   ");
        EXPECT_EQ(shown("Serving PLMN", "Mobile Network Code"), network.network ? "01 " : "   ");
        EXPECT_EQ(shown("Serving PLMN", "Location Area Code"), std::to_string(network.locationArea));
        EXPECT_EQ(shown("Serving PLMN", "Routing Area Code"), std::to_string(network.routingArea));
        EXPECT_EQ(shown("Serving PLMN", "Service Type"), ServiceNames.at(network.service));
        EXPECT_EQ(shown("GPRS Information", "Network Operating Mode"), "Class 2");
    });
}

TEST_F(MobilityRoundTripTest, ThreeDigitNetworkShowsAllItsDigits)
{
    NetworkReport network;
    network.network = PLMN {{3, 1, 0}, {4, 2, 6}};
    deliver(servingNetworkRecord(network, Now));
    EXPECT_EQ(shown("Serving PLMN", "Mobile Country Code"), "310");
    EXPECT_EQ(shown("Serving PLMN", "Mobile Network Code"), "426");
}

TEST_F(MobilityRoundTripTest, EquivalentNetworksShowTheirNumbers)
{
    const auto numberOf = [](const auto& digits) {
        return std::to_string(digits[0] * 100 + digits[1] * 10 + digits[2]);
    };
    std::set<std::size_t> counts;
    drive(1, 8, [&](const GSMUMTSWorld& world) {
        const auto networks = world.equivalentNetworks();
        deliver(equivalentNetworksRecord(networks, Now));
        ASSERT_EQ(list("Equivalent PLMN List").count(), networks.size());
        for (std::size_t index = 0; index < networks.size(); ++index) {
            const Dictionary& shownNetwork = entry("Equivalent PLMN List", index);
            EXPECT_EQ(text(shownNetwork, "Mobile Country Code"), numberOf(networks[index].countryDigits));
            EXPECT_EQ(text(shownNetwork, "Mobile Network Code"), numberOf(networks[index].networkDigits));
        }
        counts.insert(networks.size());
    });
    EXPECT_EQ(counts, (std::set<std::size_t> {0, 1, 2}));
}

TEST_F(MobilityRoundTripTest, CardShowsTheTestNetworkAndTheKnownAreas)
{
    char area[8];
    drive(1, 8, [&](const GSMUMTSWorld& world) {
        deliver(gsmumtsSIMFilesRecord(world.mobility().knownLocation(), world.mobility().knownRouting(), Now));
        std::snprintf(area, sizeof area, "%04X", world.mobility().knownLocation().locationArea);
        EXPECT_EQ(shown("SIM Info", "EF-LOCI"), "00F110 " + std::string(area) + " FE");
        std::snprintf(area, sizeof area, "%04X", world.mobility().knownRouting().locationArea);
        EXPECT_EQ(shown("SIM Info", "EF-GPRS/PS-LOCI").substr(0, 11), "00F110 " + std::string(area));
        EXPECT_EQ(shown("SIM Info", "EF-ACTING HPLMN"), "001-01");
        EXPECT_EQ(shown("SIM Info", "EF-PLMN NETWORK NAME"), "Test Network");
    });
}

TEST_F(MobilityRoundTripTest, ContextsShowWhatTheyHaveTransferred)
{
    drive(1, 8, [&](const GSMUMTSWorld& world) {
        deliver(packetContextsRecord(world.session(), Now));
        ASSERT_EQ(list("PDP Context Info").count(), world.now().hasSession ? 1u : 0u);
        if (world.now().hasSession) {
            EXPECT_EQ(text(entry("PDP Context Info", 0), "Bytes Received"), std::to_string(world.bytesReceived()));
            EXPECT_EQ(text(entry("PDP Context Info", 0), "State"), "Active");
        }
    });
}

} // namespace
} // namespace spectrel
