#include "Telephony/Encoders/MobilityRecords.h"

#include "Tests/Telephony/RecordBytes.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(MobilityRecordsTest, CircuitStatesAreThreeBytes)
{
    const Bytes record =
        mmStateRecord({MMState::Idle, MMSubState::LocationUpdateNeeded, UpdateStatus::NotUpdated}, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x7131u);
    EXPECT_EQ(payloadOf(record), (Bytes {19, 5, 1}));
}

TEST(MobilityRecordsTest, PacketStatesAreThreeBytes)
{
    const Bytes record =
        gmmStateRecord({GMMState::ServiceRequestInitiated, GMMSubState::None, UpdateStatus::Updated}, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x7130u);
    EXPECT_EQ(payloadOf(record), (Bytes {6, 12, 0}));
}

TEST(MobilityRecordsTest, RegistrationIsFollowedByTheSelectionModeAndAByte)
{
    const Bytes record = registrationRecord({RegistrationState::AutomaticSearch, PLMNSelection::Limited}, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x7132u);
    EXPECT_EQ(payloadOf(record), (Bytes {5, 2, 0}));
}

TEST(MobilityRecordsTest, ServingNetworkHasPackedDigitsAndABigEndianArea)
{
    NetworkReport report;
    report.operatingMode = 1;
    report.service = ServiceType::CircuitAndPacket;
    report.network = PLMN {{3, 1, 0}, {4, 1, 6}};
    report.locationArea = 0x1234;
    report.routingArea = 0x56;
    const Bytes record = servingNetworkRecord(report, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x7135u);
    ASSERT_EQ(record.size(), 32u);
    EXPECT_EQ(part(record, 13, 8), (Bytes {1, 3, 0x13, 0x60, 0x14, 0x12, 0x34, 0x56}));
}

TEST(MobilityRecordsTest, MissingDigitsAreFiller)
{
    NetworkReport report;
    EXPECT_EQ(part(servingNetworkRecord(report, Epoch1980), 15, 3), (Bytes {0xFF, 0xFF, 0xFF}));
    report.network = TestNetwork;
    EXPECT_EQ(part(servingNetworkRecord(report, Epoch1980), 15, 3), (Bytes {0x00, 0xF1, 0x10}));
}

TEST(MobilityRecordsTest, EquivalentNetworkIsDigitsInTurn)
{
    const std::array<PLMN, 1> networks {PLMN {{3, 1, 0}, {4, 2, 6}}};
    const Bytes record = equivalentNetworksRecord(networks, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x7150u);
    EXPECT_EQ(payloadOf(record), (Bytes {0, 0, 0, 1, 3, 4, 1, 2, 0, 6}));
}

TEST(MobilityRecordsTest, EquivalentNetworksOverlapByHalf)
{
    const std::array<PLMN, 2> networks {PLMN {{0, 0, 1}, {2, 0, 0}}, PLMN {{0, 0, 1}, {1, 0, 4}}};
    const Bytes record = equivalentNetworksRecord(networks, Epoch1980);
    EXPECT_EQ(payloadOf(record), (Bytes {0, 0, 0, 2, 0, 2, 0, 0, 1, 0, 0, 1, 4}));
}

TEST(MobilityRecordsTest, EquivalentNetworkThatDoesNotFitTheOneBeforeIsLeftOut)
{
    const std::array<PLMN, 3> networks {TestNetwork, PLMN {{3, 1, 0}, {4, 1, 6}}, PLMN {{0, 1, 1}, {1, 0, 4}}};
    const Bytes record = equivalentNetworksRecord(networks, Epoch1980);
    EXPECT_EQ(payloadOf(record), (Bytes {0, 0, 0, 1, 0, 0, 0, 0, 1, 1}));
}

TEST(MobilityRecordsTest, NoEquivalentNetworksLeaveTheHeadAlone)
{
    EXPECT_EQ(payloadOf(equivalentNetworksRecord({}, Epoch1980)), (Bytes {0, 0, 0, 0}));
}

} // namespace
} // namespace spectrel
