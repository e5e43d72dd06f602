#include "Telephony/Modem/ModemSource.h"
#include "Records/Frame.h"

#include "Records/TelephonyConstants.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Telephony/Modem/FakeModemService.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyList.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

/// Keeps what a stream delivers, by code.
class Listener final : public MessageSink {
public:
    bool deliver(ByteView message) override
    {
        if (isFull)
            return false;
        const auto code = routedCode(message);
        EXPECT_TRUE(code);
        const auto payload = parsePropertyList(message.subspan(13));
        EXPECT_TRUE(payload) << "a payload that does not parse ends the application";
        received.emplace_back(code.value_or(0), payload.value_or(Value()));
        return true;
    }
    std::size_t count(std::uint32_t code) const
    {
        return static_cast<std::size_t>(std::count_if(
            received.begin(), received.end(), [code](const auto& message) { return message.first == code; }));
    }
    Value last(std::uint32_t code) const
    {
        for (auto message = received.rbegin(); message != received.rend(); ++message) {
            if (message->first == code)
                return message->second;
        }
        return {};
    }
    /// A key of one of the cells of the last cell-information record.
    Value cell(std::size_t place, std::string_view key) const
    {
        const Value cells = last(0xFF0001);
        return cells.list() && place < cells.list()->count() ? (*(*cells.list())[place].dictionary())[key] : Value();
    }
    std::vector<std::pair<std::uint32_t, Value>> received;
    bool isFull = false;
};

class ModemSourceTest : public testing::Test {
protected:
    ModemSourceTest()
    {
        testing::internal::CaptureStderr();
        modem.id = "/modems/0";
        modem.model = "EM7455";
        modem.isEnabled = true;
        modem.isRegistered = true;
        modem.cellKind = CellKind::LTE;
        modem.technology = Technology::LTE;
        modem.operatorId = "00101";
        modem.signalRate = 0;
        modem.sim = SimFacts {"8900101000000000017", "00101", "Test Network", {"+10015550100"}};
        modem.bearers = {bearer(100)};
        ledger.cells = {cell(416, true), cell(417, false)};
        ledger.location = LocationFacts {"00101", std::nullopt, 0x6FFE, 0x1CEAD80};
    }
    ~ModemSourceTest() override
    {
        source.reset();
        if (!_isStderrTaken)
            testing::internal::GetCapturedStderr();
    }

    static CellFacts cell(std::uint32_t physicalCellId, bool isServing)
    {
        CellFacts facts;
        facts.kind = CellKind::LTE;
        facts.isServing = isServing;
        facts.operatorId = "00101";
        facts.physicalCellId = physicalCellId;
        facts.power = -100;
        return facts;
    }
    static BearerFacts bearer(std::uint64_t received)
    {
        BearerFacts facts;
        facts.id = "3";
        facts.apn = "internet.test";
        facts.bytesReceived = received;
        return facts;
    }

    /// The service finds the modem, as it is in `modem` now.
    void plug()
    {
        ledger.modems = {modem};
        ledger.change();
    }
    void unplug()
    {
        ledger.modems.clear();
        ledger.change();
    }
    void open(const std::string& wish = {})
    {
        source = std::make_unique<ModemSource>(loop, loop, std::make_unique<FakeModemService>(ledger), wish);
    }
    void openWithModem()
    {
        ledger.modems = {modem};
        open();
    }
    /// What has been printed on standard error since the test began.
    std::string printed()
    {
        _isStderrTaken = true;
        return testing::internal::GetCapturedStderr();
    }
    static std::size_t occurrences(const std::string& text, const std::string& part)
    {
        std::size_t count = 0;
        for (std::size_t place = text.find(part); place != std::string::npos; place = text.find(part, place + 1))
            ++count;
        return count;
    }

    FakeRunLoop loop;
    FakeModemService::Ledger ledger;
    ModemFacts modem;
    std::unique_ptr<ModemSource> source;
    Listener listener;

private:
    bool _isStderrTaken = false;
};

TEST_F(ModemSourceTest, NewChannelGetsAllThreeRecordsAtOnce)
{
    openWithModem();
    const auto stream = source->start(listener);
    EXPECT_EQ(listener.count(0xFF0000), 1u);
    EXPECT_EQ(listener.count(0xFF0001), 1u);
    EXPECT_EQ(listener.count(0xFF0002), 1u);
    EXPECT_EQ(listener.cell(0, kRKCellMonitorPID), Value::integer(416));
    EXPECT_EQ(listener.cell(1, kRKCellMonitorCellType), Value(kRKCellMonitorCellTypeNeighbor));
}

TEST_F(ModemSourceTest, SecondChannelGetsTheLastCellsWithoutAskingTheModem)
{
    openWithModem();
    const auto first = source->start(listener);
    Listener other;
    const auto second = source->start(other);
    EXPECT_EQ(other.count(0xFF0001), 1u);
    EXPECT_EQ(ledger.cellsAsked, 1);
}

TEST_F(ModemSourceTest, CellsAreAskedForEveryFiveSeconds)
{
    openWithModem();
    const auto stream = source->start(listener);
    loop.advance(4999ms);
    EXPECT_EQ(ledger.cellsAsked, 1);
    loop.advance(1ms);
    EXPECT_EQ(ledger.cellsAsked, 2);
    loop.advance(50s);
    EXPECT_EQ(ledger.cellsAsked, 12);
    EXPECT_EQ(listener.count(0xFF0001), 12u);
}

TEST_F(ModemSourceTest, NothingIsAskedWhileNobodyListens)
{
    openWithModem();
    loop.advance(60s);
    EXPECT_EQ(ledger.cellsAsked, 0);
    EXPECT_EQ(loop.timers(), 0u);
    source->start(listener).reset();
    loop.advance(60s);
    EXPECT_EQ(ledger.cellsAsked, 1);
    EXPECT_EQ(loop.timers(), 0u);
}

TEST_F(ModemSourceTest, SlowModemIsNotAskedAgainBeforeItHasAnswered)
{
    openWithModem();
    ledger.isSlow = true;
    const auto stream = source->start(listener);
    loop.advance(20s);
    EXPECT_EQ(ledger.cellsAsked, 1);
    ledger.answerAll();
    loop.advance(5s);
    EXPECT_EQ(ledger.cellsAsked, 2);
}

TEST_F(ModemSourceTest, AnswerAfterTheLastChannelClosedIsDropped)
{
    openWithModem();
    ledger.isSlow = true;
    auto stream = source->start(listener);
    stream.reset();
    ledger.answerAll();
    const auto again = source->start(listener);
    EXPECT_EQ(listener.count(0xFF0001), 0u) << "the old cells are not this channel's";
}

TEST_F(ModemSourceTest, SignalRateIsRaisedWhileSomebodyListensAndPutBack)
{
    modem.signalRate = 10;
    openWithModem();
    EXPECT_TRUE(ledger.rates.empty());
    auto stream = source->start(listener);
    EXPECT_EQ(ledger.rates, (std::vector<std::pair<std::string, std::uint32_t>> {{"/modems/0", 2}}));
    ledger.change();
    stream.reset();
    EXPECT_EQ(ledger.rates.back(), std::pair(std::string("/modems/0"), 10u));
}

TEST_F(ModemSourceTest, FasterRateOfAnotherClientStays)
{
    modem.signalRate = 1;
    openWithModem();
    source->start(listener).reset();
    EXPECT_TRUE(ledger.rates.empty());
}

TEST_F(ModemSourceTest, RateThatAnotherClientHasSetSinceStays)
{
    openWithModem();
    auto stream = source->start(listener);
    modem.signalRate = 30;
    plug();
    stream.reset();
    EXPECT_EQ(ledger.rates.size(), 1u);
}

TEST_F(ModemSourceTest, ModemThatMeasuresNothingIsNotSetARate)
{
    modem.signalRate.reset();
    openWithModem();
    source->start(listener).reset();
    EXPECT_TRUE(ledger.rates.empty());
}

TEST_F(ModemSourceTest, DeniedSignalRateIsPrintedOnceAndNotPutBack)
{
    ledger.rateOutcome = ModemOutcome::Denied;
    openWithModem();
    source->start(listener).reset();
    source->start(listener).reset();
    EXPECT_EQ(ledger.rates.size(), 2u) << "one attempt each";
    EXPECT_EQ(occurrences(printed(), "Signal.Setup"), 1u);
}

TEST_F(ModemSourceTest, NewMeasurementIsReportedInTheServingCell)
{
    openWithModem();
    const auto stream = source->start(listener);
    EXPECT_EQ(listener.cell(0, kRKCellMonitorRSRP), Value::integer(-100));
    modem.signal.rsrp = -91.4;
    plug();
    EXPECT_EQ(listener.count(0xFF0001), 2u);
    EXPECT_EQ(listener.cell(0, kRKCellMonitorRSRP), Value::integer(-91));
    EXPECT_EQ(listener.cell(1, kRKCellMonitorRSRP), Value::integer(-100));
}

TEST_F(ModemSourceTest, OtherKindOfCellIsAskedForAtOnce)
{
    openWithModem();
    const auto stream = source->start(listener);
    ledger.cellsOutcome = ModemOutcome::Failed;
    modem.cellKind = CellKind::UMTS;
    modem.signal.rscp = -85;
    plug();
    EXPECT_EQ(ledger.cellsAsked, 2);
    EXPECT_EQ(
        listener.cell(0, kRKCellMonitorCellRadioAccessTechnology), Value(kRKCellMonitorRadioAccessTechnologyUMTS));
    EXPECT_EQ(listener.cell(0, kRKCellMonitorRSCP), Value::integer(-85));
}

TEST_F(ModemSourceTest, ChangeOfNothingSendsNothing)
{
    openWithModem();
    const auto stream = source->start(listener);
    listener.received.clear();
    plug();
    EXPECT_TRUE(listener.received.empty());
}

TEST_F(ModemSourceTest, TrafficIsReported)
{
    openWithModem();
    const auto stream = source->start(listener);
    modem.bearers = {bearer(2000)};
    plug();
    EXPECT_EQ(displayText(listener.last(0xFF0002)),
        R"([{"Context ID": "3", "APN": "internet.test", "Bytes Received": "2000"}])");
    EXPECT_EQ(listener.count(0xFF0000), 1u);
}

TEST_F(ModemSourceTest, SimThatIsTakenOutLeavesDashes)
{
    openWithModem();
    const auto stream = source->start(listener);
    modem.sim.reset();
    plug();
    EXPECT_EQ(displayText(listener.last(0xFF0000)),
        R"({"kSimFile_ICCID": "-", "kSimFile_MSISDN": "-", "kSimFile_AHPLMN": "-", "kSimFile_PNN": "-"})");
    EXPECT_NE(printed().find("modem 0 (EM7455), without a SIM"), std::string::npos);
}

TEST_F(ModemSourceTest, DeniedCellListIsPrintedOnceAndTheServingCellComesFromLocation)
{
    ledger.cellsOutcome = ModemOutcome::Denied;
    modem.signal.rsrp = -91;
    openWithModem();
    const auto stream = source->start(listener);
    loop.advance(20s);
    EXPECT_EQ(ledger.cellsAsked, 1) << "a denied wish is not repeated";
    EXPECT_EQ(ledger.locationsAsked, 5);
    EXPECT_EQ(listener.count(0xFF0001), 5u);
    EXPECT_EQ(displayText(listener.last(0xFF0001)),
        "[{\"kRKCellMonitorCellRadioAccessTechnology\": \"kRKCellMonitorRadioAccessTechnologyLTE\", "
        "\"kRKCellMonitorCellType\": \"kRKCellMonitorCellTypeServing\", \"kRKCellMonitorMCC\": int 1, "
        "\"kRKCellMonitorMNC\": int 1, \"kRKCellMonitorPLMN\": \"001-01\", \"kRKCellMonitorCellId\": int 30322048, "
        "\"kRKCellMonitorTAC\": int 28670, \"kRKCellMonitorRSRP\": int -91}]");
    const std::string lines = printed();
    EXPECT_EQ(occurrences(lines, "GetCellInfo"), 1u);
    EXPECT_NE(lines.find("have spectrel-modem.conf and spectrel-modem.rules in place"), std::string::npos) << lines;
}

TEST_F(ModemSourceTest, PermissionGivenSinceIsUsedByTheNextChannel)
{
    ledger.cellsOutcome = ModemOutcome::Denied;
    openWithModem();
    source->start(listener).reset();
    ledger.cellsOutcome = ModemOutcome::Done;
    const auto stream = source->start(listener);
    EXPECT_EQ(listener.cell(0, kRKCellMonitorPID), Value::integer(416));
}

TEST_F(ModemSourceTest, ModemWithoutCellListIsPrintedOnce)
{
    ledger.cellsOutcome = ModemOutcome::Unsupported;
    openWithModem();
    const auto stream = source->start(listener);
    loop.advance(20s);
    EXPECT_EQ(ledger.cellsAsked, 1);
    EXPECT_EQ(occurrences(printed(), "cannot list its cells"), 1u);
}

TEST_F(ModemSourceTest, ModemThatIsEnabledLaterIsAskedForEverythingAnew)
{
    modem.isEnabled = false;
    modem.signalRate.reset();
    ledger.cellsOutcome = ModemOutcome::Unsupported;
    ledger.locationOutcome = ModemOutcome::Unsupported;
    ledger.location.reset();
    openWithModem();
    const auto stream = source->start(listener);
    EXPECT_TRUE(ledger.rates.empty());
    ledger.cellsOutcome = ModemOutcome::Done;
    modem.isEnabled = true;
    modem.signalRate = 0;
    plug();
    loop.advance(5s);
    EXPECT_EQ(ledger.rates.size(), 1u);
    EXPECT_EQ(listener.cell(0, kRKCellMonitorPID), Value::integer(416));
}

TEST_F(ModemSourceTest, FailedListFallsBackAndIsTriedAgain)
{
    ledger.cellsOutcome = ModemOutcome::Failed;
    openWithModem();
    const auto stream = source->start(listener);
    EXPECT_EQ(listener.cell(0, kRKCellMonitorTAC), Value::integer(0x6FFE));
    ledger.cellsOutcome = ModemOutcome::Done;
    loop.advance(5s);
    EXPECT_EQ(listener.cell(0, kRKCellMonitorPID), Value::integer(416));
}

TEST_F(ModemSourceTest, EmptyListFallsBackToLocation)
{
    ledger.cells.clear();
    openWithModem();
    const auto stream = source->start(listener);
    EXPECT_EQ(listener.cell(0, kRKCellMonitorTAC), Value::integer(0x6FFE));
}

TEST_F(ModemSourceTest, DeniedLocationLeavesTheNetworkAlone)
{
    ledger.cellsOutcome = ModemOutcome::Denied;
    ledger.locationOutcome = ModemOutcome::Denied;
    ledger.location.reset();
    openWithModem();
    const auto stream = source->start(listener);
    loop.advance(10s);
    EXPECT_EQ(ledger.locationsAsked, 1);
    EXPECT_EQ(listener.cell(0, kRKCellMonitorPLMN), Value("001-01"));
    EXPECT_TRUE(listener.cell(0, kRKCellMonitorTAC).isAbsent());
    EXPECT_EQ(occurrences(printed(), "GetLocation"), 1u);
}

TEST_F(ModemSourceTest, ModemThatKnowsNothingHasNoCells)
{
    ledger.cells.clear();
    ledger.location.reset();
    modem.operatorId.clear();
    openWithModem();
    const auto stream = source->start(listener);
    EXPECT_EQ(displayText(listener.last(0xFF0001)), "[]");
}

TEST_F(ModemSourceTest, WithoutModemAChannelIsSilentUntilOneComes)
{
    modem.technology = Technology::GSM;
    modem.cellKind = CellKind::GSM;
    open();
    const auto stream = source->start(listener);
    loop.advance(60s);
    EXPECT_TRUE(listener.received.empty());
    plug();
    EXPECT_EQ(listener.count(0xFF0000), 1u);
    EXPECT_EQ(listener.count(0xFF0001), 1u);
    EXPECT_EQ(listener.count(0xFF0002), 1u);
    EXPECT_EQ(printed(),
        "spectrel-telephonyd: no modem; waiting for one\n"
        "spectrel-telephonyd: using modem 0 (EM7455)\n");
}

TEST_F(ModemSourceTest, UnpluggedModemEndsTheChannels)
{
    openWithModem();
    auto stream = source->start(listener);
    source->setBasebandHandler([&stream] { stream.reset(); });
    listener.received.clear();
    unplug();
    EXPECT_TRUE(stream) << "never in the middle of a delivery";
    loop.runQueued();
    EXPECT_FALSE(stream) << "the programs are to show that nothing is heard any more";
    loop.advance(60s);
    EXPECT_TRUE(listener.received.empty());
    EXPECT_EQ(ledger.cellsAsked, 1);
    const std::string lines = printed();
    EXPECT_NE(lines.find("modem 0 (EM7455) is no longer used"), std::string::npos) << lines;
    EXPECT_NE(lines.find("no modem; waiting for one"), std::string::npos) << lines;
}

TEST_F(ModemSourceTest, AnotherModemEndsTheChannelsThoughOfTheSameTechnology)
{
    openWithModem();
    auto stream = source->start(listener);
    source->setBasebandHandler([&stream] { stream.reset(); });
    modem.id = "/modems/1";
    plug();
    loop.runQueued();
    EXPECT_FALSE(stream) << "another baseband is another session";
    EXPECT_EQ(ledger.rates.back(), std::pair(std::string("/modems/1"), 0u)) << "as it was found";
}

TEST_F(ModemSourceTest, ModemPluggedInAgainIsHeardInTheChannelOpenedSince)
{
    openWithModem();
    auto stream = source->start(listener);
    source->setBasebandHandler([&stream] { stream.reset(); });
    unplug();
    loop.runQueued();
    stream = source->start(listener);
    listener.received.clear();
    modem.id = "/modems/1";
    plug();
    loop.runQueued();
    EXPECT_TRUE(stream);
    EXPECT_EQ(listener.cell(0, kRKCellMonitorPID), Value::integer(416));
    loop.advance(5s);
    EXPECT_EQ(ledger.cellsAsked, 3);
    EXPECT_EQ(ledger.rates.back(), std::pair(std::string("/modems/1"), 2u));
}

TEST_F(ModemSourceTest, ServiceThatIsNotThereIsNamed)
{
    ledger.isRunning = false;
    open();
    ledger.isRunning = true;
    plug();
    EXPECT_EQ(printed(),
        "spectrel-telephonyd: no ModemManager on the system bus; waiting for it\n"
        "spectrel-telephonyd: the technology is now lte\n"
        "spectrel-telephonyd: using modem 0 (EM7455)\n");
}

TEST_F(ModemSourceTest, TechnologyIsGSMUntilOneIsKnownAndThenTheLastKnown)
{
    open();
    EXPECT_EQ(source->technology(), Technology::GSM);
    plug();
    EXPECT_EQ(source->technology(), Technology::LTE);
    modem.technology.reset();
    plug();
    EXPECT_EQ(source->technology(), Technology::LTE);
    unplug();
    EXPECT_EQ(source->technology(), Technology::LTE);
}

TEST_F(ModemSourceTest, ChangeOfTechnologyIsReportedFromTheQueue)
{
    openWithModem();
    int changes = 0;
    source->setBasebandHandler([&changes] { ++changes; });
    loop.runQueued();
    changes = 0;
    modem.technology = Technology::GSM;
    modem.cellKind = CellKind::UMTS;
    plug();
    EXPECT_EQ(changes, 0) << "never in the middle of a delivery";
    loop.runQueued();
    EXPECT_EQ(changes, 1);
    modem.cellKind = CellKind::GSM;
    plug();
    loop.runQueued();
    EXPECT_EQ(changes, 1) << "UMTS and GSM are one technology";
}

TEST_F(ModemSourceTest, BusyClientGetsTheNewestOfEachKindOnceItTakesAgain)
{
    openWithModem();
    listener.isFull = true;
    const auto stream = source->start(listener);
    loop.advance(60s);
    modem.bearers = {bearer(7)};
    plug();
    listener.isFull = false;
    stream->resume();
    EXPECT_EQ(listener.received.size(), 3u);
    EXPECT_EQ((*(*listener.last(0xFF0002).list())[0].dictionary())["Bytes Received"], Value("7"));
}

TEST_F(ModemSourceTest, WishedModemIsWaitedFor)
{
    ledger.modems = {modem};
    open("EM7565");
    EXPECT_NE(printed().find("no modem 'EM7565'; waiting for it"), std::string::npos);
    EXPECT_EQ(source->technology(), Technology::GSM);
}

TEST_F(ModemSourceTest, SubscriberIdentitiesAreNotPrinted)
{
    openWithModem();
    const auto stream = source->start(listener);
    modem.sim->iccid = "8900101000000000018";
    plug();
    unplug();
    const std::string lines = printed();
    EXPECT_EQ(lines.find("89001"), std::string::npos) << lines;
    EXPECT_EQ(lines.find("5550100"), std::string::npos) << lines;
}

} // namespace
} // namespace spectrel
