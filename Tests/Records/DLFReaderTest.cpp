#include "Tests/Fakes/ScratchFolder.h"
#include "Tests/Records/RecordingText.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <random>

namespace spectrel {

namespace {

using Messages = std::vector<std::string>;

/// A file as it is written of a history: the version report, then each entry's buffer without its first byte.
std::string dlf(const std::vector<Messages>& history, std::uint32_t seconds = 0)
{
    std::string bytes = versionReport(seconds);
    for (const Messages& entry : history) {
        std::string buffer;
        for (const std::string& message : entry)
            buffer += message;
        if (buffer.size() >= 2)
            bytes += buffer.substr(1);
    }
    return bytes;
}

Messages joined(const std::vector<Messages>& history)
{
    Messages all;
    for (const Messages& entry : history)
        all.insert(all.end(), entry.begin(), entry.end());
    return all;
}

std::string randomBytes(std::mt19937& random, std::size_t count)
{
    std::string bytes(count, '\0');
    for (char& byte : bytes)
        byte = static_cast<char>(random());
    return bytes;
}

class DLFReaderTest : public testing::Test {
protected:
    RecordingText read(const std::string& bytes)
    {
        return readRecording(_folder.write("x", bytes));
    }
    void expectRestored(const std::vector<Messages>& history)
    {
        const RecordingText text = read(dlf(history));
        EXPECT_TRUE(text.messages == joined(history)) << text.messages.size();
        EXPECT_EQ(text.damage, "");
    }

    ScratchFolder _folder;
};

} // namespace

TEST_F(DLFReaderTest, VersionReportAloneHoldsNoMessage)
{
    const RecordingText text = read(dlf({}));
    EXPECT_TRUE(text.isOpen) << text.reason;
    EXPECT_FALSE(text.technology);
    EXPECT_TRUE(text.messages.empty());
    EXPECT_EQ(text.damage, "");
}

TEST_F(DLFReaderTest, LoneItemsGetTheirTypeByteBack)
{
    expectRestored({{record(0xB0C2, "abc")}, {record(0x0010)}, {record(0x000F, "x", '\xFF')}, {record(0, "", '\xFF')}});
}

TEST_F(DLFReaderTest, TimeIsThatOfWriting)
{
    const RecordingText text = read(dlf({{record(1), record(2)}}, 4'000'000'000u));
    EXPECT_EQ(text.times, (std::vector<std::int64_t> {4'000'000'000'000'000, 4'000'000'000'000'000}));
}

TEST_F(DLFReaderTest, TypeBytesOfLaterRecordsAreNotTakenForItems)
{
    const std::string a = record(0xB0C2, "abc");
    const std::string b = record(0x0C00, "defgh", '\xFF'); // its type byte stands in the file, whatever its code
    expectRestored({{a, b, a}, {a, a, b}});
}

TEST_F(DLFReaderTest, WrappersOfLaterRecordsAreKept)
{
    const std::string a = record(0xB0C2, "abc");
    expectRestored({{a, wrapped(a), a, wrapped(record(7, "x", '\xFF'), '\x01')}});
}

TEST_F(DLFReaderTest, FirstRecordsWrapperIsRestored)
{
    const std::string a = record(0xB0C2, "abc");
    expectRestored({{wrapped(a)}, {wrapped(a, '\x01'), a}, {wrapped(a, '\xFF'), wrapped(a, '\x81')}, {a}});
}

TEST_F(DLFReaderTest, LengthsThatLookLikeTypeBytesAreTakenAsLengths)
{
    for (const std::size_t payload :
        {0xFFu - 12, 0x101u - 12, 0x1FFu - 12, 0x1FFu + 0x100u - 12, 0x81u - 12, 0x181u - 12}) {
        const std::string a = record(0xB0C2, std::string(payload, 'a'));
        expectRestored({{a, a, wrapped(a)}, {a}, {a, a}});
    }
}

TEST_F(DLFReaderTest, RandomHistoriesAreRestored)
{
    std::mt19937 random(23);
    for (int round = 0; round < 3; ++round) {
        std::vector<Messages> history(5);
        for (Messages& entry : history) {
            for (auto count = random() % 2000; count > 0; --count) {
                entry.push_back(
                    record(static_cast<unsigned>(0x1000 + random() % 0xE000), randomBytes(random, random() % 120)));
                if (random() % 16 == 0)
                    entry.back() = wrapped(entry.back(), static_cast<char>(random()));
            }
        }
        expectRestored(history);
    }
}

TEST_F(DLFReaderTest, LongFilesAreRestoredAcrossTheLookAhead)
{
    std::mt19937 random(29);
    std::vector<Messages> history(5);
    for (Messages& entry : history) {
        for (int i = 0; i < 12; ++i)
            entry.push_back(record(0xB0C2, randomBytes(random, random() % 60000)));
    }
    expectRestored(history);
}

TEST_F(DLFReaderTest, FilesOfLoneItemsAreReadItemByItem)
{
    std::mt19937 random(31);
    std::vector<Messages> history;
    for (int i = 0; i < 2500; ++i)
        history.push_back({record(0xB0C2, randomBytes(random, random() % 600))});
    expectRestored(history);
}

TEST_F(DLFReaderTest, ShortMessageBetweenOthersIsKept)
{
    const std::string a = record(0xB0C2, "abc");
    expectRestored({{a, a, "short", a, a}});
}

TEST_F(DLFReaderTest, EntryOfOneByteLeavesNothing)
{
    const std::string a = record(0xB0C2, "abc");
    EXPECT_EQ(read(dlf({{"x"}, {a}})).messages, Messages {a});
}

TEST_F(DLFReaderTest, TruncationAnywhereYieldsTheMessagesBefore)
{
    const std::string a = record(0xB0C2, "abcdef");
    const std::string whole = dlf({{a, a}, {wrapped(a), a}});
    const std::size_t ends[] = {161, 161 + 18, 161 + 37, 161 + 37 + 20, whole.size()};
    for (std::size_t length = 161; length <= whole.size(); ++length) {
        const RecordingText text = read(whole.substr(0, length));
        const auto complete =
            static_cast<std::size_t>(std::ranges::count_if(ends, [&](auto end) { return end <= length; })) - 1;
        ASSERT_EQ(text.messages.size(), complete) << length;
        ASSERT_EQ(text.damage.empty(), length == ends[complete]) << length << text.damage;
    }
}

TEST_F(DLFReaderTest, TruncatedVersionReportIsDamage)
{
    for (std::size_t length = 4; length < 161; ++length) {
        const RecordingText text = read(versionReport().substr(0, length));
        ASSERT_TRUE(text.isOpen) << length;
        ASSERT_EQ(text.damage,
            "version report at byte 0: it has a length of 161, " + std::to_string(length) + " bytes are left");
    }
}

TEST_F(DLFReaderTest, DamageTellsMessageAndPlace)
{
    const std::string a = record(0xB0C2, "abcdef");
    EXPECT_EQ(read(dlf({{a, a.substr(0, 16)}})).damage,
        "message 1 at byte 179: the item has a length of 18, 15 bytes are left");
    EXPECT_EQ(read(dlf({{a}}) + "xyz").damage, "message 1 at byte 179: 3 bytes are left, too few for a message");
}

TEST_F(DLFReaderTest, FileWithoutVersionReportIsReadWithTimeZero)
{
    const std::string a = record(0xB0C2, "abcdef");
    const std::string b = record(0x0002, "x", '\xFF');
    const RecordingText text = read(a.substr(1) + b.substr(1) + a.substr(1));
    EXPECT_EQ(text.messages, (Messages {a, b, a}));
    EXPECT_EQ(text.times, (std::vector<std::int64_t> {0, 0, 0}));
}

/// Bytes under which every place may start a message end in time that grows with their number, not with the ways to
/// cut.
TEST_F(DLFReaderTest, HostileBytesEnd)
{
    for (const std::string& pattern : {std::string("\x0C\0", 2), std::string("\x01\x0C\0", 3), std::string("\x0C"),
             std::string("\x01\x01"), std::string("\x81\x01\x0C\0\xFF\x0D\0", 7), std::string("\0", 1)}) {
        std::string bytes = versionReport();
        while (bytes.size() < 560'000)
            bytes += pattern;
        EXPECT_TRUE(read(bytes).isOpen);
    }
}

} // namespace spectrel
