#include "Telephony/Sources/RelaySource.h"

#include "Telephony/ChannelQueue.h"
#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Fakes/FakeStreamInput.h"
#include "Tests/Fakes/RecordBuilder.h"
#include "Tests/Fakes/ScratchFolder.h"
#include "Tests/Telephony/Collector.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace spectrel {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class RelaySourceTest : public testing::Test {
protected:
    RelaySource& open(std::optional<Technology> technology = {})
    {
        auto made = std::make_unique<FakeStreamInput>();
        input = made.get();
        source = std::make_unique<RelaySource>(loop, std::move(made), technology, [this] { ++failures; });
        input->come();
        return *source;
    }
    static Bytes message(int number)
    {
        return RecordBuilder(0xB0C2, 13).u8(12, static_cast<std::uint32_t>(number)).bytes();
    }
    /// The bytes of a capture of these messages, byte 12 of each its number.
    Bytes capture(int first, int count, Technology technology = Technology::LTE)
    {
        const std::string path = scratch.file("x.pcap");
        const auto writer = *createRecording(path, technology);
        for (int number = first; number < first + count; ++number)
            EXPECT_TRUE(writer->write(Moment(std::chrono::seconds(1000 + number)), message(number)));
        EXPECT_TRUE(writer->flush());
        std::ifstream file(path, std::ios::binary);
        return {std::istreambuf_iterator<char>(file), {}};
    }
    static std::vector<int> numbers(const Collector& collector)
    {
        std::vector<int> numbers;
        for (const Bytes& each : collector.messages)
            numbers.push_back(each[12]);
        return numbers;
    }
    std::unique_ptr<LogStream> start(MessageSink& sink)
    {
        auto stream = source->start(sink);
        loop.runQueued();
        return stream;
    }

    FakeRunLoop loop;
    ScratchFolder scratch;
    std::unique_ptr<RelaySource> source;
    FakeStreamInput* input = nullptr;
    Collector collector;
    int failures = 0;
};

TEST_F(RelaySourceTest, EveryChannelHearsWhatComesFromItsStartOn)
{
    open(Technology::LTE);
    const auto first = start(collector);
    input->write(capture(1, 2));
    Collector late;
    const auto second = start(late);
    input->write(capture(3, 1));
    EXPECT_THAT(numbers(collector), ElementsAre(1, 2, 3));
    EXPECT_THAT(numbers(late), ElementsAre(3));
}

TEST_F(RelaySourceTest, TechnologyIsKnownOnceTheStreamHasNamedIt)
{
    open();
    EXPECT_FALSE(source->isReady());
    input->write(capture(1, 3, Technology::UTRAN));
    EXPECT_TRUE(source->isReady());
    EXPECT_EQ(source->technology(), Technology::UTRAN);
}

TEST_F(RelaySourceTest, WithoutListenersTheWriterWaitsAndNothingIsLost)
{
    open();
    input->write(capture(1, 3));
    EXPECT_TRUE(input->isPaused);
    const auto stream = start(collector);
    EXPECT_THAT(numbers(collector), ElementsAre(1, 2, 3));
    EXPECT_FALSE(input->isPaused);
}

TEST_F(RelaySourceTest, LoneSlowClientSlowsTheWriterAndLosesNothing)
{
    open();
    const auto stream = start(collector);
    collector.isFull = true;
    input->write(capture(1, 200));
    EXPECT_TRUE(input->isPaused);
    EXPECT_EQ(stream->waiting(), 1u) << "the rest has not left the stream yet";
    collector.isFull = false;
    stream->resume();
    EXPECT_EQ(collector.messages.size(), 200u);
    EXPECT_EQ(stream->lost(), 0u);
    EXPECT_FALSE(input->isPaused);
}

TEST_F(RelaySourceTest, ClientThatTakesNothingHarmsNoOther)
{
    open();
    Collector stuck;
    const auto first = start(collector);
    const auto second = start(stuck);
    stuck.isFull = true;
    for (int round = 0; round < 60; ++round)
        input->write(capture(round, 100));
    EXPECT_FALSE(input->isPaused);
    EXPECT_EQ(collector.messages.size(), 6000u);
    EXPECT_EQ(second->waiting(), ChannelQueue::MaxMessages);
    EXPECT_EQ(second->lost(), 6000 - ChannelQueue::MaxMessages);
    stuck.isFull = false;
    second->resume();
    EXPECT_EQ(stuck.messages.size(), ChannelQueue::MaxMessages);
    EXPECT_EQ(stuck.messages.back(), collector.messages.back()) << "the oldest are lost, the latest come";
}

/// A client that asks for some of the messages only and hears of its losses.
class LossyClient final : public MessageSink {
public:
    bool deliver(ByteView message) override
    {
        if (!wants(message))
            return true;
        if (isFull)
            return false;
        heard.push_back(std::to_string(message[12]));
        return true;
    }
    bool wants(ByteView message) const override
    {
        return message[12] % 2 == 0;
    }
    bool reportLoss(std::uint64_t messages) override
    {
        if (!isFull)
            heard.push_back("lost " + std::to_string(messages));
        return !isFull;
    }
    bool isFull = false;
    std::vector<std::string> heard;
};

TEST_F(RelaySourceTest, ClientHearsWhereItsMessagesAreMissing)
{
    open();
    const auto first = start(collector);
    LossyClient slow;
    const auto second = start(slow);
    slow.isFull = true;
    for (int round = 0; round < 100; ++round)
        input->write(capture(0, 100));
    EXPECT_EQ(second->waiting(), ChannelQueue::MaxMessages) << "of those it asked for";
    EXPECT_EQ(second->lost(), 5000 - ChannelQueue::MaxMessages);
    second->resume();
    EXPECT_TRUE(slow.heard.empty());
    slow.isFull = false;
    second->resume();
    ASSERT_EQ(slow.heard.size(), 1 + ChannelQueue::MaxMessages);
    EXPECT_EQ(slow.heard[0], "lost 904");
    EXPECT_EQ(slow.heard[1], "8") << "the one behind the 904th";
    input->write(capture(2, 1));
    EXPECT_EQ(slow.heard.back(), "2") << "and is told once";
}

TEST_F(RelaySourceTest, StreamThatOthersCanWriteHasToSayWhatItIs)
{
    auto made = std::make_unique<FakeStreamInput>();
    made->openToOthers = true;
    input = made.get();
    source = std::make_unique<RelaySource>(loop, std::move(made), Technology::LTE, [this] { ++failures; });
    const auto stream = start(collector);
    const std::string post = "POST / HTTP/1.1\r\nContent-Length: 4096\r\n\r\n";
    Bytes page(post.begin(), post.end());
    const Bytes bare = message(1);
    for (int copies = 0; copies < 3; ++copies)
        page.insert(page.end(), bare.begin(), bare.end());
    for (const Bytes& bytes : {page, bare}) {
        input->come();
        input->write(bytes);
        input->end();
    }
    EXPECT_EQ(input->dropped, 2);
    EXPECT_TRUE(collector.messages.empty());
    input->come();
    input->write(capture(3, 1));
    EXPECT_THAT(numbers(collector), ElementsAre(3));
}

TEST_F(RelaySourceTest, ClientsThatAllTakeNothingSlowTheWriter)
{
    open();
    Collector other;
    const auto first = start(collector);
    const auto second = start(other);
    collector.isFull = other.isFull = true;
    input->write(capture(1, 100));
    EXPECT_TRUE(input->isPaused);
    other.isFull = false;
    second->resume();
    EXPECT_EQ(other.messages.size(), 100u);
    EXPECT_FALSE(input->isPaused);
}

TEST_F(RelaySourceTest, NextWriterIsServedAgain)
{
    open();
    const auto stream = start(collector);
    input->write(capture(1, 2));
    input->end();
    input->come();
    input->write(capture(5, 1));
    EXPECT_THAT(numbers(collector), ElementsAre(1, 2, 5));
}

TEST_F(RelaySourceTest, WhatADeadWriterLeftBehindIsRelayedBeforeTheNextIsHeard)
{
    open();
    const auto stream = start(collector);
    collector.isFull = true;
    input->write(capture(1, 3));
    input->end("gone");
    EXPECT_TRUE(input->isPaused) << "or the next writer's bytes would mix with them";
    collector.isFull = false;
    stream->resume();
    EXPECT_THAT(numbers(collector), ElementsAre(1, 2, 3));
    EXPECT_FALSE(input->isPaused);
}

TEST_F(RelaySourceTest, OtherTechnologyEndsTheChannelsBeforeItsMessagesCome)
{
    open();
    std::unique_ptr<LogStream> stream = start(collector);
    source->setBasebandHandler([&stream] { stream.reset(); });
    input->write(capture(1, 1, Technology::LTE));
    input->end();
    input->come();
    input->write(capture(2, 1, Technology::GSM));
    EXPECT_EQ(source->technology(), Technology::GSM);
    loop.runQueued();
    EXPECT_EQ(stream, nullptr);
    EXPECT_THAT(numbers(collector), ElementsAre(1));
    Collector next;
    stream = start(next);
    EXPECT_THAT(numbers(next), ElementsAre(2)) << "they wait for a channel of their technology";
}

TEST_F(RelaySourceTest, LoneItemsComeAfterAMoment)
{
    open(Technology::LTE);
    const auto stream = start(collector);
    const Bytes item = message(7);
    input->write(ByteView(item).subspan(1));
    EXPECT_THAT(numbers(collector), IsEmpty());
    loop.advance(RelaySource::SettlingTime);
    EXPECT_THAT(numbers(collector), ElementsAre(7));
}

TEST_F(RelaySourceTest, StreamThatCannotBeUsedIsDroppedAndTheNextIsServed)
{
    open();
    const auto stream = start(collector);
    const Bytes garbage(100, 'x');
    input->write(garbage);
    EXPECT_EQ(input->dropped, 1);
    input->come();
    input->write(capture(1, 1));
    loop.runQueued();
    EXPECT_THAT(numbers(collector), ElementsAre(1));
    EXPECT_EQ(failures, 0);
}

TEST_F(RelaySourceTest, OnlyStreamThatCannotBeUsedIsAFailure)
{
    open();
    input->furtherWriters = false;
    const Bytes garbage(100, 'x');
    input->write(garbage);
    loop.runQueued();
    EXPECT_EQ(failures, 1);
}

TEST_F(RelaySourceTest, OnlyStreamThatEndsWithoutNamingItsTechnologyIsAFailure)
{
    open();
    input->furtherWriters = false;
    input->end();
    loop.runQueued();
    EXPECT_EQ(failures, 1);
    open(Technology::LTE);
    input->furtherWriters = false;
    input->end();
    loop.runQueued();
    EXPECT_EQ(failures, 1) << "with a technology the service stays, silent";
}

TEST_F(RelaySourceTest, EndOfAClientInTheMiddleOfTheStreamIsNoHarm)
{
    open();
    auto first = start(collector);
    Collector other;
    const auto second = start(other);
    input->write(capture(1, 2));
    first.reset();
    input->write(capture(3, 2));
    EXPECT_THAT(numbers(other), ElementsAre(1, 2, 3, 4));
}

TEST_F(RelaySourceTest, StatusShowsWhatWasRelayedAndSkipped)
{
    open();
    const auto stream = start(collector);
    Bytes damaged = capture(1, 3);
    damaged.erase(damaged.begin() + 30, damaged.begin() + 34);
    input->write(damaged);
    EXPECT_EQ(source->status(), "fake: 2 messages relayed, 25 bytes skipped at 1 place");
    input->end();
    EXPECT_EQ(source->status(), "fake: 2 messages relayed, 25 bytes skipped at 1 place, no writer");
}

} // namespace
} // namespace spectrel
