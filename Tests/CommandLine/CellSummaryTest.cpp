#include "CommandLine/Output/CellSummary.h"

#include "CommandLine/Output/CellJson.h"
#include "CommandLine/Output/TimeForm.h"

#include <chrono>
#include <gtest/gtest.h>

namespace spectrel {
namespace {

Cell lteCell(std::uint32_t id, double rsrp)
{
    Cell cell;
    cell.id = id;
    cell.levels[static_cast<std::size_t>(Level::RSRP)] = rsrp;
    return cell;
}

TEST(CellSummaryTest, OneLineTellsTheCellItsLevelsAndTheBestNeighbour)
{
    CellReport report;
    Cell serving = lteCell(52, -104.5);
    serving.band = "3";
    serving.downlinkMHz = 1815;
    serving.cell = 1049857;
    serving.site = 4101;
    serving.sector = 1;
    serving.levels[static_cast<std::size_t>(Level::RSRQ)] = -9.5;
    report.serving = serving;
    report.connection = Connection::Idle;
    report.neighbours.push_back({lteCell(203, -102), 2.5});
    EXPECT_EQ(summaryOf(report),
        "LTE band 3, 1815.0 MHz, PCI 52, cell 4101-1, RSRP -104.5 dBm, RSRQ -9.5 dB, 1 neighbour (best PCI 203, +2.5 "
        "dB), "
        "idle");
}

TEST(CellSummaryTest, NothingKnownIsSaid)
{
    EXPECT_EQ(summaryOf({}), "no serving cell");
}

TEST(CellJsonTest, WhatIsNotKnownIsLeftOutAndKeysStandInOrder)
{
    Cell cell = lteCell(52, -104.25);
    cell.channel = 1300;
    cell.stored = Moment(std::chrono::seconds(10));
    std::string text;
    appendCellJson(cell, {Moment(std::chrono::milliseconds(12500)), nullptr}, text);
    EXPECT_EQ(text, R"({"technology": "lte", "id": 52, "channel": 1300, "levels": {"RSRP": -104.25}, "age": 2.5})");
}

TEST(TimeFormTest, BothFormsHaveSixDecimals)
{
    const Moment time(std::chrono::microseconds(1709647651123456));
    EXPECT_EQ(timeText(time, TimeForm::Seconds), "1709647651.123456");
    EXPECT_EQ(jsonTimeText(time, TimeForm::RFC3339), "\"2024-03-05T14:07:31.123456Z\"");
    EXPECT_EQ(timeOfDay(time), "14:07:31");
    EXPECT_EQ(timeFormNamed("iso"), std::nullopt);
}

} // namespace
} // namespace spectrel
