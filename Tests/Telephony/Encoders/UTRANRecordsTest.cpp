#include "Telephony/Encoders/UTRANRecords.h"

#include "Telephony/Simulator/UTRAN/UTRANWorld.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyList.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

constexpr Moment Epoch1980 = std::chrono::sys_days(std::chrono::year(1980) / 1 / 6);

Bytes from(const Bytes& record, std::size_t offset, std::size_t count)
{
    return {record.begin() + static_cast<long>(offset), record.begin() + static_cast<long>(offset + count)};
}

TEST(UTRANRecordsTest, RRCModeIsMarkedAsValidInService)
{
    EXPECT_EQ(from(utranRRCRecord(RRCMode::CellDCH, true, Epoch1980), 13, 2), (Bytes {1, 3}));
    EXPECT_EQ(from(utranRRCRecord(RRCMode::Disconnected, false, Epoch1980), 13, 2), (Bytes {0, 0}));
    EXPECT_EQ(utranRRCRecord(RRCMode::URAPCH, true, Epoch1980).size(), 15u);
}

TEST(UTRANRecordsTest, ServingCellIsLaidOutByteForByte)
{
    UTRANCell cell;
    cell.identity = 0x0ABCDEF;
    cell.registrationArea = 17;
    cell.channel = 10054;
    const Bytes record = utranServingCellRecord(cell, true, Epoch1980);
    EXPECT_EQ(from(record, 13, 13), (Bytes {1, 0, 17, 0, 0x46, 0x27, 0x46, 0x27, 0xEF, 0xCD, 0xAB, 0x00, 0}));
    EXPECT_EQ(record.size(), 26u);
    EXPECT_EQ(utranServingCellRecord(cell, false, Epoch1980)[25], 1);
}

TEST(UTRANRecordsTest, NeighboursStand16BytesApartFromOffset168)
{
    // 10054 = 0x2746 in 14 bits; cellParameterId 0x55 in 7; -100 dBm is level 16 in 8; set 1 in 2; 1.
    const UTRANNeighbour cells[] {{}, {10054, 0x55, -100, UTRANCellSet::Monitored, true}};
    const Bytes record = utranNeighbourRecord(cells, Epoch1980);
    EXPECT_EQ(record.size(), 200u);
    EXPECT_EQ(record[16], 2 << 1);
    EXPECT_EQ(from(record, 184, 4), (Bytes {0x46, 0x67, 0x15, 0xA2}));
    EXPECT_EQ(from(record, 188, 12), Bytes(12));
}

TEST(UTRANRecordsTest, NeighbourLevelsAreThoseOfAReport)
{
    const std::pair<double, unsigned> levels[] {{-130, 0}, {-115.5, 0}, {-115, 1}, {-25, 91}, {0, 91}};
    for (const auto& [dBm, level] : levels) {
        const UTRANNeighbour cell {0, 0, dBm, UTRANCellSet::Active, false};
        const Bytes record = utranNeighbourRecord({&cell, 1}, Epoch1980);
        EXPECT_EQ(record[170] >> 5 | (record[171] & 0x1Fu) << 3, level) << dBm;
    }
}

TEST(UTRANRecordsTest, CountsFitTheirFields)
{
    const std::vector<UTRANNeighbour> cells(200);
    EXPECT_EQ(utranNeighbourRecord(cells, Epoch1980).size(), 168u + 127 * 16);
    const std::vector<GSMNeighbour> gsmCells(300);
    EXPECT_EQ(utranGSMNeighbourRecord(gsmCells, Epoch1980).size(), 17u + 255 * 8);
    TransportReport report;
    report.channels.resize(100);
    report.composites.resize(20);
    const Bytes record = utranTransportChannelRecord(report, Epoch1980);
    EXPECT_EQ(record.size(), 289u + 34 * 63 + 8 * 15);
    EXPECT_EQ(record[14], 0xC0);
    EXPECT_EQ(record[15], 0xFF);
}

TEST(UTRANRecordsTest, GSMNeighbourIsLaidOutByteForByte)
{
    GSMNeighbour cell;
    cell.identity = 0x1234;
    cell.isPCSBand = true;
    cell.networkColour = 3;
    cell.stationColour = 5;
    cell.channel = 612;
    cell.rssi = -71.6;
    const Bytes record = utranGSMNeighbourRecord({&cell, 1}, Epoch1980);
    EXPECT_EQ(from(record, 16, 9), (Bytes {1, 0x34, 0xD2, 3, 5, 0x64, 0x02, 0xB9, 0xFF}));
    cell.rssi = -100;
    EXPECT_EQ(utranGSMNeighbourRecord({&cell, 1}, Epoch1980)[18], 0x52) << "too weak for its colours to be known";
}

TEST(UTRANRecordsTest, CodedCompositeChannelsStandWhereTheTransportChannelsPutThem)
{
    TransportReport report;
    report.channels = {{24, 3}};
    report.composites = {{1, 2, {30, 28, 0, 0, 0, 0}}};
    const Bytes record = utranTransportChannelRecord(report, Epoch1980);
    EXPECT_EQ(record.size(), 331u);
    EXPECT_EQ(from(record, 13, 6), (Bytes {1, 0x40, 0x10, 0, 24, 3}));
    EXPECT_EQ(from(record, 323, 8), (Bytes {1, 2, 30, 28, 0, 0, 0, 0}));
}

TEST(UTRANRecordsTest, CellInformationNamesTheServingCellFirst)
{
    UTRANCell served;
    served.identity = 12u << 16 | 301;
    const UTRANCell other;
    const std::vector<const UTRANCell*> others(6, &other);
    const auto cells = parsePropertyList(ByteView(utranCellInformationRecord(served, others, Epoch1980)).subspan(13));
    ASSERT_TRUE(cells && cells->list());
    EXPECT_EQ(cells->list()->count(), 5u) << "the serving one and four";
    const auto& serving = *(*cells->list())[0].dictionary();
    EXPECT_EQ(serving["kRKCellMonitorCellType"], Value("kRKCellMonitorCellTypeServing"));
    EXPECT_EQ(serving["kRKCellMonitorCellRadioAccessTechnology"], Value("kRKCellMonitorRadioAccessTechnologyUTRAN2"));
    EXPECT_EQ(serving["kRKCellMonitorCellId"].int32(), 12 << 16 | 301);
}

} // namespace
} // namespace spectrel
