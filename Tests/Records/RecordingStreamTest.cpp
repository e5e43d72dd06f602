#include "Records/RecordingStream.h"

#include "Tests/Records/RecordingText.h"
#include "Values/Bytes.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace spectrel {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

std::string captureHead(std::uint32_t linkType = 150, std::uint32_t magic = 0xA1B2C3D4)
{
    return u32(magic) + u16(2) + u16(4) + u32(0) + u32(0) + u32(262144) + u32(linkType);
}

std::string packet(const std::string& body, std::uint32_t fraction = 0)
{
    const auto length = static_cast<std::uint32_t>(body.size());
    return u32(1'700'000'000) + u32(fraction) + u32(length) + u32(length) + body;
}

/// The same numbers with their high byte first.
std::string swappedWords(const std::string& words)
{
    std::string swapped;
    for (std::size_t place = 0; place < words.size(); place += 4)
        swapped += {words[place + 3], words[place + 2], words[place + 1], words[place]};
    return swapped;
}

/// What a stream yields, one line a step: "lte", "message TEXT", "skipped N at OFFSET: REASON", "refused: REASON".
class Heard {
public:
    explicit Heard(std::optional<Technology> technology)
        : _stream(makeRecordingStream(technology))
    {
    }
    void append(std::string_view bytes)
    {
        _stream->append(viewOf(bytes));
        takeAll();
    }
    void settle()
    {
        _stream->settle();
        takeAll();
    }
    std::vector<std::string> finish()
    {
        _stream->finish();
        takeAll();
        return lines;
    }
    std::vector<std::string> lines;
    std::vector<std::int64_t> times; // microseconds since 1970, of the messages

private:
    void takeAll()
    {
        RecordedMessage message;
        for (;;) {
            switch (_stream->next(message)) {
            case StreamStep::Waiting:
                return;
            case StreamStep::Begin:
                lines.emplace_back(technologyName(*_stream->technology()));
                break;
            case StreamStep::Message:
                lines.push_back("message " + std::string(message.body.begin(), message.body.end()));
                times.push_back(message.time.time_since_epoch().count());
                break;
            case StreamStep::Skipped:
                lines.push_back("skipped " + std::to_string(_stream->skipped().length) + " at "
                    + std::to_string(_stream->skipped().offset) + ": " + _stream->skipped().reason);
                break;
            case StreamStep::Refused:
                if (lines.empty() || !lines.back().starts_with("refused"))
                    lines.push_back("refused: " + _stream->reason());
                return;
            }
        }
    }
    std::unique_ptr<RecordingStream> _stream;
};

/// The stream in one piece; the same must come from it cut at any place, and byte by byte.
std::vector<std::string> read(const std::string& bytes, std::optional<Technology> technology = {})
{
    Heard whole(technology);
    whole.append(bytes);
    const auto expected = whole.finish();
    for (std::size_t place = 1; place < bytes.size(); ++place) {
        Heard cut(technology);
        cut.append(std::string_view(bytes).substr(0, place));
        cut.append(std::string_view(bytes).substr(place));
        EXPECT_EQ(cut.finish(), expected) << "cut at byte " << place;
    }
    Heard bytewise(technology);
    for (const char byte : bytes)
        bytewise.append({&byte, 1});
    EXPECT_EQ(bytewise.finish(), expected) << "byte by byte";
    return expected;
}

const std::string First = record(0xB0C2, "first payload");
const std::string Second = wrapped(record(0xB0C3, "second one"));
const std::string Third = record(0x0001, "<plist/>", '\xFF');
const std::string Capture = captureHead() + packet(First) + packet(Second) + packet(Third);

TEST(CaptureStreamTest, MessagesComeOutAsTheyWentIn)
{
    EXPECT_THAT(read(Capture), ElementsAre("lte", "message " + First, "message " + Second, "message " + Third));
}

TEST(CaptureStreamTest, MessageComesWithItsLastByte)
{
    Heard heard({});
    heard.append(std::string_view(Capture).substr(0, 24 + 16 + First.size() - 1));
    EXPECT_THAT(heard.lines, ElementsAre("lte"));
    heard.append(std::string_view(Capture).substr(24 + 16 + First.size() - 1, 1));
    EXPECT_THAT(heard.lines, ElementsAre("lte", "message " + First));
}

TEST(CaptureStreamTest, TimesAreThePacketsToTheMicrosecond)
{
    Heard micro({});
    micro.append(captureHead(149) + packet(First, 123456));
    EXPECT_EQ(micro.times.at(0), 1'700'000'000'123'456);
    EXPECT_EQ(micro.lines.at(0), "cdma");
    Heard nano({});
    nano.append(captureHead(148, 0xA1B23C4D) + packet(First, 123456789));
    EXPECT_EQ(nano.times.at(0), 1'700'000'000'123'456);
}

TEST(CaptureStreamTest, OtherByteOrderIsRead)
{
    const auto length = static_cast<std::uint32_t>(First.size());
    const std::string bytes = swappedWords(u32(0xA1B2C3D4)) + std::string("\0\2\0\4", 4)
        + swappedWords(u32(0) + u32(0) + u32(262144) + u32(151))
        + swappedWords(u32(1'700'000'000) + u32(5) + u32(length) + u32(length)) + First;
    EXPECT_THAT(read(bytes), ElementsAre("utran", "message " + First));
}

TEST(CaptureStreamTest, MessagesThatAreNoRecordsPassAllTheSame)
{
    const std::string bytes = captureHead() + packet("short") + packet(record(1, "", '\x10')) + packet(First)
        + packet("x") + packet("at the end");
    EXPECT_THAT(read(bytes),
        ElementsAre("lte", "message short", "message " + record(1, "", '\x10'), "message " + First, "message x",
            "message at the end"));
}

TEST(CaptureStreamTest, MessageThatIsNoRecordComesOnceTheStreamSettles)
{
    Heard heard({});
    heard.append(captureHead() + packet("short"));
    EXPECT_THAT(heard.lines, ElementsAre("lte"));
    heard.settle();
    EXPECT_THAT(heard.lines, ElementsAre("lte", "message short"));
    heard.append(packet(First));
    EXPECT_THAT(heard.lines, ElementsAre("lte", "message short", "message " + First));
}

TEST(CaptureStreamTest, ReportsOfTheDictionaryBasebandPass)
{
    const std::string report = "<?xml version=\"1.0\"?><plist><dict/></plist>";
    EXPECT_THAT(read(captureHead(147) + packet(report) + packet(report)),
        ElementsAre("ifx", "message " + report, "message " + report));
}

TEST(CaptureStreamTest, AnotherCaptureMayFollow)
{
    EXPECT_THAT(read(Capture + captureHead(148) + packet(Third)),
        ElementsAre("lte", "message " + First, "message " + Second, "message " + Third, "gsm", "message " + Third));
}

TEST(CaptureStreamTest, LostBytesCostTheirPacketAndAreTold)
{
    for (std::size_t lost = 1; lost < 16 + First.size(); ++lost) {
        std::string bytes = Capture;
        bytes.erase(24, lost);
        const std::size_t rest = 16 + First.size() - lost;
        EXPECT_THAT(read(bytes),
            ElementsAre("lte", "skipped " + std::to_string(rest) + " at 24: no packet starts there",
                "message " + Second, "message " + Third))
            << lost << " bytes lost";
    }
}

TEST(CaptureStreamTest, ForeignBytesBetweenPacketsAreSkipped)
{
    std::string noise = "some tool wrote its greeting here\n";
    std::string bytes = captureHead() + packet(First) + noise + packet(Second) + packet(Third);
    const std::string place = std::to_string(24 + 16 + First.size());
    EXPECT_THAT(read(bytes),
        ElementsAre("lte", "message " + First,
            "skipped " + std::to_string(noise.size()) + " at " + place + ": no packet starts there",
            "message " + Second, "message " + Third));
}

TEST(CaptureStreamTest, DamagedLengthCostsItsPacketOnly)
{
    for (const std::uint32_t length : {0u, 1u, 40000u, 262144u, 0xFFFFFFFFu}) {
        std::string bytes = Capture;
        bytes.replace(24 + 8, 4, u32(length));
        const auto lines = read(bytes);
        ASSERT_GE(lines.size(), 3u);
        EXPECT_THAT(std::vector(lines.end() - 2, lines.end()), ElementsAre("message " + Second, "message " + Third))
            << length;
    }
}

TEST(CaptureStreamTest, PacketCapturedInPartIsSkipped)
{
    const std::string partly = u32(1) + u32(1) + u32(3) + u32(9) + "abc";
    EXPECT_THAT(read(captureHead() + partly + packet(First)),
        ElementsAre("lte", "skipped 19 at 24: a packet that was captured only in part", "message " + First));
}

TEST(CaptureStreamTest, EndWithinAPacketIsTold)
{
    EXPECT_THAT(read(Capture.substr(0, Capture.size() - 3)),
        ElementsAre("lte", "message " + First, "message " + Second,
            "skipped " + std::to_string(16 + Third.size() - 3) + " at "
                + std::to_string(Capture.size() - Third.size() - 16) + ": the stream ended within a packet"));
}

TEST(CaptureStreamTest, EndlessNoiseIsToldPieceByPieceAndNotKept)
{
    Heard heard({});
    heard.append(captureHead());
    for (int count = 0; count < 24; ++count)
        heard.append(std::string(RecordingStream::LargestAppend, '\x77'));
    EXPECT_GE(heard.lines.size(), 2u);
    EXPECT_TRUE(heard.lines.back().ends_with("no packet starts there")) << heard.lines.back();
    heard.append(packet(First));
    EXPECT_EQ(heard.lines.back(), "message " + First);
}

TEST(CaptureStreamTest, ForeignLinkTypeNeedsTheTechnologyNamed)
{
    EXPECT_THAT(read(captureHead(1) + packet(First)),
        ElementsAre("refused: its link type tells no technology; name it with --technology"));
    EXPECT_THAT(read(captureHead(1) + packet(First), Technology::GSM), ElementsAre("gsm", "message " + First));
}

TEST(DLFStreamTest, WholeMessagesAndItemsAreCut)
{
    EXPECT_THAT(read(versionReport(7) + First.substr(1) + Second + Third + Third.substr(1), Technology::LTE),
        ElementsAre("lte", "message " + First, "message " + Second, "message " + Third, "message " + Third));
}

TEST(DLFStreamTest, MessagesThatFollowEachOtherNeedNoVersionReport)
{
    EXPECT_THAT(read(First + Second + Third, Technology::GSM),
        ElementsAre("gsm", "message " + First, "message " + Second, "message " + Third));
}

TEST(DLFStreamTest, AnotherFileMayFollow)
{
    EXPECT_THAT(read(versionReport() + First.substr(1) + versionReport() + First.substr(1), Technology::LTE),
        ElementsAre("lte", "message " + First, "message " + First));
}

TEST(DLFStreamTest, MessageComesWhenTheStreamSettles)
{
    Heard heard(Technology::LTE);
    heard.append(First);
    EXPECT_THAT(heard.lines, ElementsAre("lte")) << "what follows decides how it is cut";
    heard.settle();
    EXPECT_THAT(heard.lines, ElementsAre("lte", "message " + First));
    heard.append(std::string_view(Second).substr(0, 9));
    heard.settle();
    EXPECT_EQ(heard.lines.size(), 2u) << "a message that is not whole waits";
    heard.append(std::string_view(Second).substr(9));
    heard.settle();
    EXPECT_EQ(heard.lines.back(), "message " + Second);
}

TEST(DLFStreamTest, SettlingAnywhereMakesNoDifferenceToWholeMessages)
{
    const std::string bytes = versionReport() + First.substr(1) + Second + Third + First + First + Second;
    for (std::size_t place = 1; place < bytes.size(); ++place) {
        Heard heard(Technology::LTE);
        heard.append(std::string_view(bytes).substr(0, place));
        heard.settle();
        heard.append(std::string_view(bytes).substr(place));
        EXPECT_THAT(heard.finish(),
            ElementsAre("lte", "message " + First, "message " + Second, "message " + Third, "message " + First,
                "message " + First, "message " + Second))
            << "settled at byte " << place;
    }
}

TEST(DLFStreamTest, DamageIsSkippedAndTold)
{
    const std::string noise(20, '\0');
    EXPECT_THAT(read(First + Second + noise + Third + First + First, Technology::LTE),
        ElementsAre("lte", "message " + First, "message " + Second,
            "skipped 20 at " + std::to_string(First.size() + Second.size()) + ": no item starts there",
            "message " + Third, "message " + First, "message " + First));
}

TEST(DLFStreamTest, EndWithinAnItemIsTold)
{
    EXPECT_THAT(read(First + Second.substr(0, Second.size() - 1), Technology::LTE),
        ElementsAre("lte", "message " + First,
            "skipped " + std::to_string(Second.size() - 1) + " at " + std::to_string(First.size())
                + ": the stream ended within an item"));
}

TEST(DLFStreamTest, LongStreamIsDecidedOnAsItComes)
{
    Heard heard(Technology::LTE);
    std::size_t expected = 1;
    for (std::size_t bytes = 0; bytes < 1'000'000; bytes += First.size() + Second.size(), expected += 2)
        heard.append(First + Second);
    EXPECT_GT(heard.lines.size(), expected / 2) << "the first part needs no end";
    EXPECT_EQ(heard.finish().size(), expected);
    EXPECT_EQ(heard.lines.back(), "message " + Second);
}

TEST(DLFStreamTest, EndlessNoiseIsNotKept)
{
    Heard heard(Technology::LTE);
    for (int count = 0; count < 20; ++count)
        heard.append(std::string(RecordingStream::LargestAppend, '\0'));
    EXPECT_GE(heard.lines.size(), 2u);
    for (std::size_t count = 0; count * First.size() < 300'000; ++count)
        heard.append(First);
    EXPECT_EQ(heard.finish().back(), "message " + First);
}

TEST(RecordingStreamTest, EmptyStreamYieldsNothing)
{
    EXPECT_THAT(read(""), IsEmpty());
}

TEST(RecordingStreamTest, WhatCannotBeRelayedIsRefusedWithItsReason)
{
    EXPECT_THAT(read("ab"), ElementsAre("refused: it ended after 2 bytes"));
    EXPECT_THAT(read("hello, world"),
        ElementsAre("refused: it starts neither as a capture nor as DLF (DLF items alone need --technology)"));
    EXPECT_THAT(read(versionReport()),
        ElementsAre("refused: it is DLF, which does not tell its technology; name it with --technology"));
    EXPECT_THAT(read("\x0A\x0D\x0D\x0A and so on"),
        ElementsAre("refused: it is pcapng; only classic pcap and DLF are relayed"));
}

TEST(RecordingStreamTest, LargestMessagePasses)
{
    const std::string large(LargestMessage, 'x');
    Heard heard({});
    const std::string bytes = captureHead() + packet(large) + packet(First);
    for (std::size_t place = 0; place < bytes.size(); place += RecordingStream::LargestAppend)
        heard.append(std::string_view(bytes).substr(place, RecordingStream::LargestAppend));
    EXPECT_THAT(heard.finish(), ElementsAre("lte", "message " + large, "message " + First));
}

} // namespace
} // namespace spectrel
