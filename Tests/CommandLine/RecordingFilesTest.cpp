#include "CommandLine/Commands/RecordingFiles.h"

#include "CommandLine/Options/OptionTypes.h"
#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Fakes/RecordBuilder.h"
#include "Tests/Fakes/ScratchFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <unistd.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;

class RecordingFilesTest : public testing::Test {
protected:
    RecordingFiles open(RecordingFilesOptions options)
    {
        RecordingFiles files(std::move(options), loop);
        EXPECT_TRUE(files.prepare());
        return files;
    }
    /// One message of 13 bytes a second: 29 bytes in the file, behind 24 bytes of its head.
    void write(RecordingFiles& files, int count, Technology technology = Technology::LTE)
    {
        for (int number = 0; number < count; ++number) {
            loop.advance(1s);
            EXPECT_TRUE(files.write(technology, RecordBuilder(0xB0C2, 13)));
        }
        EXPECT_TRUE(files.flush());
    }
    /// The files of a folder with the number of messages in each: "a.pcap: 3".
    std::vector<std::string> contents(const std::string& folder)
    {
        std::vector<std::string> lines;
        for (const auto& each : std::filesystem::directory_iterator(folder)) {
            const auto reader = openRecording(each.path().string());
            int messages = 0;
            for (RecordedMessage message; reader && (*reader)->next(message);)
                ++messages;
            lines.push_back(
                each.path().filename().string() + ": " + (reader ? std::to_string(messages) : reader.failure().text));
        }
        std::ranges::sort(lines);
        return lines;
    }

    ScratchFolder scratch;
    FakeRunLoop loop;
};

TEST_F(RecordingFilesTest, OneFileWithoutLimits)
{
    auto files = open({scratch.file("a.pcap"), {}, {}, {}});
    write(files, 100);
    EXPECT_THAT(contents(scratch.path().string()), ElementsAre("a.pcap: 100"));
}

TEST_F(RecordingFilesTest, FileIsNotLargerThanItsLimit)
{
    auto files = open({scratch.file("a.pcap"), 24 + 3 * 29, {}, {}});
    write(files, 7);
    EXPECT_THAT(contents(scratch.path().string()), ElementsAre("a-2.pcap: 3", "a-3.pcap: 1", "a.pcap: 3"));
    EXPECT_EQ(files.count(), 3u);
}

TEST_F(RecordingFilesTest, MessageLargerThanTheLimitHasAFileOfItsOwn)
{
    auto files = open({scratch.file("a.pcap"), 30, {}, {}});
    write(files, 2);
    EXPECT_THAT(contents(scratch.path().string()), ElementsAre("a-2.pcap: 1", "a.pcap: 1"));
}

TEST_F(RecordingFilesTest, FileIsNotLongerThanItsTime)
{
    auto files = open({scratch.file("a.pcap"), {}, 3s, {}});
    write(files, 7);
    EXPECT_THAT(contents(scratch.path().string()), ElementsAre("a-2.pcap: 3", "a-3.pcap: 1", "a.pcap: 3"));
}

TEST_F(RecordingFilesTest, ClockThatIsSetNeitherDelaysNorHastensTheNextFile)
{
    auto files = open({scratch.file("a.pcap"), {}, 3s, {}});
    write(files, 2);
    loop.setClock(-1h);
    write(files, 2);
    loop.setClock(2h);
    write(files, 1);
    EXPECT_THAT(contents(scratch.path().string()), ElementsAre("a-2.pcap: 2", "a.pcap: 3"));
}

TEST_F(RecordingFilesTest, FolderIsMadeAndItsFilesAreNumberedAcrossTechnologies)
{
    auto files = open({scratch.file("new/folder/"), {}, {}, {}});
    write(files, 1, Technology::LTE);
    write(files, 2, Technology::GSM);
    EXPECT_THAT(contents(scratch.file("new/folder")),
        ElementsAre("spectrel-000001-lte.pcap: 1", "spectrel-000002-gsm.pcap: 2"));
}

TEST_F(RecordingFilesTest, FolderGoesOnBehindItsHighestNumber)
{
    scratch.write("spectrel-000041-gsm.pcap", "an old one");
    scratch.write("spectrel-000099.pcap", "no recording of ours");
    auto files = open({scratch.path().string(), {}, {}, {}});
    write(files, 1);
    EXPECT_EQ(files.path(), scratch.file("spectrel-000042-lte.pcap"));
    EXPECT_THAT(contents(scratch.path().string()),
        testing::Contains("spectrel-000041-gsm.pcap: neither a capture nor a snapshot nor a DLF file"));
}

TEST_F(RecordingFilesTest, TwoRecordersInOneFolderShareNoFile)
{
    auto one = open({scratch.path().string(), {}, {}, {}});
    auto other = open({scratch.path().string(), {}, {}, {}});
    write(one, 1);
    write(other, 2);
    EXPECT_THAT(
        contents(scratch.path().string()), ElementsAre("spectrel-000001-lte.pcap: 1", "spectrel-000002-lte.pcap: 2"));
}

TEST_F(RecordingFilesTest, FurtherFilesOverwriteNothing)
{
    scratch.write("a.pcap", "old");
    scratch.write("a-2.pcap", "mine");
    auto files = open({scratch.file("a.pcap"), {}, 1s, {}, true});
    write(files, 2);
    EXPECT_EQ(files.path(), scratch.file("a-3.pcap"));
    EXPECT_EQ(std::filesystem::file_size(scratch.file("a-2.pcap")), 4u);
}

TEST_F(RecordingFilesTest, FileThatIsThereIsLeftAloneUnlessItMayBeOverwritten)
{
    scratch.write("a.pcap", "mine");
    RecordingFiles refused({scratch.file("a.pcap"), {}, {}, {}}, loop);
    const auto prepared = refused.prepare();
    ASSERT_FALSE(prepared);
    EXPECT_EQ(prepared.failure().text, scratch.file("a.pcap") + ": is there already (--overwrite writes over it)");
    EXPECT_EQ(scratch.read("a.pcap"), "mine");
    auto files = open({scratch.file("a.pcap"), {}, {}, {}, true});
    write(files, 2);
    EXPECT_THAT(contents(scratch.path().string()), ElementsAre("a.pcap: 2"));
}

TEST_F(RecordingFilesTest, FileThatHasComeInTheMeantimeIsLeftAlone)
{
    auto files = open({scratch.file("a.pcap"), {}, {}, {}});
    scratch.write("a.pcap", "mine");
    EXPECT_FALSE(files.begin(Technology::LTE));
    EXPECT_EQ(scratch.read("a.pcap"), "mine");
}

TEST_F(RecordingFilesTest, PlantedLinksAreNotFollowed)
{
    scratch.write("victim", "text");
    std::filesystem::create_symlink("victim", scratch.file("a.pcap"));
    std::filesystem::create_symlink("victim", scratch.file(".b.pcap-" + std::to_string(::getpid())));
    RecordingFiles linked({scratch.file("a.pcap"), {}, {}, {}, true}, loop);
    EXPECT_TRUE(linked.prepare());
    const auto begun = linked.begin(Technology::LTE);
    ASSERT_FALSE(begun);
    EXPECT_EQ(begun.failure().text, scratch.file("a.pcap") + ": it is a link, and links are not followed");
    auto files = open({scratch.file("b.pcap"), {}, {}, {}});
    write(files, 1);
    EXPECT_EQ(scratch.read("victim"), "text");
    EXPECT_EQ(std::filesystem::status(scratch.file("b.pcap")).permissions(), std::filesystem::perms(0600));
}

TEST_F(RecordingFilesTest, FileThatAnotherRecorderWritesIsNeitherOverwrittenNorRemoved)
{
    auto one = open({scratch.path().string(), {}, {}, {}});
    write(one, 1);
    auto other = open({scratch.path().string(), {}, 1s, 2});
    write(other, 4);
    write(one, 1);
    EXPECT_THAT(contents(scratch.path().string()),
        ElementsAre("spectrel-000001-lte.pcap: 2", "spectrel-000004-lte.pcap: 1", "spectrel-000005-lte.pcap: 1"));
    RecordingFiles third({one.path(), {}, {}, {}, true}, loop);
    const auto begun = third.begin(Technology::LTE);
    ASSERT_FALSE(begun);
    EXPECT_EQ(begun.failure().text, one.path() + ": another program is writing it");
    EXPECT_THAT(contents(scratch.path().string()), testing::Contains("spectrel-000001-lte.pcap: 2"));
}

TEST_F(RecordingFilesTest, HighestNumberIsNotCountedBeyond)
{
    const std::string highest = scratch.write("spectrel-18446744073709551615-lte.pcap", "old");
    auto files = open({scratch.path().string(), {}, 1s, 2});
    const auto written = files.write(Technology::LTE, RecordBuilder(0xB0C2, 13));
    ASSERT_FALSE(written);
    EXPECT_EQ(written.failure().text, highest + ": has the highest number that there is; no file can follow it");
    EXPECT_EQ(scratch.read("spectrel-18446744073709551615-lte.pcap"), "old");
}

TEST_F(RecordingFilesTest, OnlyTheLastFilesAreKept)
{
    scratch.write("spectrel-000007-gsm.pcap", "of an earlier run");
    auto files = open({scratch.path().string(), {}, 1s, 2});
    write(files, 4);
    EXPECT_THAT(
        contents(scratch.path().string()), ElementsAre("spectrel-000010-lte.pcap: 1", "spectrel-000011-lte.pcap: 1"));
}

TEST_F(RecordingFilesTest, OfNamedFilesOnlyThisRecordingsAreRemoved)
{
    scratch.write("other.pcap", "not ours");
    auto files = open({scratch.file("a.pcap"), {}, 1s, 2});
    write(files, 4);
    EXPECT_THAT(contents(scratch.path().string()),
        ElementsAre("a-3.pcap: 1", "a-4.pcap: 1", testing::StartsWith("other.pcap: ")));
}

TEST_F(RecordingFilesTest, PlaceThatCannotBeWrittenIsToldBeforehand)
{
    RecordingFiles files({scratch.file("nowhere/a.pcap"), {}, {}, {}}, loop);
    const auto prepared = files.prepare();
    ASSERT_FALSE(prepared);
    EXPECT_EQ(prepared.failure().text, scratch.file("nowhere/a.pcap") + ": No such file or directory");
    scratch.write("file", "");
    RecordingFiles folder({scratch.file("file/folder/"), {}, {}, {}}, loop);
    EXPECT_FALSE(folder.prepare());
}

TEST(SizeTest, UnitsArePowersOfAThousand)
{
    EXPECT_EQ(parseSize("100M"), 100'000'000u);
    EXPECT_EQ(parseSize("1.5k"), 1500u);
    EXPECT_EQ(parseSize("2G"), 2'000'000'000u);
    EXPECT_EQ(parseSize("1000"), 1000u);
    for (const char* text : {"", "M", "999", "0", "-1M", "1T", "1 M", "1MB"})
        EXPECT_EQ(parseSize(text), std::nullopt) << text;
}

} // namespace
} // namespace spectrel
