#include "Telephony/Encoders/LTERecords.h"

#include "Telephony/Reports/LTEReports.h"
#include "Tests/Telephony/RecordBytes.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

/// `count` bits of a record from a bit of a byte on, the lower-addressed byte being the lower one.
unsigned bitsOf(const Bytes& record, std::size_t byte, unsigned first, unsigned count)
{
    unsigned value = 0;
    for (unsigned bit = 0; bit < count; ++bit)
        value |= (record.at(byte + (first + bit) / 8) >> (first + bit) % 8 & 1u) << bit;
    return value;
}

LTEServingReport servingReport()
{
    LTEServingReport report;
    report.channel = 1300;
    report.physicalCellId = 503;
    report.priority = 5;
    report.measured = {-95.25, -60.5, -12.25};
    report.average = {-95.5, -60, -11.75};
    report.qRxLevMin = -124;
    report.pMax = 23;
    report.maxUETransmitPower = 20;
    report.srxlev = -7;
    report.cyclesBelowZero = 3;
    report.sIntraSearch = 46;
    report.sNonIntraSearch = 26;
    report.areRulesUpdated = true;
    report.rules = 5;
    return report;
}

LTECell cell()
{
    LTECell some;
    some.identity = 0x0123456;
    some.physicalCellId = 0x01F7;
    some.downlinkChannel = 1300;
    some.uplinkChannel = 19300;
    some.band = 3;
    some.resourceBlocks = 100;
    some.antennas = 4;
    some.trackingArea = 0xABCD;
    return some;
}

TEST(LTERecordsTest, ServingCellRecordIsLaidOutByteForByte)
{
    const Bytes record = lteServingCellRecord(cell(), Epoch1980);
    const Bytes payload {2, 0xF7, 0x01, 0x14, 0x05, 0x64, 0x4B, 100, 100, 0x56, 0x34, 0x12, 0x00, 0xCD, 0xAB, 3, 0, 0,
        0, 0, 0, 0, 0, 0, 0};
    ASSERT_EQ(record.size(), 38u);
    EXPECT_EQ(payloadOf(record), payload);
}

TEST(LTERecordsTest, AntennasRecordHasTheAntennasAtOffset20)
{
    const Bytes record = lteAntennasRecord(cell(), Epoch1980);
    ASSERT_EQ(record.size(), 22u);
    EXPECT_EQ(record[20], 4);
}

TEST(LTERecordsTest, ConnectedModeHasTheDetectedCellsAfterTheMeasuredOnes)
{
    LTEConnectedReport report {1300, 257, 9, {-95, 0, -11}, {}, {515, 4}};
    report.measured.push_back({258, {-139.75, 0, -19.875}});
    const Bytes record = lteConnectedModeRecord(report, Epoch1980);
    EXPECT_EQ(payloadOf(record),
        (Bytes {
            3, 0, 0, 0, 0x14, 0x05, 0x01, 0x01, 9, 0, 180, 0, 72, 0, 1, 2, 0x02, 0x01, 1, 0, 1, 0, 0x03, 0x02, 4, 0}));
}

TEST(LTERecordsTest, ConnectedModeCountsFitTheirBytes)
{
    LTEConnectedReport report;
    report.measured.resize(300);
    report.detected.resize(300);
    const Bytes record = lteConnectedModeRecord(report, Epoch1980);
    EXPECT_EQ(record[27], 255);
    EXPECT_EQ(record[28], 255);
    EXPECT_EQ(record.size(), 29u + 255 * 6 + 255 * 2);
}

TEST(LTERecordsTest, ServingMeasurementHasEveryFieldAtItsBits)
{
    const Bytes record = lteServingMeasurementRecord(servingReport(), Epoch1980);
    ASSERT_EQ(record.size(), 33u);
    EXPECT_EQ(record[13], 1);
    EXPECT_EQ(bitsOf(record, 17, 0, 16), 1300u);
    EXPECT_EQ(bitsOf(record, 19, 0, 9), 503u);
    EXPECT_EQ(bitsOf(record, 20, 1, 4), 5u);
    EXPECT_EQ(bitsOf(record, 21, 0, 9), 179u);
    EXPECT_EQ(bitsOf(record, 22, 1, 9), 178u);
    EXPECT_EQ(bitsOf(record, 23, 2, 7), 71u);
    EXPECT_EQ(bitsOf(record, 24, 1, 7), 73u);
    EXPECT_EQ(bitsOf(record, 25, 0, 9), 159u);
    EXPECT_EQ(bitsOf(record, 26, 1, 6), 8u);
    EXPECT_EQ(bitsOf(record, 26, 7, 7), 53u);
    EXPECT_EQ(bitsOf(record, 27, 6, 6), 50u);
    EXPECT_EQ(bitsOf(record, 29, 0, 7), 23u);
    EXPECT_EQ(bitsOf(record, 29, 7, 6), 3u);
    EXPECT_EQ(bitsOf(record, 30, 5, 6), 23u);
    EXPECT_EQ(bitsOf(record, 31, 3, 6), 13u);
    EXPECT_EQ(bitsOf(record, 32, 1, 1), 1u);
    EXPECT_EQ(bitsOf(record, 32, 2, 4), 5u);
}

TEST(LTERecordsTest, AbsentThresholdsHaveTheirOwnCodes)
{
    LTEServingReport report = servingReport();
    report.pMax.reset();
    report.sIntraSearch.reset();
    report.sNonIntraSearch.reset();
    const Bytes record = lteServingMeasurementRecord(report, Epoch1980);
    EXPECT_EQ(bitsOf(record, 26, 7, 7), 64u);
    EXPECT_EQ(bitsOf(record, 30, 5, 6), 32u);
    EXPECT_EQ(bitsOf(record, 31, 3, 6), 32u);
}

TEST(LTERecordsTest, NeighbourMeasurementHasEveryFieldOfEveryEntryAtItsBits)
{
    LTEIdleNeighbour neighbour;
    neighbour.physicalCellId = 300;
    neighbour.measured = {-95, -60.5, -12.25};
    neighbour.average = {-94, -60, -11.75};
    neighbour.srxlev = 29;
    neighbour.frequencyOffset = 0xABCD;
    neighbour.antennas[0] = {1023, 307199};
    neighbour.antennas[1] = {1, 2};
    const Bytes record = lteNeighbourMeasurementRecord({6300, -122, {LTEIdleNeighbour(), neighbour}}, Epoch1980);
    ASSERT_EQ(record.size(), 61u);
    EXPECT_EQ(bitsOf(record, 17, 0, 16), 6300u);
    EXPECT_EQ(bitsOf(record, 19, 0, 6), 9u);
    EXPECT_EQ(bitsOf(record, 19, 6, 5), 1u) << "the last one's index";
    EXPECT_EQ(bitsOf(record, 41, 0, 9), 300u);
    EXPECT_EQ(bitsOf(record, 42, 1, 8), 159u);
    EXPECT_EQ(bitsOf(record, 43, 1, 9), 90u);
    EXPECT_EQ(bitsOf(record, 45, 0, 9), 92u);
    EXPECT_EQ(bitsOf(record, 46, 1, 7), 71u);
    EXPECT_EQ(bitsOf(record, 47, 0, 7), 73u);
    EXPECT_EQ(bitsOf(record, 47, 7, 7), 59u);
    EXPECT_EQ(bitsOf(record, 49, 0, 16), 0xABCDu);
    EXPECT_EQ(bitsOf(record, 53, 0, 11), 1023u);
    EXPECT_EQ(bitsOf(record, 54, 3, 19), 307199u);
    EXPECT_EQ(bitsOf(record, 57, 0, 11), 1u) << "the second antenna's own";
    EXPECT_EQ(bitsOf(record, 58, 3, 19), 2u);
}

TEST(LTERecordsTest, NeighbourMeasurementHoldsOneTo32)
{
    LTENeighbourReport report;
    EXPECT_TRUE(lteNeighbourMeasurementRecord(report, Epoch1980).empty());
    report.neighbours.resize(40);
    const Bytes record = lteNeighbourMeasurementRecord(report, Epoch1980);
    EXPECT_EQ(bitsOf(record, 19, 6, 5), 31u);
    EXPECT_EQ(record.size(), 21u + 32 * 20);
}

TEST(LTERecordsTest, CandidateOfEachTechnologyHasItsOwnFields)
{
    using Technology = ReselectionTechnology;
    const std::pair<ReselectionCandidate, Bytes> candidates[] {
        {{Technology::LTE, 6, 3350, 503, 7}, {6, 0, 0, 0, 0x16, 0x0D, 0x80, 0xFB, 0, 0, 0, 0}},
        {{Technology::UTRAN, 3, 10700, 311, 0}, {3, 0, 1, 0, 0xCC, 0x29, 0x37, 0x01, 0, 0, 0, 0}},
        {{Technology::GERAN, 1, 612, 0x2B, 1}, {1, 0, 2, 0, 0x64, 0x02, 1, 0x2B, 0, 0, 0, 0}},
        {{Technology::CDMA1xRTT, 1, 283, 168, 10}, {1, 0, 3, 0, 10, 0, 0, 0, 0x1B, 0x01, 168, 0}},
        {{Technology::CDMAHRPD, 2, 37, 300, 1}, {2, 0, 4, 0, 1, 0, 0, 0, 37, 0, 0x2C, 0x01}},
    };
    for (const auto& [candidate, bytes] : candidates) {
        const Bytes record = lteReselectionRecord({1300, 44, {candidate}}, Epoch1980);
        const Bytes head {1, 0, 0x14, 0x05, 44, 0, 1, 0};
        ASSERT_EQ(record.size(), 33u);
        EXPECT_EQ(Bytes(record.begin() + 13, record.begin() + 21), head);
        EXPECT_EQ(Bytes(record.begin() + 21, record.end()), bytes) << int(candidate.technology);
    }
}

TEST(LTERecordsTest, LaterCandidatesLieOverTheEarlierOnes)
{
    const ReselectionCandidate first {ReselectionTechnology::LTE, 6, 3350, 503, 7};
    const ReselectionCandidate second {ReselectionTechnology::UTRAN, 3, 10700, 311, 0};
    const Bytes record = lteReselectionRecord({1300, 44, {first, second}}, Epoch1980);
    EXPECT_EQ(record.size(), 37u);
    EXPECT_EQ(
        Bytes(record.begin() + 21, record.begin() + 33), (Bytes {6, 0, 0, 0, 3, 0, 1, 0, 0xCC, 0x29, 0x37, 0x01}));
}

TEST(LTERecordsTest, NoCandidateIsWrittenToo)
{
    const Bytes record = lteReselectionRecord({1300, 44, {}}, Epoch1980);
    EXPECT_EQ(record.size(), 21u);
    EXPECT_EQ(record[19], 0);
}

} // namespace
} // namespace spectrel
