#include "Telephony/Encoders/GSMRecords.h"

#include "Telephony/Reports/GSMCell.h"
#include "Tests/Telephony/RecordBytes.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

GSMMeasurement measurement()
{
    GSMMeasurement some;
    some.arfcn = 55;
    some.rxLevel = 42;
    some.c1 = -2;
    some.c2 = 12;
    some.fullQuality = 3;
    some.subQuality = 4;
    some.reselectHysteresis = 6;
    some.neighbours = {{700, 31, -5, 7}, {70, 9, 3, 3}};
    return some;
}

TEST(GSMRecordsTest, ServingCellIsFrequencyColourAndIdentity)
{
    GSMCell cell;
    cell.arfcn = 700;
    cell.bsic = 43;
    cell.identity = 20041;
    const Bytes record = gsmServingCellRecord(cell, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x5134u);
    ASSERT_EQ(record.size(), 26u);
    EXPECT_EQ(part(record, 13, 6), (Bytes {0xBC, 0x02, 43, 0, 0x49, 0x4E}));
}

TEST(GSMRecordsTest, IdleMeasurementCarriesTheCriteria)
{
    const Bytes record = gsmMeasurementRecord(measurement(), Epoch1980);
    EXPECT_EQ(codeOf(record), 0x5137u);
    EXPECT_EQ(part(record, 13, 16), (Bytes {55, 0, 42, 0xFE, 0xFF, 0xFF, 0xFF, 12, 0, 0, 0, 0, 0, 6, 0, 2}));
}

TEST(GSMRecordsTest, DedicatedMeasurementCarriesTheQualities)
{
    GSMMeasurement dedicated = measurement();
    dedicated.isDedicated = true;
    EXPECT_EQ(part(gsmMeasurementRecord(dedicated, Epoch1980), 16, 8), (Bytes {3, 0, 0, 0, 4, 0, 0, 0}));
}

TEST(GSMRecordsTest, NeighbourIsFourteenBytes)
{
    const Bytes record = gsmMeasurementRecord(measurement(), Epoch1980);
    ASSERT_EQ(record.size(), 29u + 2 * 14);
    EXPECT_EQ(part(record, 29, 11), (Bytes {0xBC, 0x02, 31, 0xFB, 0xFF, 0xFF, 0xFF, 7, 0, 0, 0}));
    EXPECT_EQ(part(record, 43, 3), (Bytes {70, 0, 9}));
}

TEST(GSMRecordsTest, NeighbourIdentityIsFourBytes)
{
    const std::array<IdentifiedGSMCell, 2> cells {{{50, 7}, {700, 63}}};
    const Bytes record = neighbourIdentitiesRecord(cells, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x51FFu);
    EXPECT_EQ(payloadOf(record), (Bytes {0, 2, 50, 0, 7, 0, 0xBC, 0x02, 63, 0}));
}

TEST(GSMRecordsTest, DedicatedChannelIsTwoBytes)
{
    const Bytes record = dedicatedChannelRecord(300, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x5076u);
    EXPECT_EQ(payloadOf(record), (Bytes {0x2C, 0x01, 0, 0}));
}

TEST(GSMRecordsTest, StateIsFourBytes)
{
    const Bytes record = rrStateRecord({RRState::FromUMTSByOrder, 2, 1, true}, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x512Cu);
    EXPECT_EQ(payloadOf(record), (Bytes {21, 2, 1, 1}));
}

TEST(GSMRecordsTest, DiscontinuousTransmissionIsTheLastByte)
{
    const Bytes record = dtxRecord(true, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x5072u);
    EXPECT_EQ(payloadOf(record), (Bytes {0, 0, 0, 0, 0, 0, 1}));
}

TEST(GSMRecordsTest, MobileAllocationIsSequenceCountAndFrequencies)
{
    const Bytes record = mobileAllocationRecord({61, {10, 300}}, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x51F8u);
    EXPECT_EQ(payloadOf(record), (Bytes {61, 2, 10, 0, 0x2C, 0x01}));
    EXPECT_EQ(payloadOf(mobileAllocationRecord({}, Epoch1980)), (Bytes {0, 0}));
}

} // namespace
} // namespace spectrel
