#include "Telephony/Encoders/UMTSRecords.h"

#include "Telephony/Reports/UMTSCell.h"
#include "Tests/Telephony/RecordBytes.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(UMTSRecordsTest, CellSetsAreALevelThenCellsThenEnergies)
{
    CellSetsReport report;
    report.rssi = -60; // (-60 + 106) * 10 - 512 = -52
    report.cells = {
        {0x01F3, CellSet::Active, 0, EnergyAverages::Long}, {24, CellSet::Detected, -10, EnergyAverages::Short}};
    const Bytes record = cellSetsRecord(report, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x417Au);
    ASSERT_EQ(record.size(), 16u + 2 * 15 + 2 * 44);
    EXPECT_EQ(part(record, 13, 3), (Bytes {0xCC, 0xFF, 2}));
    EXPECT_EQ(part(record, 16 + 7, 2), (Bytes {0xF3, 0x01}));
    EXPECT_EQ(part(record, 31 + 7, 2), (Bytes {24, 0x40})) << "set 2 in the upper three bits";
    const Bytes fullScale {0x00, 0x00, 0x08, 0x00};
    const Bytes tenth {0xCD, 0xCC, 0x00, 0x00}; // 52429
    EXPECT_EQ(part(record, 46 + 32, 4), fullScale);
    EXPECT_EQ(part(record, 46 + 36, 4), fullScale);
    EXPECT_EQ(part(record, 90 + 32, 4), (Bytes {0, 0, 0, 0})) << "no long average yet";
    EXPECT_EQ(part(record, 90 + 36, 4), tenth);
    EXPECT_EQ(part(record, 90 + 40, 4), tenth);
}

TEST(UMTSRecordsTest, FreshCellHasOnlyItsLastEnergy)
{
    const Bytes record = cellSetsRecord({-60, {{1, CellSet::Active, 0, EnergyAverages::None}}}, Epoch1980);
    EXPECT_EQ(part(record, 31 + 32, 12), (Bytes {0, 0, 0, 0, 0, 0, 0, 0, 0x00, 0x00, 0x08, 0x00}));
}

TEST(UMTSRecordsTest, NoCellsLeaveTheLevelAndTheCount)
{
    EXPECT_EQ(payloadOf(cellSetsRecord({-106, {}}, Epoch1980)), (Bytes {0x00, 0xFE, 0}));
}

TEST(UMTSRecordsTest, RankedUMTSCellIsTenBytes)
{
    RankingReport report;
    report.umts = {{10612, 257, -101, -100, -7.5, -98}};
    const Bytes record = rankingRecord(report, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x4005u);
    EXPECT_EQ(payloadOf(record),
        (Bytes {1, 0, 0x74, 0x29, 0x01, 0x01, 0xB0, 0x9C, 0xFF, 0xF1, 0x9E, 0xFF})); // -80, -100, -15, -98
}

TEST(UMTSRecordsTest, RankedGSMCellIsSevenBytesBehindTheUMTSCells)
{
    RankingReport report;
    report.gsm = {{700, 43, -76.4, -83}};
    EXPECT_EQ(payloadOf(rankingRecord(report, Epoch1980)), (Bytes {0, 1, 0xBC, 0x02, 43, 0, 0xB4, 0xAD, 0xFF}));
    report.umts.resize(2);
    const Bytes record = rankingRecord(report, Epoch1980);
    ASSERT_EQ(record.size(), 15u + 20 + 7);
    EXPECT_EQ(part(record, 35, 2), (Bytes {0xBC, 0x02}));
}

TEST(UMTSRecordsTest, ConnectionStateIsOneByte)
{
    const Bytes record = rrcStateRecord(RRCState::URAPCH, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x4125u);
    EXPECT_EQ(payloadOf(record), (Bytes {5}));
}

TEST(UMTSRecordsTest, TransmitPowerStandsFourBytesIntoItsEntry)
{
    const Bytes record = transmitPowerRecord({-10.0, std::nullopt}, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x4031u);
    ASSERT_EQ(record.size(), 16u + 2 * 14);
    EXPECT_EQ(record[14], 2);
    EXPECT_EQ(part(record, 20, 2), (Bytes {88, 0}));
    EXPECT_EQ(part(record, 34, 2), (Bytes {0, 0})) << "no sample";
}

TEST(UMTSRecordsTest, PowerThatWouldReadAsNoSampleIsMovedByATenth)
{
    const Bytes record = transmitPowerRecord({-18.8}, Epoch1980); // (-18.8 + 70) * 10 = 512
    EXPECT_EQ(part(record, 20, 2), (Bytes {1, 0}));
}

TEST(UMTSRecordsTest, ServingCellIsFrequenciesIdentityAndArea)
{
    UMTSCell cell;
    cell.uplinkChannel = 9662;
    cell.downlinkChannel = 10612;
    cell.identity = 0x0210403;
    cell.registrationArea = 301;
    const Bytes record = umtsServingCellRecord(cell, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x4127u);
    EXPECT_EQ(
        payloadOf(record), (Bytes {0xBE, 0x25, 0, 0, 0x74, 0x29, 0, 0, 0x03, 0x04, 0x21, 0x00, 0x2D, 0x01, 0, 0}));
}

TEST(UMTSRecordsTest, CipheringIsAFlagAtTheStart)
{
    const Bytes record = cipheringRecord(true, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x4157u);
    EXPECT_EQ(payloadOf(record), (Bytes {1, 0, 0, 0, 0, 0}));
    EXPECT_EQ(cipheringRecord(false, Epoch1980)[13], 0);
}

TEST(UMTSRecordsTest, BlockErrorsAreNineBytesAChannel)
{
    const Bytes record = blockErrorRecord({300, {{24, 0x01020304, 5}, {1, 50, 0}}}, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x4116u);
    EXPECT_EQ(payloadOf(record), (Bytes {2, 0x2C, 0x01, 24, 4, 3, 2, 1, 5, 0, 0, 0, 1, 50, 0, 0, 0, 0, 0, 0, 0}));
}

TEST(UMTSRecordsTest, HSDPAHasTenBitsOfSubFramesAndTheCarriersAboveThem)
{
    const Bytes record = hsdpaRecord({1023, HSDPACarriers::Dual, {{3, 0xFFFFFFFF, 258, 7}}, {}}, Epoch1980);
    EXPECT_EQ(codeOf(record), 0x4221u);
    EXPECT_EQ(payloadOf(record), (Bytes {1, 0xFF, 0x0B, 1, 0, 3, 0xFF, 0xFF, 0xFF, 0xFF, 2, 1, 7, 0}));
}

TEST(UMTSRecordsTest, SecondaryProcessesStandFarBehindThePrimaryOnes)
{
    const HARQProcess primary {1, 2, 3, 4};
    const HARQProcess secondary {9, 8, 7, 6};
    const Bytes one = hsdpaRecord({500, HSDPACarriers::Dual, {primary}, {secondary}}, Epoch1980);
    ASSERT_EQ(one.size(), 180u + 9);
    EXPECT_EQ(part(one, 180, 9), (Bytes {9, 8, 0, 0, 0, 7, 0, 6, 0}));
    const Bytes two = hsdpaRecord({500, HSDPACarriers::Dual, {primary, primary}, {secondary}}, Epoch1980);
    ASSERT_EQ(two.size(), 18u + 2 * 162 + 9);
    EXPECT_EQ(two[18 + 2 * 162], 9);
}

TEST(UMTSRecordsTest, ListsAreCutToWhatTheirCountCanHold)
{
    const Bytes record = rankingRecord({std::vector<RankedUMTSCell>(300), {}}, Epoch1980);
    EXPECT_EQ(record[13], 255);
    EXPECT_EQ(record.size(), 15u + 255 * 10);
}

} // namespace
} // namespace spectrel
