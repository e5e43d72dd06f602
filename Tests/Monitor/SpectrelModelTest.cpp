#include "Monitor/SpectrelModel.h"

#include "Records/TelephonyConstants.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/FakeMessagePorts.h"
#include "Tests/Fakes/FakeResources.h"
#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Tests/Fakes/RecordBuilder.h"
#include "Values/PropertyList/PropertyList.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

constexpr const char* PortName = "test.BasebandStateReport.LogChannel";

class Observer final : public SpectrelModelObserver {
public:
    void updateViewControllerFromModel() override
    {
        ++reloads;
        if (model)
            model->topLevelNodes();
    }
    void sessionDidChange() override
    {
        news += (model->isConnected() ? "connected" : "lost") + std::string(":") + model->lostReason() + "\n";
    }
    SpectrelModel* model = nullptr;
    int reloads = 0;
    std::string news;
};

class SpectrelModelTest : public testing::Test {
protected:
    SpectrelModelTest()
    {
        observer.model = &model;
        resources.lists["LTE"] =
            Dictionary::make({{"Serving Cell Info", Dictionary::make({{"UARFCN", "-"}})}, {"List", List::make()}});
        resources.lists["ZPH_GSM"] = Dictionary::make({{"SIM Info", Dictionary::make()}});
        answerTechnology(kRKLogChannelTechnology_Zephyr_LTE);
        ports.answer = [this](const FakeMessagePorts::Sent& request) { return answer(request); };
    }

    FakeMessagePorts::Answer answer(const FakeMessagePorts::Sent& request)
    {
        if (request.replyMode == ReplyMode::Wait)
            return {technologyStatus, technologyReply};
        return {startStatus, std::nullopt};
    }
    void answerTechnology(const Value& technology)
    {
        answerWith(Dictionary::make({{"GetTechnology", technology}}));
    }
    void answerWith(const Value& list)
    {
        const auto text = serialisePropertyList(list);
        technologyReply = Bytes(text->begin(), text->end());
    }
    void receive(ByteView message, std::int32_t id = 0)
    {
        ASSERT_TRUE(ports.deliver(PortName, id, message));
    }
    std::size_t historyCount()
    {
        const auto& history = model.displayState().state()[StateKey::History].list();
        return history ? history->count() : 0;
    }
    static RecordBuilder servingCell()
    {
        return RecordBuilder(0xB0C2, 38).u16(14, 7);
    }
    static bool isStart(const FakeMessagePorts::Sent& request)
    {
        return request.body.find("Streaming") != std::string::npos;
    }

    FakeRunLoop loop;
    LogRecorder log;
    FakeResources resources;
    FakeMessagePorts ports;
    FakeTelephonyServer telephony;
    Observer observer;
    SpectrelModel model {{loop, ports, telephony, {loop, resources, log, log}}, &LogGenerator::generatorFromTechnology,
        observer, "test"};
    SendStatus technologyStatus = SendStatus::Success;
    SendStatus startStatus = SendStatus::Success;
    std::optional<Bytes> technologyReply;
};

// ---- The session

TEST_F(SpectrelModelTest, CreationOpensNothing)
{
    EXPECT_FALSE(model.isConnected());
    EXPECT_EQ(ports.localPorts(), 0u);
    EXPECT_EQ(model.topLevelNodes(), nullptr);
    EXPECT_EQ(model.getSaveContents(), nullptr);
}

TEST_F(SpectrelModelTest, StartAsksForTheTechnologyThenSendsTheStartCommand)
{
    model.startMonitor();
    EXPECT_TRUE(model.isConnected());
    EXPECT_EQ(telephony.channelsFor, std::vector<std::string> {PortName});
    ASSERT_EQ(ports.sent.size(), 2u);

    const auto& request = ports.sent[0];
    EXPECT_EQ(request.id, 0);
    EXPECT_EQ(request.sendTimeout, 1s);
    EXPECT_EQ(request.receiveTimeout, 1s);
    EXPECT_EQ(request.replyMode, ReplyMode::Wait);
    EXPECT_NE(request.body.find("<plist version=\"1.0\">"), std::string::npos);
    const Bytes body(request.body.begin(), request.body.end());
    EXPECT_EQ(displayText(*parsePropertyList(body)), "{\"GetTechnology\": \"GetTechnology\"}");

    const auto& start = ports.sent[1];
    EXPECT_EQ(start.id, 0);
    EXPECT_EQ(start.sendTimeout, 1s);
    EXPECT_EQ(start.receiveTimeout, 0s);
    EXPECT_EQ(start.replyMode, ReplyMode::None);
    const Bytes command(start.body.begin(), start.body.end());
    EXPECT_EQ(displayText(*parsePropertyList(command)),
        "{\"SetState\": \"Streaming\", \"SetZephyrLogCodes\": [int 45250, int 45249, int 45433, int 45439, int 45440, "
        "int 45446], \"SetRkExtraCodes\": [int 1, int 0, int 2]}");
    EXPECT_EQ(loop.timers(), 1u);
}

TEST_F(SpectrelModelTest, StartIsLoggedLineByLine)
{
    model.startMonitor();
    const std::string text = log.takeLog();
    const auto ports_ = text.find("<3> ***** Created ports (send=0x");
    const auto generator = text.find("<3>Got log generated: 0x");
    const auto timer = text.find("<3>Starting the display update timer\n");
    EXPECT_LT(ports_, generator);
    EXPECT_LT(generator, timer);
    EXPECT_NE(timer, std::string::npos);
}

TEST_F(SpectrelModelTest, SecondStartWhileRunningChangesAndSendsNothing)
{
    model.startMonitor();
    log.takeLog();
    const auto sent = ports.sent.size();
    model.startMonitor();
    EXPECT_EQ(ports.sent.size(), sent);
    EXPECT_EQ(loop.timers(), 1u);
    EXPECT_EQ(log.takeLog(), "");
}

TEST_F(SpectrelModelTest, UnknownTechnologyDropsTheGeneratorAndRetriesForEver)
{
    model.startMonitor();
    answerTechnology("kRKLogChannelTechnology_Martian");
    ports.killPeers();
    loop.advance(2s);
    EXPECT_EQ(model.displayState().generator(), nullptr);
    EXPECT_NE(log.takeLogWith("No log generator technology works"), "");
    EXPECT_FALSE(model.isConnected());
    EXPECT_EQ(ports.localPorts(), 0u);
    for (int attempt = 0; attempt < 20; ++attempt) {
        loop.advance(5s);
        EXPECT_EQ(log.takeLogWith("<3>No log generator technology works\n"), "<3>No log generator technology works\n");
    }
    EXPECT_EQ(model.lostReason(), "No log generator technology works");
}

TEST_F(SpectrelModelTest, ExistingPortOfTheNameFailsAndIsClosed)
{
    ports.existingLocal = true;
    model.startMonitor();
    EXPECT_EQ(log.takeLog(), "<3>Local messsage port already exists\n<3>Could not create the ports necessary\n");
    EXPECT_EQ(ports.localPorts(), 0u);
    EXPECT_EQ(loop.waitingJobs(), 1u);
}

TEST_F(SpectrelModelTest, PortThatCannotBeHadFails)
{
    ports.refuseLocal = true;
    model.startMonitor();
    EXPECT_EQ(log.takeLog(), "<3>Could not create local message port\n<3>Could not create the ports necessary\n");
}

TEST_F(SpectrelModelTest, NameThatCannotBeBuiltFailsWithoutAMessage)
{
    SpectrelModel nameless(
        {loop, ports, telephony, {loop, resources, log, log}}, &LogGenerator::generatorFromTechnology, observer, "");
    EXPECT_FALSE(nameless.createPorts());
    EXPECT_EQ(log.takeLog(), "");
}

TEST_F(SpectrelModelTest, ServiceThatDoesNotRunFails)
{
    telephony.isRunning = false;
    model.startMonitor();
    EXPECT_EQ(log.takeLog(), "<3>Could not create RKServerConnection\n<3>Could not create the ports necessary\n");
    EXPECT_EQ(model.lostReason(), "Could not create RKServerConnection");
}

TEST_F(SpectrelModelTest, ErrorOfTheServiceIsLoggedWithItsCode)
{
    telephony.result = {1, -42, "channel"};
    model.startMonitor();
    EXPECT_EQ(log.takeLog(),
        "<3>_RKServerConnectionNetworkMonitorCreateLogChannel returns error: -42!\n"
        "<3>Could not create the ports necessary\n");
}

TEST_F(SpectrelModelTest, EmptyServicePortNameIsTreatedLikeAMissingOne)
{
    for (const std::optional<std::string>& name : {std::optional<std::string>(), std::optional<std::string>("")}) {
        telephony.result = {0, 0, name};
        EXPECT_FALSE(model.createPorts());
        EXPECT_EQ(log.takeLog(), "<3>Could not create a log channel (RK returned null port)!\n");
        model.destroyPorts();
    }
}

TEST_F(SpectrelModelTest, RemotePortThatCannotBeMadeFails)
{
    ports.refuseRemote = true;
    model.startMonitor();
    EXPECT_EQ(log.takeLog(), "<3>Could not create the remote port!\n<3>Could not create the ports necessary\n");
}

TEST_F(SpectrelModelTest, FailedStartIsTriedAgainAfterFiveSecondsAndNotBefore)
{
    telephony.isRunning = false;
    model.startMonitor();
    telephony.isRunning = true;
    loop.advance(4999ms);
    EXPECT_FALSE(model.isConnected());
    loop.advance(1ms);
    EXPECT_TRUE(model.isConnected());
    EXPECT_EQ(model.lostReason(), "");
}

struct TechnologyFailure {
    const char* name;
    SendStatus status;
    std::optional<std::string> reply;
    const char* line;
};

TEST_F(SpectrelModelTest, EachFailureOfTheTechnologyRequestHasItsLine)
{
    const TechnologyFailure failures[] = {
        {"no answer", SendStatus::ReceiveTimeout, {},
            "<3> ***** Could not send the GetTechnology command (got error=-2)\n"},
        {"full", SendStatus::SendTimeout, "x", "<3> ***** Could not send the GetTechnology command (got error=-1)\n"},
        {"empty", SendStatus::Success, {}, "<3> ***** No response to GetTechnology; cannot configure\n"},
        {"garbage", SendStatus::Success, "gar", "<3> ***** Could not parse reply to GetTechnology; cannot configure\n"},
        {"a text", SendStatus::Success, "<plist version=\"1.0\"><string>x</string></plist>",
            "<3> ***** Could not parse reply to GetTechnology; cannot configure\n"},
        {"no key", SendStatus::Success, "<plist version=\"1.0\"><dict/></plist>",
            "<3> ***** Reply to GetTechnology had no answer; cannot configure\n"},
    };
    for (const auto& failure : failures) {
        technologyStatus = failure.status;
        technologyReply.reset();
        if (failure.reply)
            technologyReply = Bytes(failure.reply->begin(), failure.reply->end());
        model.startMonitor();
        EXPECT_EQ(log.takeLogWith("GetTechnology"), failure.line) << failure.name;
        EXPECT_FALSE(model.isConnected());
    }
}

TEST_F(SpectrelModelTest, StartCommandThatCannotBeSentIsLoggedAndRetried)
{
    startStatus = SendStatus::SendTimeout;
    model.startMonitor();
    EXPECT_EQ(log.takeLogWith("START"), "<3> ***** Could not send the START command (got error=-1)\n");
    EXPECT_FALSE(model.isConnected());
    EXPECT_EQ(loop.waitingJobs(), 1u);
}

TEST_F(SpectrelModelTest, RestartWithoutAnAnswerReusesTheGeneratorAndSendsItsStartCommandAgain)
{
    model.startMonitor();
    const LogGenerator* generator = model.displayState().generator();
    technologyReply.reset();
    model.restartMonitor();
    EXPECT_EQ(model.displayState().generator(), generator);
    EXPECT_TRUE(model.isConnected());
    ASSERT_EQ(ports.sent.size(), 4u);
    EXPECT_TRUE(isStart(ports.sent[3]));
}

TEST_F(SpectrelModelTest, MessageOfAnotherIdChangesNothing)
{
    model.startMonitor();
    for (const std::int32_t id : {1, -1, 7}) {
        receive(servingCell(), id);
    }
    EXPECT_EQ(model.displayState().state().count(), 0u);
    loop.advance(2s);
    EXPECT_EQ(observer.reloads, 0);
}

TEST_F(SpectrelModelTest, DeliberateCloseNeverRestarts)
{
    model.startMonitor();
    log.takeLog();
    model.destroyPorts();
    model.destroyPorts();
    loop.advance(60s);
    EXPECT_FALSE(model.isConnected());
    EXPECT_EQ(log.takeLog(), "");
    EXPECT_EQ(loop.timers(), 0u);
    EXPECT_NE(model.displayState().generator(), nullptr) << "the generator stays";
}

TEST_F(SpectrelModelTest, InvalidationFromOutsideAlwaysRestarts)
{
    model.startMonitor();
    log.takeLog();
    ports.invalidateLocal(PortName);
    const std::string text = log.takeLog();
    EXPECT_EQ(text.find("<3> ***** INVALIDATED 0x"), 0u);
    EXPECT_NE(text.find(" *****\n"), std::string::npos);
    EXPECT_TRUE(model.isConnected());
    EXPECT_EQ(telephony.channelsFor.size(), 2u);
    EXPECT_EQ(loop.timers(), 1u);
}

TEST_F(SpectrelModelTest, DeathOfTheServiceIsNoticedAtTheNextTickAndSurvived)
{
    model.startMonitor();
    receive(servingCell());
    loop.advance(2s);
    ports.killPeers();
    telephony.isRunning = false;
    loop.advance(2s);
    EXPECT_FALSE(model.isConnected());
    EXPECT_EQ(observer.news, "connected:\nlost:\nlost:Could not create RKServerConnection\n");
    loop.advance(10s);
    telephony.isRunning = true;
    loop.advance(5s);
    EXPECT_TRUE(model.isConnected());
    const auto display = model.displayState().state()[StateKey::Display].dictionary();
    receive(servingCell().u16(14, 99));
    loop.advance(2s);
    EXPECT_EQ(*model.nodeAtPath("/Serving Cell Info/Physical Cell ID")->value(), "99");
    EXPECT_EQ(model.displayState().state()[StateKey::Display].dictionary(), display)
        << "the new generator took the display over";
}

TEST_F(SpectrelModelTest, ServiceThatReturnsWithAnotherTechnologyGetsItsOwnDisplay)
{
    model.startMonitor();
    receive(servingCell());
    loop.advance(2s);
    answerTechnology(kRKLogChannelTechnology_Zephyr_GSM);
    ports.killPeers();
    loop.advance(2s);
    EXPECT_EQ(model.session().technology(), kRKLogChannelTechnology_Zephyr_GSM);
    receive(RecordBuilder::withPropertyList(0xFF0000, Dictionary::make({{"kSimFile_ICCID", "1"}})));
    loop.advance(2s);
    EXPECT_EQ(model.nodeAtPath("/Serving Cell Info"), nullptr);
    EXPECT_EQ(*model.nodeAtPath("/SIM Info/EF-ICCID")->value(), "1");
    EXPECT_EQ(historyCount(), 2u);
}

TEST_F(SpectrelModelTest, NotificationOfTheConnectionRefreshes)
{
    model.startMonitor();
    receive(servingCell());
    telephony.notification("anything");
    loop.runQueued();
    EXPECT_EQ(observer.reloads, 1);
}

TEST_F(SpectrelModelTest, JobsThatOutliveTheModelDoNothing)
{
    telephony.isRunning = false;
    {
        SpectrelModel shortLived({loop, ports, telephony, {loop, resources, log, log}},
            &LogGenerator::generatorFromTechnology, observer, "brief");
        observer.model = &shortLived;
        shortLived.startMonitor();
    }
    observer.model = &model;
    telephony.isRunning = true;
    const auto asked = telephony.channelsFor.size();
    loop.advance(60s);
    EXPECT_EQ(telephony.channelsFor.size(), asked);
}

// ---- The display

TEST_F(SpectrelModelTest, WithoutAGeneratorThereAreNoNodesEverAndMessagesStillCount)
{
    model.updateWithData(servingCell());
    EXPECT_EQ(model.topLevelNodes(), nullptr);
    EXPECT_EQ(model.nodeAtPath("/"), nullptr);
    EXPECT_EQ(model.nodeAtPath("/"), nullptr);
    model.refresh();
    loop.runQueued();
    EXPECT_EQ(observer.reloads, 1);
}

TEST_F(SpectrelModelTest, TickWithoutNewMessagesAddsNoHistory)
{
    model.startMonitor();
    loop.advance(20s);
    EXPECT_EQ(observer.reloads, 0);
    EXPECT_EQ(historyCount(), 0u);
}

TEST_F(SpectrelModelTest, ManyMessagesInATickYieldOneRebuild)
{
    model.startMonitor();
    for (int count = 0; count < 100; ++count)
        receive(servingCell());
    loop.advance(2s);
    EXPECT_EQ(observer.reloads, 1);
    EXPECT_EQ(historyCount(), 1u);
}

TEST_F(SpectrelModelTest, FloodWaitsForTheNextTick)
{
    model.startMonitor();
    const Bytes large = RecordBuilder(0xB0C1, 65536).bytes();
    for (std::size_t count = 1; count < SpectrelModel::LargestIntake / large.size(); ++count)
        receive(large);
    receive(large); // the last one that is taken
    EXPECT_FALSE(ports.deliver(PortName, 0, large));
    loop.advance(SpectrelModel::RefreshInterval);
    receive(large);
}

TEST_F(SpectrelModelTest, SecondTickAfterOneMessageDoesNothing)
{
    model.startMonitor();
    receive(servingCell());
    loop.advance(4s);
    EXPECT_EQ(observer.reloads, 1);
    EXPECT_EQ(historyCount(), 1u);
}

TEST_F(SpectrelModelTest, TreeIsBuiltOnceUntilTheNextRefresh)
{
    model.startMonitor();
    receive(servingCell());
    const NodeRef root = model.topLevelNodes();
    EXPECT_EQ(root->displayName(), "Spectrel");
    EXPECT_EQ(model.topLevelNodes(), root);
    EXPECT_EQ(model.nodeAtPath("/"), root);
    EXPECT_EQ(historyCount(), 1u);
    loop.advance(2s);
    EXPECT_NE(model.topLevelNodes(), root);
}

TEST_F(SpectrelModelTest, PathThatTheNewTreeNoLongerHoldsHasNoNode)
{
    model.startMonitor();
    receive(RecordBuilder(1, 13));
    loop.advance(2s);
    EXPECT_NE(model.nodeAtPath("/Serving Cell Info/UARFCN"), nullptr);
    receive(servingCell());
    loop.advance(2s);
    EXPECT_EQ(model.nodeAtPath("/Serving Cell Info/UARFCN"), nullptr);
    EXPECT_EQ(model.nodeAtPath("Serving Cell Info"), nullptr) << "paths are taken exactly as given";
}

TEST_F(SpectrelModelTest, SaveContentsAreTheGenerators)
{
    model.startMonitor();
    receive(servingCell());
    loop.advance(2s);
    EXPECT_EQ(model.getSaveContents()->count(), 2u);
}

TEST_F(SpectrelModelTest, LastContentsHoldWhatNoRefreshHasSeen)
{
    model.startMonitor();
    receive(servingCell());
    const auto contents = model.displayState().lastContents();
    ASSERT_EQ(contents->count(), 2u);
    EXPECT_EQ((*(*contents)[0].dictionary())["DisplayState"].data()->size(), 38u);
}

TEST_F(SpectrelModelTest, ExceptionOfARecordEndsTheProcess)
{
    model.startMonitor();
    const Bytes garbage {1, 2, 3};
    EXPECT_DEATH(ports.deliver(PortName, 0, RecordBuilder::withPayload(0xFF0000, garbage)), "UnknownDataException");
}

} // namespace
} // namespace spectrel
