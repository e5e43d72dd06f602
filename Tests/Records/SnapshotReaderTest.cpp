#include "Tests/Fakes/ScratchFolder.h"
#include "Tests/Records/RecordingText.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyList.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <random>

namespace spectrel {

namespace {

Value data(const std::string& bytes)
{
    return std::make_shared<const Bytes>(bytes.begin(), bytes.end());
}

Value entry(const Value& displayState, const char* date = "2024-03-05 14:07:31 +0000")
{
    return Dictionary::make({{"DisplayState", displayState}, {"Display", Dictionary::make()},
        {"ExtraInfo", Dictionary::make()}, {"Date", date}});
}

class SnapshotReaderTest : public testing::Test {
protected:
    RecordingText read(const ListRef& entries)
    {
        const Value snapshot = Dictionary::make({{"Timestamp", "2024-03-05 14:07:31 +0000"}, {"Data", entries}});
        EXPECT_TRUE(writePropertyListToFile(snapshot, _folder.file("x")));
        return readRecording(_folder.file("x"));
    }
    /// One entry with these bytes.
    RecordingText readBuffer(const std::string& bytes)
    {
        return read(List::make({entry(data(bytes))}));
    }

    ScratchFolder _folder;
};

using Messages = std::vector<std::string>;

} // namespace

TEST_F(SnapshotReaderTest, MessagesOfAllEntriesComeInOrderWithTheirEntrysTime)
{
    const std::string a = record(0xB0C2, "abc");
    const std::string b = record(0x0C00, "", '\xFF');
    const std::string c = wrapped(record(0xB0C3, "x"));
    const RecordingText text =
        read(List::make({entry(data(a + b)), entry(data(c), "2024-03-05 14:07:33 +0000"), entry(data(""))}));
    EXPECT_EQ(text.messages, (Messages {a, b, c}));
    EXPECT_EQ(text.times, (std::vector<std::int64_t> {1709647651'000'000, 1709647651'000'000, 1709647653'000'000}));
    EXPECT_EQ(text.damage, "");
    EXPECT_FALSE(text.technology);
}

TEST_F(SnapshotReaderTest, EntryWithoutDateOrWithAnotherFormHasTimeZero)
{
    const Value dateless = Dictionary::make({{"DisplayState", data(record(1))}});
    const RecordingText text =
        read(List::make({entry(data(record(1))), dateless, entry(data(record(1)), "yesterday")}));
    EXPECT_EQ(text.times, (std::vector<std::int64_t> {1709647651'000'000, 0, 0}));
}

TEST_F(SnapshotReaderTest, EntryWithTheDLFIsSkipped)
{
    const Value dlf = Dictionary::make({{"Description", "DLF binary"}, {"DLF", data(versionReport() + record(1))}});
    const RecordingText text = read(List::make({entry(data(record(1))), dlf}));
    EXPECT_EQ(text.messages, Messages {record(1)});
    EXPECT_EQ(text.damage, "");
}

TEST_F(SnapshotReaderTest, EmptyAndForeignEntriesHoldNoMessages)
{
    const RecordingText text = read(List::make({Dictionary::make(), "text", entry(data(record(1)))}));
    EXPECT_EQ(text.messages, Messages {record(1)});
    EXPECT_EQ(text.damage, "");
}

TEST_F(SnapshotReaderTest, ReportObjectIsOneMessageOfTheDictionaryReportingBaseband)
{
    const Value report = Dictionary::make({{"Cell", Dictionary::make({{"ARFCN", "12"}})}, {"n", Value::integer(3)}});
    const RecordingText text = read(List::make({Dictionary::make(), entry(report), entry("only a text")}));
    EXPECT_EQ(text.technology, Technology::IFX);
    ASSERT_EQ(text.messages.size(), 2u);
    EXPECT_EQ(parsePropertyList(viewOf(text.messages[0])), report);
    EXPECT_EQ(parsePropertyList(viewOf(text.messages[1])), Value("only a text"));
    EXPECT_EQ(text.times[0], 1709647651'000'000);
}

TEST_F(SnapshotReaderTest, ShortMessageBetweenOthersIsKept)
{
    const std::string good = record(0xB0C2, "abcdef");
    for (std::size_t length = 1; length <= 12; ++length) {
        const std::string tooShort(length, '\x20');
        const RecordingText text = readBuffer(good + tooShort + good + good);
        EXPECT_EQ(text.messages, (Messages {good, tooShort, good, good})) << length;
        EXPECT_EQ(text.damage, "");
    }
}

TEST_F(SnapshotReaderTest, ShortMessageAtTheStartIsKept)
{
    const std::string good = record(0xB0C2, "abcdef");
    const RecordingText text = readBuffer("\x81" + good);
    EXPECT_EQ(text.messages, (Messages {"\x81", good}));
}

TEST_F(SnapshotReaderTest, MessageOfUnknownTypeIsCutByItsOwnLength)
{
    const std::string good = record(0xB0C2, "abcdef");
    const std::string unknown = record(0xB0C2, "uvw", '\x10');
    EXPECT_EQ(readBuffer(good + unknown + good).messages, (Messages {good, unknown, good}));
    EXPECT_EQ(readBuffer(good + unknown).messages, (Messages {good, unknown}));
    EXPECT_EQ(readBuffer(unknown + good).messages, (Messages {unknown, good}));
}

TEST_F(SnapshotReaderTest, MessagesOfUnknownTypesInARowAreCutByTheirOwnLengths)
{
    const std::string two = record(0x1183, std::string(37, 'a'), '\x02');
    const std::string three = record(0x119D, "bcd", '\x03');
    const RecordingText text = readBuffer(two + two + three + two);
    EXPECT_EQ(text.messages, (Messages {two, two, three, two}));
    EXPECT_EQ(text.damage, "");
}

TEST_F(SnapshotReaderTest, ReportOfManyValuesIsOneMessage)
{
    const Value report = Dictionary::make({{"Cell", Dictionary::make({{"ARFCN", "12"}})},
        {"Neighbours", List::make({"head", Dictionary::make({{"ARFCN", "14"}}), Value::integer(5)})}});
    const RecordingText text = read(List::make({entry(report), Dictionary::make(), entry("one text")}));
    ASSERT_EQ(text.messages.size(), 2u) << "and none of the empty entry";
    EXPECT_EQ(text.messages[0], serialisePropertyList(report));
    EXPECT_EQ(text.messages[1], serialisePropertyList("one text"));
}

TEST_F(SnapshotReaderTest, GarbageMessageBetweenOthersIsKept)
{
    const std::string good = record(0xB0C2, "abcdef");
    const std::string garbage = "this is no record of any kind, yet it was received";
    const RecordingText text = readBuffer(good + garbage + good + good);
    EXPECT_EQ(text.messages, (Messages {good, garbage, good, good}));
    EXPECT_EQ(text.damage, "");
}

TEST_F(SnapshotReaderTest, TruncationAnywhereYieldsTheMessagesBefore)
{
    const std::string good = record(0xB0C2, "abcdef");
    const std::string whole = good + wrapped(good) + good;
    const std::size_t ends[] = {0, good.size(), 2 * good.size() + 2, whole.size()};
    for (std::size_t length = 1; length <= whole.size(); ++length) {
        const RecordingText text = readBuffer(whole.substr(0, length));
        const auto complete =
            static_cast<std::size_t>(std::ranges::count_if(ends, [&](auto end) { return end <= length; })) - 1;
        ASSERT_EQ(text.messages.size(), complete) << length;
        ASSERT_EQ(text.damage.empty(), length == ends[complete]) << length << text.damage;
    }
}

TEST_F(SnapshotReaderTest, DamageTellsMessagePlaceAndEntry)
{
    const std::string good = record(0xB0C2, "abcdef");
    const auto damageOf = [&](const std::string& rest) {
        return read(List::make({entry(data(good)), entry(data(good + rest)), entry(data(good))})).damage;
    };
    EXPECT_EQ(damageOf("\x01"), "message 2 at byte 19 of entry 1: 1 bytes are left, too few for a message");
    EXPECT_EQ(damageOf(good.substr(0, 15)),
        "message 2 at byte 19 of entry 1: the item has a length of 18, 14 bytes are left");
    EXPECT_EQ(damageOf("\x01" + u16(11) + std::string(10, ' ')),
        "message 2 at byte 19 of entry 1: the item has a length of 11, the least is 12");
}

TEST_F(SnapshotReaderTest, RecordWithAWrongLengthIsDamageEvenWhenOthersFollow)
{
    const std::string good = record(0xB0C2, "abcdef");
    std::string wrong = good;
    wrong[1] = 5;
    const RecordingText text = readBuffer(good + wrong + good + good);
    EXPECT_EQ(text.messages, Messages {good});
    EXPECT_EQ(text.damage, "message 1 at byte 19 of entry 0: the item has a length of 5, the least is 12");
}

TEST_F(SnapshotReaderTest, RandomMessagesAreCutAsTheyWereReceived)
{
    std::mt19937 random(17);
    Messages messages;
    std::string buffer;
    for (int i = 0; i < 20000; ++i) {
        std::string payload(random() % (i % 100 == 0 ? 3000 : 90), '\0');
        for (char& byte : payload)
            byte = static_cast<char>(random());
        std::string message = record(random() & 0xFFFF, payload, random() % 4 == 0 ? '\xFF' : '\x01');
        if (random() % 8 == 0)
            message = wrapped(message, static_cast<char>(random()));
        messages.push_back(message);
        buffer += message;
    }
    const RecordingText text = readBuffer(buffer);
    EXPECT_TRUE(text.messages == messages);
    EXPECT_EQ(text.damage, "");
}

TEST_F(SnapshotReaderTest, ReportThatCannotBeCarriedIsDamage)
{
    // The binary form can hold what XML cannot: the text "\x01".
    const std::string binary = std::string("bplist00") + "\xD1\x01\x02"
        + "\x54"
          "Data"
        + "\xA1\x03" + "\xD1\x04\x05"
        + "\x5C"
          "DisplayState"
        + "\x51\x01" + "\x08\x0B\x10\x12\x15\x22" + std::string(6, '\0') + "\x01\x01" + std::string(7, '\0') + "\x06"
        + std::string(15, '\0') + "\x24";
    const RecordingText text = readRecording(_folder.write("x", binary));
    EXPECT_TRUE(text.isOpen) << text.reason;
    EXPECT_EQ(text.damage, "message 0 of entry 0: the report holds what a message cannot carry");
}

} // namespace spectrel
