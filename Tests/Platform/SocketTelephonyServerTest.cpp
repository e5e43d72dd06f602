#include "Platform/Sockets/SocketTelephonyServer.h"
#include "Tests/Fakes/FakeMessagePorts.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace spectrel {
namespace {

using testing::HasSubstr;

class SocketTelephonyServerTest : public testing::Test {
protected:
    static Bytes list(const std::string& content)
    {
        const std::string text = "<?xml version=\"1.0\"?><plist version=\"1.0\">" + content + "</plist>";
        return {text.begin(), text.end()};
    }
    void answer(SendStatus status, std::optional<Bytes> reply)
    {
        ports.answer = [=](const FakeMessagePorts::Sent&) { return FakeMessagePorts::Answer {status, reply}; };
    }
    LogChannelResult createLogChannel()
    {
        const auto connection = server.RKServerConnectionCreate({});
        return connection->RKServerConnectionNetworkMonitorCreateLogChannel("my.port");
    }

    FakeMessagePorts ports;
    SocketTelephonyServer server {ports};
};

TEST_F(SocketTelephonyServerTest, NoConnectionWhenNobodyServesTheName)
{
    ports.refuseRemote = true;
    EXPECT_EQ(server.RKServerConnectionCreate({}), nullptr);
}

TEST_F(SocketTelephonyServerTest, AsksWithIdOneAndASecondsPatience)
{
    createLogChannel();
    ASSERT_EQ(ports.sent.size(), 1U);
    EXPECT_EQ(ports.sent[0].id, 1);
    EXPECT_THAT(ports.sent[0].body, HasSubstr("<key>CreateLogChannel</key>"));
    EXPECT_THAT(ports.sent[0].body, HasSubstr("<string>my.port</string>"));
    EXPECT_EQ(ports.sent[0].sendTimeout, std::chrono::seconds(1));
    EXPECT_EQ(ports.sent[0].receiveTimeout, std::chrono::seconds(1));
    EXPECT_EQ(ports.sent[0].replyMode, ReplyMode::Wait);
}

TEST_F(SocketTelephonyServerTest, HandsOutTheServicesPort)
{
    answer(SendStatus::Success,
        list("<dict><key>Error</key><integer>0</integer><key>Domain</key><integer>0</integer>"
             "<key>PortName</key><string>channel.1</string></dict>"));
    const auto result = createLogChannel();
    EXPECT_EQ(result.error, 0);
    EXPECT_EQ(result.portName, "channel.1");
}

TEST_F(SocketTelephonyServerTest, HandsOnTheServicesError)
{
    answer(SendStatus::Success,
        list("<dict><key>Error</key><integer>12</integer><key>Domain</key><integer>3</integer></dict>"));
    const auto result = createLogChannel();
    EXPECT_EQ(result.error, 12);
    EXPECT_EQ(result.domain, 3);
    EXPECT_EQ(result.portName, std::nullopt);
}

TEST_F(SocketTelephonyServerTest, SendStatusIsTheErrorWhenTheServiceIsNotReached)
{
    for (const auto status : {SendStatus::SendTimeout, SendStatus::ReceiveTimeout, SendStatus::Invalid,
             SendStatus::TransportError, SendStatus::BecameInvalid}) {
        answer(status, std::nullopt);
        const auto result = createLogChannel();
        EXPECT_EQ(result.error, static_cast<std::int32_t>(status));
        EXPECT_EQ(result.domain, SocketTelephonyServer::TransportDomain);
        EXPECT_EQ(result.portName, std::nullopt);
    }
}

TEST_F(SocketTelephonyServerTest, AbsentAnswerIsAnError)
{
    answer(SendStatus::Success, std::nullopt);
    EXPECT_EQ(createLogChannel().error, SocketTelephonyServer::NoAnswer);
}

class UnreadableAnswerTest : public SocketTelephonyServerTest, public testing::WithParamInterface<std::string> { };

TEST_P(UnreadableAnswerTest, IsAnError)
{
    const std::string content = GetParam();
    answer(SendStatus::Success, content.front() == '<' ? list(content) : Bytes(content.begin(), content.end()));
    const auto result = createLogChannel();
    EXPECT_EQ(result.error, SocketTelephonyServer::UnreadableAnswer);
    EXPECT_EQ(result.portName, std::nullopt);
}

INSTANTIATE_TEST_SUITE_P(Answers, UnreadableAnswerTest,
    testing::Values("garbage", "<string>no dictionary</string>", "<dict></dict>",
        "<dict><key>PortName</key><string>no error</string></dict>",
        "<dict><key>Error</key><string>0</string><key>PortName</key><string>p</string></dict>"));

} // namespace
} // namespace spectrel
