#include "Records/Recording.h"
#include "Tests/Fakes/ScratchFolder.h"
#include "Tests/Records/RecordingText.h"

#include <algorithm>
#include <csignal>
#include <filesystem>
#include <gtest/gtest.h>
#include <malloc.h>
#include <sys/inotify.h>
#include <sys/resource.h>
#include <unistd.h>

namespace spectrel {

namespace {

Moment at(std::int64_t microseconds)
{
    return Moment(std::chrono::microseconds(microseconds));
}

/// The bytes of a capture, made without any library; `swapped` writes it as a machine of the other byte order would.
struct CaptureBytes {
    explicit CaptureBytes(std::uint32_t magic = 0xA1B2C3D4, std::uint32_t linkType = 150, bool swap = false)
        : swapped(swap)
    {
        bytes = number(magic) + half(2) + half(4) + number(0) + number(0) + number(262144) + number(linkType);
    }
    std::string number(std::uint32_t value) const
    {
        std::string text = u32(value);
        if (swapped)
            std::ranges::reverse(text);
        return text;
    }
    std::string half(unsigned value) const
    {
        std::string text = u16(value);
        if (swapped)
            std::ranges::reverse(text);
        return text;
    }
    CaptureBytes& packet(std::uint32_t seconds, std::uint32_t fraction, const std::string& body, std::uint32_t cut = 0)
    {
        const auto length = static_cast<std::uint32_t>(body.size());
        bytes += number(seconds) + number(fraction) + number(length) + number(length + cut) + body;
        return *this;
    }

    bool swapped;
    std::string bytes;
};

} // namespace

std::string whyNotWritten(RecordingWriter& writer, Moment time, ByteView message)
{
    const auto written = writer.write(time, message);
    return written ? "written" : written.failure().text;
}

TEST(CaptureTest, WrittenMessagesReadBackWithTimeAndTechnology)
{
    const ScratchFolder folder;
    for (const Technology technology :
        {Technology::IFX, Technology::GSM, Technology::CDMA, Technology::LTE, Technology::UTRAN}) {
        auto writer = *createRecording(folder.file("x.pcap"), technology);
        EXPECT_TRUE(writer->write(at(1'733'000'000'123'456), viewOf("first")));
        EXPECT_TRUE(writer->write(at(0), viewOf(std::string(3, '\0'))));
        EXPECT_TRUE(writer->write(at(4'294'967'295'999'999), viewOf("last")));
        EXPECT_TRUE(writer->flush());
        writer.reset();
        const RecordingText text = readRecording(folder.file("x.pcap"));
        EXPECT_EQ(text.technology, technology);
        EXPECT_EQ(text.messages, (std::vector<std::string> {"first", std::string(3, '\0'), "last"}));
        EXPECT_EQ(text.times, (std::vector<std::int64_t> {1'733'000'000'123'456, 0, 4'294'967'295'999'999}));
        EXPECT_EQ(text.damage, "");
    }
}

TEST(CaptureTest, FileIsAClassicCaptureWithItsLinkType)
{
    const ScratchFolder folder;
    auto writer = *createRecording(folder.file("x"), Technology::UTRAN);
    ASSERT_TRUE(writer->write(at(1'000'001), viewOf("ab")));
    writer.reset();
    EXPECT_EQ(folder.read("x"), CaptureBytes(0xA1B2C3D4, 151).packet(1, 1, "ab").bytes);
}

TEST(CaptureTest, MessagesOfEitherBoundAreWrittenAndRead)
{
    const ScratchFolder folder;
    const std::string longest(262144, 'x');
    auto writer = *createRecording(folder.file("x"), Technology::LTE);
    EXPECT_TRUE(writer->write(at(0), viewOf("x")));
    EXPECT_TRUE(writer->write(at(0), viewOf(longest)));
    EXPECT_EQ(whyNotWritten(*writer, at(0), {}), "a message has 1 to 262144 bytes, this one has 0");
    EXPECT_EQ(
        whyNotWritten(*writer, at(0), viewOf(longest + "x")), "a message has 1 to 262144 bytes, this one has 262145");
    EXPECT_TRUE(writer->write(at(0), viewOf("after"))); // nothing of the refused ones is in the file
    writer.reset();
    EXPECT_EQ(readRecording(folder.file("x")).messages, (std::vector<std::string> {"x", longest, "after"}));
}

TEST(CaptureTest, TimesThatACaptureCannotTellAreRefused)
{
    const ScratchFolder folder;
    const auto writer = *createRecording(folder.file("x"), Technology::LTE);
    EXPECT_EQ(whyNotWritten(*writer, at(-1), viewOf("x")),
        "the time 1969-12-31 23:59:59 +0000 is outside what a capture can tell");
    EXPECT_FALSE(writer->write(at(4'294'967'296'000'000), viewOf("x")));
}

TEST(CaptureTest, FlushedMessagesAreInTheFileWhileTheWriterLives)
{
    const ScratchFolder folder;
    const auto writer = *createRecording(folder.file("x"), Technology::LTE);
    EXPECT_TRUE(readRecording(folder.file("x")).isOpen);
    ASSERT_TRUE(writer->write(at(0), viewOf("message")));
    ASSERT_TRUE(writer->flush());
    EXPECT_EQ(readRecording(folder.file("x")).messages.size(), 1u);
}

/// What happens to the names of a folder from now on: "created x", "renamed to y".
class FolderEvents {
public:
    explicit FolderEvents(const ScratchFolder& folder)
        : _descriptor(::inotify_init1(IN_NONBLOCK | IN_CLOEXEC))
    {
        ::inotify_add_watch(_descriptor, folder.path().c_str(), IN_CREATE | IN_MOVED_TO);
    }
    ~FolderEvents()
    {
        ::close(_descriptor);
    }
    std::vector<std::string> take() const
    {
        alignas(inotify_event) char buffer[4096];
        std::vector<std::string> texts;
        const ssize_t length = ::read(_descriptor, buffer, sizeof buffer);
        for (ssize_t place = 0; place < length;) {
            const auto* const event = reinterpret_cast<const inotify_event*>(buffer + place);
            texts.push_back((event->mask & IN_CREATE ? "created " : "renamed to ") + std::string(event->name));
            place += static_cast<ssize_t>(sizeof *event + event->len);
        }
        return texts;
    }

private:
    int _descriptor;
};

TEST(CaptureTest, NewFileGetsItsNameWithItsHead)
{
    const ScratchFolder folder;
    const FolderEvents events(folder);
    const std::string hidden = "created .x.pcap-" + std::to_string(::getpid());
    for (const auto create : {createRecording, createNewRecording}) {
        const auto writer = *create(folder.file("x.pcap"), Technology::LTE);
        EXPECT_EQ(events.take(), (std::vector<std::string> {hidden, "renamed to x.pcap"}));
        EXPECT_EQ(folder.read("x.pcap"), CaptureBytes(0xA1B2C3D4, 150).bytes);
        std::filesystem::remove(folder.file("x.pcap"));
    }
}

TEST(CaptureTest, OverwrittenFileKeepsItsPlaceAndItsOldPacketsGo)
{
    const ScratchFolder folder;
    folder.write("x.pcap", CaptureBytes(0xA1B2C3D4, 149).packet(1, 1, "old").packet(2, 2, "older").bytes);
    const FolderEvents events(folder);
    auto writer = *createRecording(folder.file("x.pcap"), Technology::LTE);
    EXPECT_EQ(folder.read("x.pcap"), CaptureBytes(0xA1B2C3D4, 150).bytes);
    EXPECT_TRUE(writer->write(at(1'000'001), viewOf("new")));
    writer.reset();
    EXPECT_EQ(folder.read("x.pcap"), CaptureBytes(0xA1B2C3D4, 150).packet(1, 1, "new").bytes);
    EXPECT_TRUE(events.take().empty());
}

TEST(CaptureTest, OverwrittenShortFileOfAnotherKindIsACapture)
{
    const ScratchFolder folder;
    folder.write("x.pcap", "text");
    EXPECT_TRUE(createRecording(folder.file("x.pcap"), Technology::LTE));
    EXPECT_EQ(folder.read("x.pcap"), CaptureBytes(0xA1B2C3D4, 150).bytes);
}

TEST(CaptureTest, NewRecordingLeavesAFileOfItsNameAlone)
{
    const ScratchFolder folder;
    folder.write("x.pcap", "mine");
    const auto created = createNewRecording(folder.file("x.pcap"), Technology::LTE);
    ASSERT_FALSE(created);
    EXPECT_EQ(created.failure().code, Failure::Code::Exists);
    EXPECT_EQ(folder.read("x.pcap"), "mine");
    const auto files = std::filesystem::directory_iterator(folder.path());
    EXPECT_EQ(std::distance(begin(files), end(files)), 1) << "nothing hidden stays";
}

TEST(CaptureTest, FullDiskIsReported)
{
    const auto created = createRecording("/dev/full", Technology::LTE);
    ASSERT_FALSE(created);
    EXPECT_EQ(created.failure().text, "No space left on device");
}

/// Files that grow beyond the limit fail, as on a full disk.
class FileSizeLimit {
public:
    explicit FileSizeLimit(rlim_t bytes)
        : _handler(std::signal(SIGXFSZ, SIG_IGN))
    {
        ::getrlimit(RLIMIT_FSIZE, &_before);
        const rlimit little {bytes, _before.rlim_max};
        ::setrlimit(RLIMIT_FSIZE, &little);
    }
    FileSizeLimit(const FileSizeLimit&) = delete;
    FileSizeLimit& operator=(const FileSizeLimit&) = delete;
    ~FileSizeLimit()
    {
        ::setrlimit(RLIMIT_FSIZE, &_before);
        std::signal(SIGXFSZ, _handler);
    }

private:
    rlimit _before {};
    void (*_handler)(int);
};

TEST(CaptureTest, WithoutRoomTheFileEndsWithAWholeMessageAndGoesOnWhenThereIsSome)
{
    const ScratchFolder folder;
    const auto writer = *createRecording(folder.file("x"), Technology::LTE);
    EXPECT_TRUE(writer->write(at(1'000'001), viewOf("one")));
    EXPECT_TRUE(writer->flush());
    const auto whole = CaptureBytes(0xA1B2C3D4, 150).packet(1, 1, "one").bytes;
    {
        const FileSizeLimit limit(whole.size() + 19 + 10);
        EXPECT_TRUE(writer->write(at(2'000'002), viewOf("two")));
        EXPECT_TRUE(writer->write(at(3'000'003), viewOf("three")));
        const auto flushed = writer->flush();
        ASSERT_FALSE(flushed);
        EXPECT_EQ(flushed.failure().code, Failure::Code::NoRoom);
        EXPECT_EQ(writer->waiting(), 1u);
        EXPECT_EQ(folder.read("x"), CaptureBytes(0xA1B2C3D4, 150).packet(1, 1, "one").packet(2, 2, "two").bytes);
    }
    EXPECT_TRUE(writer->flush());
    EXPECT_EQ(writer->waiting(), 0u);
    EXPECT_EQ(folder.read("x"),
        CaptureBytes(0xA1B2C3D4, 150).packet(1, 1, "one").packet(2, 2, "two").packet(3, 3, "three").bytes);
}

TEST(CaptureTest, WhatWaitsForRoomIsBounded)
{
    const ScratchFolder folder;
    const auto writer = *createRecording(folder.file("x"), Technology::LTE);
    const FileSizeLimit limit(1000);
    const std::string message(100'000, 'x');
    std::uint64_t taken = 0;
    for (int number = 0; number < 100; ++number) {
        const auto written = writer->write(at(1'000'001), viewOf(message));
        taken += written ? 1 : 0;
        EXPECT_TRUE(written || written.failure().code == Failure::Code::NoRoom);
    }
    EXPECT_EQ(taken, RecordingWriter::MostWaiting / (message.size() + 16));
    EXPECT_EQ(writer->waiting(), taken);
}

TEST(CaptureTest, FileThatIsCutAnywhereIsReadUpToTheCut)
{
    const ScratchFolder folder;
    CaptureBytes file(0xA1B2C3D4, 150);
    std::vector<std::size_t> ends;
    for (std::uint32_t number = 1; number <= 5; ++number) {
        file.packet(number, number, std::string(number, 'x'));
        ends.push_back(file.bytes.size());
    }
    for (std::size_t length = 24; length <= file.bytes.size(); ++length) {
        // Cut, and as a loss of power may leave it: the file's new length is on the disk, but not what stands there.
        for (const std::size_t zeros : {std::size_t {0}, file.bytes.size() - length}) {
            folder.write("x", file.bytes.substr(0, length) + std::string(zeros, '\0'));
            const auto reader = *openRecording(folder.file("x"));
            const auto whole = std::ranges::count_if(ends, [length](std::size_t end) { return end <= length; });
            std::ptrdiff_t messages = 0;
            for (RecordedMessage message; reader->next(message); ++messages) {
                if (messages >= whole)
                    continue;
                EXPECT_EQ(std::string(message.body.begin(), message.body.end()),
                    std::string(static_cast<std::size_t>(messages) + 1, 'x'));
            }
            // Of the message that was cut zeros may have made up the rest.
            EXPECT_GE(messages, whole) << length << " bytes and " << zeros << " zeros";
            EXPECT_LE(messages, zeros > 0 ? whole + 1 : whole) << length << " bytes and " << zeros << " zeros";
        }
    }
}

TEST(CaptureTest, PlaceThatCannotBeWrittenIsReported)
{
    const ScratchFolder folder;
    const auto created = createRecording(folder.file("no/such/folder"), Technology::LTE);
    ASSERT_FALSE(created);
    EXPECT_EQ(created.failure().text, "No such file or directory");
}

TEST(CaptureTest, BothByteOrdersAndBothTimeUnitsAreRead)
{
    const ScratchFolder folder;
    for (const bool swapped : {false, true}) {
        folder.write("micro", CaptureBytes(0xA1B2C3D4, 148, swapped).packet(5, 123456, "message").bytes);
        folder.write("nano", CaptureBytes(0xA1B23C4D, 148, swapped).packet(5, 123456789, "message").bytes);
        for (const char* name : {"micro", "nano"}) {
            const RecordingText text = readRecording(folder.file(name));
            EXPECT_EQ(text.technology, Technology::GSM);
            EXPECT_EQ(text.messages, std::vector<std::string> {"message"});
            EXPECT_EQ(text.times, std::vector<std::int64_t> {5'123'456});
            EXPECT_EQ(text.damage, "");
        }
    }
}

TEST(CaptureTest, OtherLinkTypesTellNoTechnology)
{
    const ScratchFolder folder;
    for (const std::uint32_t linkType : {1u, 146u, 152u}) {
        const auto path = folder.write("x", CaptureBytes(0xA1B2C3D4, linkType).packet(5, 0, "message").bytes);
        const RecordingText text = readRecording(path);
        EXPECT_FALSE(text.technology) << linkType;
        EXPECT_EQ(text.messages.size(), 1u);
    }
}

TEST(CaptureTest, CaptureWithoutMessagesIsEmpty)
{
    const ScratchFolder folder;
    const RecordingText text = readRecording(folder.write("x", CaptureBytes().bytes));
    EXPECT_TRUE(text.isOpen);
    EXPECT_TRUE(text.messages.empty());
    EXPECT_EQ(text.damage, "");
}

TEST(CaptureTest, TruncationAnywhereYieldsTheMessagesBefore)
{
    const ScratchFolder folder;
    const std::string first = CaptureBytes().packet(1, 0, "first").bytes;
    const std::string whole = CaptureBytes().packet(1, 0, "first").packet(2, 0, "second").bytes;
    for (std::size_t length = 1; length < whole.size(); ++length) {
        const RecordingText text = readRecording(folder.write("x", whole.substr(0, length)));
        ASSERT_EQ(text.isOpen, length >= 24) << length;
        ASSERT_EQ(text.messages.size(), length < first.size() ? 0u : 1u) << length;
        ASSERT_EQ(text.reason.empty(), text.isOpen) << length;
        ASSERT_EQ(text.damage.empty(), !text.isOpen || length == 24 || length == first.size()) << length;
    }
}

TEST(CaptureTest, DamageTellsMessageAndPlace)
{
    const ScratchFolder folder;
    std::string bytes = CaptureBytes().packet(1, 0, "first").packet(2, 0, "second").bytes;
    bytes.resize(bytes.size() - 2);
    EXPECT_EQ(readRecording(folder.write("x", bytes)).damage,
        "message 1 at byte 45: truncated dump file; tried to read 6 captured bytes, only got 4");
}

TEST(CaptureTest, GarbageBetweenPacketsIsDamage)
{
    const ScratchFolder folder;
    const auto path = folder.write("x", CaptureBytes().packet(1, 0, "first").bytes + std::string(64, '\xEE'));
    const RecordingText text = readRecording(path);
    EXPECT_EQ(text.messages.size(), 1u);
    EXPECT_TRUE(text.damage.starts_with("message 1 at byte 45: ")) << text.damage;
}

TEST(CaptureTest, MessageThatWasCapturedInPartIsDamage)
{
    const ScratchFolder folder;
    const auto path = folder.write("x", CaptureBytes().packet(1, 0, "whole").packet(2, 0, "part", 3).bytes);
    const RecordingText text = readRecording(path);
    EXPECT_EQ(text.messages, std::vector<std::string> {"whole"});
    EXPECT_EQ(text.damage, "message 1 at byte 45: only 4 of 7 bytes were captured");
}

TEST(CaptureTest, NewerCaptureFormIsRead)
{
    const ScratchFolder folder;
    const std::string section =
        u32(0x0A0D0D0A) + u32(28) + u32(0x1A2B3C4D) + u16(1) + u16(0) + std::string(8, '\xFF') + u32(28);
    const std::string interface = u32(1) + u32(20) + u16(150) + u16(0) + u32(0) + u32(20);
    const std::string packet = u32(6) + u32(36) + u32(0) + u32(0) + u32(7'000'001) + u32(4) + u32(4) + "body" + u32(36);
    const std::string whole = section + interface + packet + packet;
    RecordingText text = readRecording(folder.write("x", whole));
    EXPECT_EQ(text.technology, Technology::LTE);
    EXPECT_EQ(text.messages, (std::vector<std::string> {"body", "body"}));
    EXPECT_EQ(text.times, (std::vector<std::int64_t> {7'000'001, 7'000'001}));
    EXPECT_EQ(text.damage, "");
    text = readRecording(folder.write("x", whole.substr(0, whole.size() - 10)));
    EXPECT_EQ(text.messages.size(), 1u);
    EXPECT_TRUE(text.damage.starts_with("message 1 at byte 84: ")) << text.damage;
}

TEST(CaptureTest, MemoryDoesNotGrowWithTheLength)
{
    const ScratchFolder folder;
    CaptureBytes capture;
    for (std::uint32_t i = 0; i < 50000; ++i)
        capture.packet(i, 0, std::string(200, 'x'));
    const auto reader = *openRecording(folder.write("x", capture.bytes));
    RecordedMessage message;
    ASSERT_TRUE(reader->next(message));
    const std::size_t heapAtStart = ::mallinfo2().uordblks;
    std::size_t count = 1;
    while (reader->next(message))
        ++count;
    EXPECT_EQ(count, 50000u);
    EXPECT_LE(::mallinfo2().uordblks, heapAtStart + 4096);
}

TEST(CaptureTest, CaptureComesThroughAPipe)
{
    const ScratchFolder folder;
    const auto path = folder.write("x", CaptureBytes().packet(1, 0, "first").packet(2, 0, "second").bytes);
    std::FILE* pipe = ::popen(("cat '" + path + "'").c_str(), "re");
    ASSERT_TRUE(pipe);
    const RecordingText text = readRecording("/dev/fd/" + std::to_string(::fileno(pipe)));
    ::pclose(pipe);
    EXPECT_EQ(text.messages, (std::vector<std::string> {"first", "second"}));
}

} // namespace spectrel
