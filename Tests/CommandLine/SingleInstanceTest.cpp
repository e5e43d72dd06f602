#include "CommandLine/Program/SingleInstance.h"
#include "Tests/Fakes/FakeMessagePorts.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace spectrel {
namespace {

class SingleInstanceTest : public testing::Test {
protected:
    void serve(SingleInstance& instance)
    {
        instance.serve([this](const std::string& token) { tokens.push_back(token); });
    }
    void deliver(std::int32_t id, const std::string& text)
    {
        ports.deliver(SingleInstance::PortName, id, Bytes(text.begin(), text.end()));
    }

    FakeMessagePorts ports;
    std::vector<std::string> tokens;
};

TEST_F(SingleInstanceTest, FirstOneFindsNobodyToActivate)
{
    ports.refuseRemote = true;
    SingleInstance instance(ports);
    EXPECT_FALSE(instance.activateOther("token"));
}

TEST_F(SingleInstanceTest, LaterOneHandsItsTokenOver)
{
    SingleInstance instance(ports);
    EXPECT_TRUE(instance.activateOther("abc"));
    ASSERT_EQ(ports.sent.size(), 1U);
    EXPECT_EQ(ports.sent[0].replyMode, ReplyMode::Wait);
    SingleInstance first(ports);
    serve(first);
    deliver(ports.sent[0].id, ports.sent[0].body);
    EXPECT_EQ(tokens, std::vector<std::string> {"abc"});
}

TEST_F(SingleInstanceTest, TokenMayBeMissing)
{
    SingleInstance instance(ports);
    EXPECT_TRUE(instance.activateOther(""));
    serve(instance);
    deliver(ports.sent[0].id, ports.sent[0].body);
    deliver(ports.sent[0].id, "nonsense");
    EXPECT_EQ(tokens, (std::vector<std::string> {"", ""}));
}

TEST_F(SingleInstanceTest, OneThatDoesNotAnswerIsNoReasonToGo)
{
    ports.answer = [](const FakeMessagePorts::Sent&) {
        return FakeMessagePorts::Answer {SendStatus::ReceiveTimeout, std::nullopt};
    };
    SingleInstance instance(ports);
    EXPECT_FALSE(instance.activateOther(""));
}

TEST_F(SingleInstanceTest, OtherMessagesActivateNothing)
{
    SingleInstance instance(ports);
    serve(instance);
    deliver(7, "token:abc");
    EXPECT_TRUE(tokens.empty());
}

TEST_F(SingleInstanceTest, PortIsFreedAtTheEnd)
{
    {
        SingleInstance instance(ports);
        serve(instance);
        EXPECT_EQ(ports.localPorts(), 1U);
    }
    EXPECT_EQ(ports.localPorts(), 0U);
}

} // namespace
} // namespace spectrel
