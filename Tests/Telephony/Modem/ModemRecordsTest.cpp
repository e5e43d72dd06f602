#include "Telephony/Modem/ModemRecords.h"
#include "Records/Frame.h"

#include "Records/TelephonyConstants.h"
#include "Tests/Fakes/DisplayText.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyList.h"

#include <gtest/gtest.h>
#include <limits>

namespace spectrel {
namespace {

constexpr Moment Now {std::chrono::seconds(1'700'000'000)};

Value payload(const Bytes& record, std::uint32_t expectedCode)
{
    EXPECT_EQ(routedCode(record), expectedCode);
    EXPECT_EQ(record[1] | record[2] << 8, static_cast<int>(record.size()) - 1) << "the length has its 16 bits";
    return parsePropertyList(ByteView(record).subspan(13)).value_or(Value());
}

/// The dictionary of a single cell.
DictionaryRef cellOf(const CellFacts& cell, const SignalFacts& signal = {})
{
    const Value cells = payload(modemCellsRecord({cell}, signal, Now), 0xFF0001);
    return (*cells.list())[0].dictionary();
}

CellFacts cell(CellKind kind, bool isServing = true)
{
    CellFacts facts;
    facts.kind = kind;
    facts.isServing = isServing;
    facts.operatorId = "00101";
    facts.areaCode = 0x84CD;
    facts.cellId = 0xD30156;
    facts.channel = 1300;
    facts.psc = 301;
    facts.physicalCellId = 301;
    return facts;
}

TEST(ModemCells, GSMCellHasAreaCellAndChannel)
{
    EXPECT_EQ(displayText(cellOf(cell(CellKind::GSM))),
        "{\"kRKCellMonitorCellRadioAccessTechnology\": \"kRKCellMonitorRadioAccessTechnologyGSM\", "
        "\"kRKCellMonitorCellType\": \"kRKCellMonitorCellTypeServing\", \"kRKCellMonitorMCC\": int 1, "
        "\"kRKCellMonitorMNC\": int 1, \"kRKCellMonitorPLMN\": \"001-01\", \"kRKCellMonitorCellId\": int 13828438, "
        "\"kRKCellMonitorLAC\": int 33997, \"kRKCellMonitorARFCN\": int 1300, \"kRKCellMonitorRSSI\": int 32767}");
}

TEST(ModemCells, UMTSCellHasItsScramblingCode)
{
    EXPECT_EQ(displayText(cellOf(cell(CellKind::UMTS, false))),
        "{\"kRKCellMonitorCellRadioAccessTechnology\": \"kRKCellMonitorRadioAccessTechnologyUMTS\", "
        "\"kRKCellMonitorCellType\": \"kRKCellMonitorCellTypeNeighbor\", \"kRKCellMonitorMCC\": int 1, "
        "\"kRKCellMonitorMNC\": int 1, \"kRKCellMonitorPLMN\": \"001-01\", \"kRKCellMonitorCellId\": int 13828438, "
        "\"kRKCellMonitorLAC\": int 33997, \"kRKCellMonitorUARFCN\": int 1300, \"kRKCellMonitorSCN\": int 301, "
        "\"kRKCellMonitorRSCP\": int 32767, \"kRKCellMonitorECN0\": int 32767}");
}

TEST(ModemCells, LTECellHasTrackingAreaAndBand)
{
    EXPECT_EQ(displayText(cellOf(cell(CellKind::LTE))),
        "{\"kRKCellMonitorCellRadioAccessTechnology\": \"kRKCellMonitorRadioAccessTechnologyLTE\", "
        "\"kRKCellMonitorCellType\": \"kRKCellMonitorCellTypeServing\", \"kRKCellMonitorMCC\": int 1, "
        "\"kRKCellMonitorMNC\": int 1, \"kRKCellMonitorPLMN\": \"001-01\", \"kRKCellMonitorCellId\": int 13828438, "
        "\"kRKCellMonitorTAC\": int 33997, \"kRKCellMonitorPID\": int 301, \"kRKCellMonitorBandInfo\": int 3, "
        "\"kRKCellMonitorUARFCN\": int 1300}");
}

TEST(ModemCells, ReceptionLevelIsReportedInStepsOfTwoDecibels)
{
    CellFacts facts = cell(CellKind::GSM, false);
    const auto shownLevel = [&facts](std::uint32_t level) {
        facts.rxLevel = level;
        return (*cellOf(facts))[kRKCellMonitorRSSI];
    };
    EXPECT_EQ(shownLevel(21), Value::integer(-45)) << "-90 dBm";
    EXPECT_EQ(shownLevel(63), Value::integer(-24)) << "-48 dBm";
    EXPECT_EQ(shownLevel(64), Value::integer(32767)) << "no level";
}

TEST(ModemCells, MeasurementsBelongToTheServingCellAndWinOverTheList)
{
    const SignalFacts signal {-60.4, -85.5, -7.4, -91.6, -10.2, 14.4};
    CellFacts facts = cell(CellKind::LTE);
    facts.power = -99;
    EXPECT_EQ((*cellOf(facts, signal))[kRKCellMonitorRSRP], Value::integer(-92));
    EXPECT_EQ((*cellOf(facts, signal))[kRKCellMonitorRSRQ], Value::integer(-10));
    EXPECT_EQ((*cellOf(facts, signal))[kRKCellMonitorSNR], Value::integer(14));
    EXPECT_EQ((*cellOf(facts))[kRKCellMonitorRSRP], Value::integer(-99));
    facts.isServing = false;
    EXPECT_EQ((*cellOf(facts, signal))[kRKCellMonitorRSRP], Value::integer(-99));
    const auto umts = cellOf(cell(CellKind::UMTS), signal);
    EXPECT_EQ((*umts)[kRKCellMonitorRSCP], Value::integer(-86));
    EXPECT_EQ((*umts)[kRKCellMonitorECN0], Value::integer(-7));
    EXPECT_EQ((*cellOf(cell(CellKind::GSM), signal))[kRKCellMonitorRSSI], Value::integer(-30));
}

TEST(ModemCells, MeasurementThatIsNoneIsLeftOut)
{
    for (const double odd : {-1e300, 1e9, std::numeric_limits<double>::quiet_NaN()}) {
        SignalFacts signal;
        signal.rsrp = odd;
        signal.rscp = odd;
        EXPECT_TRUE((*cellOf(cell(CellKind::LTE), signal))[kRKCellMonitorRSRP].isAbsent()) << odd;
        EXPECT_EQ((*cellOf(cell(CellKind::UMTS), signal))[kRKCellMonitorRSCP], Value::integer(32767)) << odd;
    }
}

TEST(ModemCells, WhatIsNotKnownHasNoKey)
{
    CellFacts facts;
    facts.kind = CellKind::LTE;
    facts.operatorId = "1";
    EXPECT_EQ(cellOf(facts)->count(), 2u) << displayText(cellOf(facts));
}

TEST(ModemCells, ListOfMaxLengthFitsIntoARecord)
{
    const std::vector<CellFacts> many(1000, cell(CellKind::LTE));
    const SignalFacts signal {-60, -85, -7, -91, -10, 14};
    const Value cells = payload(modemCellsRecord(many, signal, Now), 0xFF0001);
    EXPECT_EQ(cells.list()->count(), MaxModemElements);
}

TEST(ModemSim, FilesAreNamedAsTheyAreShown)
{
    const SimFacts sim {"8900101000000000017", "001001", "Test & Network", {"+1", "+2"}};
    EXPECT_EQ(displayText(payload(modemSimRecord(sim, Now), 0xFF0000)),
        R"({"kSimFile_ICCID": "8900101000000000017", "kSimFile_MSISDN": "+1, +2", "kSimFile_AHPLMN": "001-001", )"
        R"("kSimFile_PNN": "Test & Network"})");
}

TEST(ModemContexts, AreShownAsTheyAre)
{
    const BearerFacts bearer {"3", "internet.test", "IPv4v6", "Active", "wwan0", "192.0.2.17", "2001:db8::17",
        "192.0.2.1", {"192.0.2.53", "192.0.2.54"}, 5'000'000'000, 0};
    EXPECT_EQ(displayText(payload(modemContextsRecord({bearer, BearerFacts()}, Now), 0xFF0002)),
        "[{\"Context ID\": \"3\", \"APN\": \"internet.test\", \"Type\": \"IPv4v6\", \"Interface\": \"wwan0\", "
        "\"Address\": \"192.0.2.17\", \"IPv6 Address\": \"2001:db8::17\", \"Gateway\": \"192.0.2.1\", "
        "\"DNS\": \"192.0.2.53, 192.0.2.54\", \"State\": \"Active\", \"Bytes Received\": \"5000000000\", "
        "\"Bytes Sent\": \"0\"}, {}]");
}

TEST(ModemContexts, TextsOfMaxLengthFitIntoARecord)
{
    const std::string longest(256, '&'); // five bytes each as XML
    const BearerFacts bearer {longest, longest, longest, longest, longest, longest, longest, longest, {longest}, 1, 1};
    const std::vector<BearerFacts> many(100, bearer);
    const Value contexts = payload(modemContextsRecord(many, Now), 0xFF0002);
    ASSERT_TRUE(contexts.list());
    EXPECT_GT(contexts.list()->count(), 1u);
}

} // namespace
} // namespace spectrel
