#include "Telephony/TelephonyService.h"

#include "Platform/TelephonyProtocol.h"
#include "Records/TelephonyConstants.h"
#include "Telephony/StatusReport.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/FakeMessagePorts.h"
#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Fakes/RecordBuilder.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyList.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;
using TelephonyProtocol::ChannelError;
using testing::ElementsAre;
namespace Protocol = TelephonyProtocol;

/// Hands its messages over at once and remembers who listens.
class ListSource final : public LogSource {
public:
    class Stream final : public LogStream {
    public:
        Stream(ListSource& source, MessageSink& sink)
            : _source(source)
            , _sink(sink)
        {
            ++_source.streams;
            resume();
        }
        ~Stream() override
        {
            --_source.streams;
        }
        void resume() override
        {
            while (_next < _source.messages.size() && _sink.deliver(_source.messages[_next]))
                ++_next;
        }

    private:
        ListSource& _source;
        MessageSink& _sink;
        std::size_t _next = 0;
    };

    Technology technology() const override
    {
        return Technology::GSM;
    }
    bool isReady() const override
    {
        return ready;
    }
    std::string status() const override
    {
        return "a list";
    }
    void setBasebandHandler(std::function<void()> handler) override
    {
        basebandHandler = std::move(handler);
    }
    std::unique_ptr<LogStream> start(MessageSink& sink) override
    {
        return std::make_unique<Stream>(*this, sink);
    }
    std::vector<Bytes> messages;
    int streams = 0;
    bool ready = true;
    std::function<void()> basebandHandler;
};

class TelephonyServiceTest : public testing::Test {
protected:
    TelephonyServiceTest()
    {
        EXPECT_TRUE(service.start());
        for (const std::uint32_t code : {0xB0C2u, 0xB0C1u, 0xFF0001u})
            source.messages.push_back(RecordBuilder(code, 13).bytes());
    }

    Value ask(const std::string& port, std::int32_t id, const Value& request)
    {
        const auto text = serialisePropertyList(request);
        const auto reply = ports.request(port, id, Bytes(text->begin(), text->end()));
        const auto value = reply ? parsePropertyList(*reply) : std::nullopt;
        return value.value_or(Value());
    }
    Value askService(const Value& request, std::int32_t id = Protocol::CreateLogChannelId)
    {
        return ask(std::string(Protocol::ServicePort), id, request);
    }
    Value askForChannel(const Value& client = "client")
    {
        return askService(Dictionary::make({{Protocol::CreateLogChannelKey, client}}));
    }
    static ChannelError errorOf(const Value& reply)
    {
        return static_cast<ChannelError>((*reply.dictionary())[Protocol::ErrorKey].int32().value_or(-1));
    }
    std::string openChannel(const std::string& client = "client")
    {
        return *(*askForChannel(client).dictionary())[Protocol::PortNameKey].string();
    }
    void start(const std::string& channel, ListRef ordinary, ListRef extra)
    {
        auto command = Dictionary::make({{Protocol::SetStateKey, Protocol::StreamingState}});
        command->set(Protocol::OrdinaryCodesKey, ordinary);
        command->set(Protocol::ExtraCodesKey, extra);
        ports.sent.clear();
        EXPECT_TRUE(ask(channel, Protocol::LogChannelId, command).isAbsent()) << "a start command is not answered";
    }
    static ListRef codes(std::initializer_list<int> numbers)
    {
        auto list = List::make();
        for (const int number : numbers)
            list->append(Value::integer(number));
        return list;
    }

    FakeRunLoop loop;
    FakeMessagePorts ports;
    ListSource source;
    TelephonyService service {loop, loop, ports, source};
};

TEST_F(TelephonyServiceTest, ChannelIsOpenedWithAPortOfItsOwn)
{
    EXPECT_EQ(displayText(askForChannel()),
        "{\"Domain\": int 0, \"Error\": int 0, \"PortName\": \"org.spectrel.Telephony.LogChannel.1\"}");
    EXPECT_NE(openChannel("other"), openChannel("third"));
    EXPECT_EQ(service.channels(), 3u);
}

TEST_F(TelephonyServiceTest, MalformedWishGetsAnErrorAndNoChannel)
{
    for (const Value& client : {Value(""), Value::integer(1)})
        EXPECT_EQ(errorOf(askForChannel(client)), ChannelError::MalformedRequest) << displayText(client);
    for (const Value& request : {Value(Dictionary::make()), Value(List::make())})
        EXPECT_EQ(errorOf(askService(request)), ChannelError::MalformedRequest) << displayText(request);
    EXPECT_EQ(errorOf(askService(Dictionary::make(), 9)), ChannelError::MalformedRequest);
    const Bytes garbage {1, 2};
    EXPECT_TRUE(ports.request(std::string(Protocol::ServicePort), Protocol::CreateLogChannelId, garbage));
    EXPECT_EQ(service.channels(), 0u);
}

TEST_F(TelephonyServiceTest, ClientWithoutAPortGetsAnError)
{
    ports.refuseRemote = true;
    EXPECT_EQ(errorOf(askForChannel("gone")), ChannelError::NoSuchPort);
}

TEST_F(TelephonyServiceTest, ChannelsAreBounded)
{
    for (std::size_t count = 0; count < TelephonyService::MaxChannels; ++count)
        openChannel();
    EXPECT_EQ(errorOf(askForChannel()), ChannelError::TooManyChannels);
}

TEST_F(TelephonyServiceTest, TechnologyIsTheSources)
{
    EXPECT_EQ(displayText(ask(openChannel(), Protocol::LogChannelId,
                  Dictionary::make({{Protocol::GetTechnologyKey, Protocol::GetTechnologyKey}}))),
        "{\"GetTechnology\": \"kRKLogChannelTechnology_Zephyr_GSM\"}");
}

TEST_F(TelephonyServiceTest, OnlyTheRequestedCodesAreStreamed)
{
    const std::string channel = openChannel();
    start(channel, codes({0xB0C2}), codes({1}));
    ASSERT_EQ(ports.sent.size(), 2u);
    EXPECT_EQ(ports.sent[0].id, Protocol::LogChannelId);
    EXPECT_EQ(ports.sent[0].body[4], '\xB0');
    EXPECT_EQ(ports.sent[1].body[0], '\xFF');
    start(channel, codes({}), codes({}));
    EXPECT_TRUE(ports.sent.empty());
    start(channel, codes({0xB0C2, 0xB0C1}), nullptr);
    EXPECT_EQ(ports.sent.size(), 2u) << "an absent list wants nothing of its stream";
    EXPECT_EQ(source.streams, 1) << "a further start command replaces the stream";
}

TEST_F(TelephonyServiceTest, StartWithoutAnyCodeListStreamsEverything)
{
    start(openChannel(), nullptr, nullptr);
    EXPECT_EQ(ports.sent.size(), 3u);
}

TEST_F(TelephonyServiceTest, MalformedRequestsGetAnErrorAnswer)
{
    const std::string channel = openChannel();
    const Value requests[] = {Dictionary::make({{Protocol::SetStateKey, "Idle"}}), List::make(),
        Protocol::StreamingState,
        Dictionary::make({{Protocol::SetStateKey, Protocol::StreamingState}, {Protocol::OrdinaryCodesKey, "all"}}),
        Dictionary::make(
            {{Protocol::SetStateKey, Protocol::StreamingState}, {Protocol::OrdinaryCodesKey, codes({65536})}}),
        Dictionary::make({{Protocol::SetStateKey, Protocol::StreamingState}, {Protocol::ExtraCodesKey, codes({-1})}})};
    for (const Value& request : requests)
        EXPECT_TRUE((*ask(channel, Protocol::LogChannelId, request).dictionary())[Protocol::ErrorKey].string())
            << displayText(request);
    EXPECT_TRUE((*ask(channel, 7, requests[0]).dictionary())[Protocol::ErrorKey].string());
    EXPECT_EQ(source.streams, 0);
}

TEST_F(TelephonyServiceTest, DeathOfAClientFreesItsChannelAndNoOther)
{
    start(openChannel("first"), codes({0xB0C2}), nullptr);
    EXPECT_EQ(source.streams, 1);
    ports.killPeers();
    start(openChannel("second"), codes({0xB0C2}), nullptr);
    loop.runQueued();
    EXPECT_EQ(service.channels(), 1u);
    EXPECT_EQ(source.streams, 1);
    EXPECT_EQ(ports.localPorts(), 2u) << "the service's and the second channel's";
}

TEST_F(TelephonyServiceTest, FullClientStopsTheStreamUntilThereIsRoom)
{
    bool isFull = true;
    ports.answer = [&isFull](const auto&) {
        return FakeMessagePorts::Answer {isFull ? SendStatus::SendTimeout : SendStatus::Success, {}};
    };
    start(openChannel(), nullptr, nullptr);
    EXPECT_EQ(ports.sent.size(), 1u) << "one attempt";
    isFull = false;
    ports.makeRoom();
    EXPECT_EQ(ports.sent.size(), 4u);
}

TEST_F(TelephonyServiceTest, SourceThatIsNotReadyHasNoChannels)
{
    source.ready = false;
    EXPECT_EQ(errorOf(askForChannel()), ChannelError::NotReady);
    EXPECT_EQ(service.channels(), 0u);
    source.ready = true;
    EXPECT_EQ(errorOf(askForChannel()), ChannelError::None);
}

TEST_F(TelephonyServiceTest, StatusShowsWhatIsStreamedToWhom)
{
    StatusReport report(loop, service, source);
    EXPECT_THAT(report.lines(), ElementsAre("a list; 0 clients"));
    const std::string channel = openChannel("org.spectrel.Watch.7.BasebandStateReport.LogChannel");
    EXPECT_TRUE(report.hasNews());
    EXPECT_THAT(report.lines(),
        ElementsAre("a list; 1 client, 0.0 messages/s", "  channel 1 to org.spectrel.Watch.7: not started"));
    start(channel, codes({0xB0C2}), codes({1}));
    loop.advance(2s);
    EXPECT_THAT(report.lines(),
        ElementsAre("a list; 1 client, 1.0 messages/s",
            "  channel 1 to org.spectrel.Watch.7: 2 codes, 1.0 messages/s, 2 sent, 1 not asked for, 0 queued"));
    EXPECT_FALSE(report.hasNews());
    loop.advance(2s);
    EXPECT_EQ(report.headline(), "a list; 1 client, 0.0 messages/s") << "rates count from the report before";
}

TEST_F(TelephonyServiceTest, ClockThatIsSetChangesNoRate)
{
    StatusReport report(loop, service, source);
    start(openChannel("org.spectrel.Watch.7.BasebandStateReport.LogChannel"), codes({0xB0C2}), codes({1}));
    loop.setClock(-1h);
    loop.advance(2s);
    EXPECT_EQ(report.headline(), "a list; 1 client, 1.0 messages/s");
}

TEST_F(TelephonyServiceTest, ComingAndGoingOfChannelsIsAChange)
{
    int changes = 0;
    service.setChangeHandler([&changes] { ++changes; });
    openChannel();
    EXPECT_EQ(changes, 1);
    ports.killPeers();
    loop.runQueued();
    EXPECT_EQ(changes, 2);
}

TEST_F(TelephonyServiceTest, ChangeOfBasebandEndsAllChannelsAndTheServiceStays)
{
    start(openChannel(), nullptr, nullptr);
    openChannel("other");
    source.basebandHandler();
    EXPECT_EQ(service.channels(), 0u);
    EXPECT_EQ(source.streams, 0);
    EXPECT_EQ(ports.localPorts(), 1u) << "the service's own";
    EXPECT_EQ(openChannel(), "org.spectrel.Telephony.LogChannel.3");
}

TEST_F(TelephonyServiceTest, SecondServiceIsRefused)
{
    TelephonyService second(loop, loop, ports, source);
    EXPECT_FALSE(second.start());
}

} // namespace
} // namespace spectrel
