#include "CommandLine/Program/RecorderPort.h"

#include "Tests/Fakes/FakeMessagePorts.h"
#include "Values/Dictionary.h"
#include "Values/PropertyList/PropertyList.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

constexpr const char* Port = "org.spectrel.Record.7.Marks";

class RecorderPortTest : public testing::Test {
protected:
    RecorderPortTest()
    {
        // What is sent to the port reaches whoever serves it.
        ports.answer = [this](const FakeMessagePorts::Sent& sent) {
            return FakeMessagePorts::Answer {
                SendStatus::Success, ports.request(Port, sent.id, Bytes(sent.body.begin(), sent.body.end()))};
        };
    }
    RecorderPort::Handlers handlers()
    {
        return {[this] { return recording; },
            [this](const std::string& note) {
                notes.push_back(note);
                return recording;
            }};
    }
    std::string mark(const std::vector<std::string>& names, const std::string& note = "tunnel")
    {
        const auto marked = markRunningRecording(ports, names, note);
        return marked ? *marked : "failed: " + marked.failure().text;
    }

    FakeMessagePorts ports;
    Result<std::string> recording = std::string("/r/drive.pcap");
    std::vector<std::string> notes;
};

TEST_F(RecorderPortTest, OneRecorderTakesTheNote)
{
    const RecorderPort port(ports, "org.spectrel.Record.7", handlers());
    EXPECT_EQ(mark({Port}, "tunnel <south> & \"north\""), "/r/drive.pcap");
    EXPECT_EQ(notes, std::vector<std::string> {"tunnel <south> & \"north\""});
}

TEST_F(RecorderPortTest, WithoutARecorderItFails)
{
    EXPECT_EQ(mark({}), "failed: no recorder is running; name a recording with --recording");
    ports.refuseRemote = true; // a name left by a dead process
    EXPECT_EQ(mark({Port}), "failed: no recorder is running; name a recording with --recording");
}

TEST_F(RecorderPortTest, SeveralRecordersAreNamedAndNoneIsMarked)
{
    const RecorderPort port(ports, "org.spectrel.Record.7", handlers());
    EXPECT_EQ(mark({Port, "org.spectrel.Record.8.Marks"}),
        "failed: several recorders are running (/r/drive.pcap, /r/drive.pcap); name a recording with --recording");
    EXPECT_TRUE(notes.empty());
}

TEST_F(RecorderPortTest, RecorderSaysWhyItCannot)
{
    recording = Failure {"the recorder has no file yet"};
    const RecorderPort port(ports, "org.spectrel.Record.7", handlers());
    EXPECT_EQ(mark({Port}), "failed: the recorder has no file yet");
}

TEST_F(RecorderPortTest, RecorderThatDoesNotAnswerIsReported)
{
    ports.answer = [](const FakeMessagePorts::Sent&) {
        return FakeMessagePorts::Answer {SendStatus::ReceiveTimeout, std::nullopt};
    };
    EXPECT_EQ(mark({Port}), "failed: the recorder at org.spectrel.Record.7.Marks does not answer");
    ports.answer = [](const FakeMessagePorts::Sent&) {
        return FakeMessagePorts::Answer {SendStatus::Success, Bytes {'x'}};
    };
    EXPECT_EQ(mark({Port}), "failed: the recorder at org.spectrel.Record.7.Marks gives no answer that is understood");
}

TEST_F(RecorderPortTest, NoteThatCannotBeSentIsRefused)
{
    EXPECT_EQ(mark({Port}, "bell\a"), "failed: the text holds control characters that it cannot be sent with");
    EXPECT_TRUE(ports.sent.empty());
}

TEST_F(RecorderPortTest, AnyOtherRequestIsAnError)
{
    const RecorderPort port(ports, "org.spectrel.Record.7", handlers());
    for (const std::string request : {"", "nonsense", "<plist><string>a</string></plist>", "<plist><dict/></plist>"}) {
        const auto body = ports.request(Port, 0, Bytes(request.begin(), request.end()));
        ASSERT_TRUE(body) << request;
        const auto reply = parsePropertyList(*body);
        ASSERT_TRUE(reply) << request;
        EXPECT_EQ(*(*reply->dictionary())["Error"].string(), "not a request of bookmarks");
    }
    EXPECT_TRUE(notes.empty());
}

TEST_F(RecorderPortTest, PortIsFreedAtTheEnd)
{
    {
        const RecorderPort port(ports, "org.spectrel.Record.7", handlers());
        EXPECT_EQ(ports.localPorts(), 1U);
    }
    EXPECT_EQ(ports.localPorts(), 0U);
}

} // namespace
} // namespace spectrel
