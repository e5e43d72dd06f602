#include "Monitor/Session.h"

#include "Records/TelephonyConstants.h"
#include "Tests/Fakes/FakeMessagePorts.h"
#include "Tests/Fakes/FakeResources.h"
#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Values/Dictionary.h"
#include "Values/PropertyList/PropertyList.h"

#include <gtest/gtest.h>
#include <memory>
#include <optional>
#include <string>

namespace spectrel {
namespace {

constexpr const char* PortName = "test.BasebandStateReport.LogChannel";

/// Counts what it receives.
class Sink final : public SessionSink {
public:
    void useTechnology(const Value& technology) override
    {
        current = LogGenerator::generatorFromTechnology(technology, {});
    }
    LogGenerator* generator() override
    {
        return current.get();
    }
    void receive(ByteView body) override
    {
        received += body.size();
    }
    void sessionDidTick() override
    {
        ++ticks;
    }
    void sessionDidChange() override
    {
        ++changes;
    }
    std::unique_ptr<LogGenerator> current;
    std::size_t received = 0;
    int ticks = 0;
    int changes = 0;
};

class SessionTest : public testing::Test {
protected:
    SessionTest()
    {
        answerTechnology(kRKLogChannelTechnology_IFX);
        ports.answer = [this](const FakeMessagePorts::Sent& request) -> FakeMessagePorts::Answer {
            if (request.replyMode == ReplyMode::Wait)
                return {technologyStatus, technologyReply};
            return {startStatus, std::nullopt};
        };
    }
    void answerTechnology(const Value& technology)
    {
        const auto text = serialisePropertyList(Dictionary::make({{"GetTechnology", technology}}));
        technologyReply = Bytes(text->begin(), text->end());
    }
    SessionLossCause causeOfAttempt()
    {
        session.restart();
        EXPECT_FALSE(session.isConnected());
        EXPECT_NE(session.loss().text, "");
        return session.loss().cause;
    }

    FakeRunLoop loop;
    LogRecorder log;
    FakeResources resources;
    FakeMessagePorts ports;
    FakeTelephonyServer telephony;
    Sink sink;
    Session session {{loop, ports, telephony, {loop, resources, log, log}}, sink, "test"};
    SendStatus technologyStatus = SendStatus::Success;
    SendStatus startStatus = SendStatus::Success;
    std::optional<Bytes> technologyReply;
};

TEST_F(SessionTest, MessagesReachTheSinkAsDelivered)
{
    session.start();
    const Bytes message {1, 2, 3};
    EXPECT_TRUE(ports.deliver(PortName, 0, message));
    EXPECT_TRUE(ports.deliver(PortName, 1, message));
    EXPECT_EQ(sink.received, 3u);
    EXPECT_EQ(session.technology(), kRKLogChannelTechnology_IFX);
}

TEST_F(SessionTest, TicksReachTheSinkWhileTheSessionRuns)
{
    session.start();
    loop.advance(3 * DisplayState::RefreshInterval);
    EXPECT_EQ(sink.ticks, 3);
    session.destroyPorts();
    loop.advance(3 * DisplayState::RefreshInterval);
    EXPECT_EQ(sink.ticks, 3);
}

TEST_F(SessionTest, PausedSessionTakesNoMessageUntilTheNextTick)
{
    session.start();
    const Bytes message {1};
    session.pause();
    EXPECT_FALSE(ports.deliver(PortName, 0, message));
    loop.advance(DisplayState::RefreshInterval);
    EXPECT_TRUE(ports.deliver(PortName, 0, message));
}

TEST_F(SessionTest, EachLossHasItsCause)
{
    telephony.isRunning = false;
    EXPECT_EQ(causeOfAttempt(), SessionLossCause::NoService);
    telephony.isRunning = true;
    telephony.result = {1, -42, "channel"};
    EXPECT_EQ(causeOfAttempt(), SessionLossCause::ChannelRefused);
    EXPECT_EQ(session.loss().text, "_RKServerConnectionNetworkMonitorCreateLogChannel returns error: -42");
    telephony.result = {0, 0, ""};
    EXPECT_EQ(causeOfAttempt(), SessionLossCause::NoChannel);
    EXPECT_EQ(session.loss().text, "Could not create a log channel (RK returned null port)");
    telephony.result = {0, 0, "channel"};
    technologyStatus = SendStatus::SendTimeout;
    EXPECT_EQ(causeOfAttempt(), SessionLossCause::RequestNotSent);
    EXPECT_EQ(session.loss().text, "Could not send the GetTechnology command (got error=-1)");
    technologyStatus = SendStatus::Success;
    answerTechnology("Martian");
    EXPECT_EQ(causeOfAttempt(), SessionLossCause::UnknownTechnology);
    answerTechnology(kRKLogChannelTechnology_IFX);
    startStatus = SendStatus::SendTimeout;
    EXPECT_EQ(causeOfAttempt(), SessionLossCause::CommandNotSent);
    EXPECT_EQ(session.loss().text, "Could not send the START command (got error=-1)");
    startStatus = SendStatus::Success;
    ports.refuseRemote = true;
    EXPECT_EQ(causeOfAttempt(), SessionLossCause::NoRemotePort);
    EXPECT_EQ(session.loss().text, "Could not create the remote port");
    ports.refuseRemote = false;
    session.restart();
    EXPECT_EQ(session.loss().cause, SessionLossCause::None);
    EXPECT_EQ(session.loss().text, "");
}

TEST_F(SessionTest, NamelessSessionHasNoPorts)
{
    Session nameless {{loop, ports, telephony, {loop, resources, log, log}}, sink, ""};
    nameless.start();
    EXPECT_EQ(nameless.loss().cause, SessionLossCause::NoPorts);
    EXPECT_EQ(nameless.loss().text, "Could not create the ports necessary");
}

TEST_F(SessionTest, SinkHearsOfAnotherCauseAndNotOfTheSameAgain)
{
    telephony.isRunning = false;
    session.start();
    EXPECT_EQ(sink.changes, 1);
    loop.advance(Session::RetryDelay);
    EXPECT_EQ(sink.changes, 1);
    telephony.isRunning = true;
    loop.advance(Session::RetryDelay);
    EXPECT_EQ(sink.changes, 2);
    EXPECT_TRUE(session.isConnected());
}

} // namespace
} // namespace spectrel
