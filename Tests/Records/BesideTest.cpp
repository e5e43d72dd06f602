#include "Records/Beside/Beside.h"

#include "Records/Beside/Gaps.h"
#include "Records/Beside/Marks.h"
#include "Tests/Fakes/ScratchFolder.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <sys/stat.h>

namespace spectrel {
namespace {

using std::chrono::microseconds;

class BesideTest : public testing::Test {
protected:
    std::string marks(const std::string& content)
    {
        folder.write("drive.marks", content);
        return marksThere();
    }
    std::string marksThere()
    {
        std::string text;
        const Marks read = readMarks(recording);
        for (const Mark& mark : read.marks)
            text += secondsForm(mark.time) + " " + mark.note + "\n";
        damage = read.damage;
        return text;
    }
    std::string gaps(const std::string& content)
    {
        folder.write("drive.gaps", content);
        std::string text;
        const Gaps read = readGaps(recording);
        for (const Gap& gap : read.gaps)
            text += secondsForm(gap.time) + " " + std::to_string(gap.lost) + "\n";
        damage = read.damage;
        return text;
    }
    Outcome append(const std::string& note)
    {
        return appendMark(recording, {Moment(microseconds(1'733'000'000'123'456)), note});
    }

    const ScratchFolder folder;
    const std::string recording = folder.file("drive.pcap");
    const std::string file = folder.file("drive.marks");
    std::string damage;
};

TEST_F(BesideTest, EndingTakesThePlaceOfThatOfACapture)
{
    EXPECT_EQ(marksPath("/a/drive.pcap"), "/a/drive.marks");
    EXPECT_EQ(gapsPath("drive-2.pcap"), "drive-2.gaps");
    EXPECT_EQ(marksPath("a.pcap/drive"), "a.pcap/drive.marks");
    EXPECT_EQ(marksPath("a.spectrel"), "a.spectrel.marks");
}

TEST_F(BesideTest, MarksComeInTheOrderOfTime)
{
    EXPECT_EQ(
        marks("{\"time\": 1733000002.5, \"note\": \"b\"}\n{\"note\": \"a\\n\\u00e4\", \"time\": 1733000001.123456}\n"
              "{\"time\": 1733000002.5, \"note\": \"c\", \"who\": {\"name\": 1}}\r\n\n"),
        "1733000001.123456 a\n\xC3\xA4\n1733000002.500000 b\n1733000002.500000 c\n");
    EXPECT_EQ(damage, "");
}

TEST_F(BesideTest, NoFileIsNoMark)
{
    EXPECT_EQ(marksThere(), "");
    EXPECT_EQ(damage, "");
}

TEST_F(BesideTest, LinesThatAreNoMarksAreLeftOutAndReported)
{
    EXPECT_EQ(marks("nonsense\n{\"time\": 1, \"note\": \"a\"}\n{\"time\": \"1\", \"note\": \"b\"}\n{\"time\": 2}\n"
                    "{\"time\": -1, \"note\": \"c\"}\n{\"time\": 1e300, \"note\": \"d\"}\n{\"time\": 3, \"no"),
        "1.000000 a\n");
    EXPECT_EQ(damage, file + ": line 1 is not understood, nor are 5 further ones");
    EXPECT_EQ(marks("{\"time\": 1, \"note\": \"a\"}\n{\"time\": 2, \"no"), "1.000000 a\n");
    EXPECT_EQ(damage, file + ": line 2 is not understood");
}

TEST_F(BesideTest, VeryLongLineIsNoMark)
{
    EXPECT_EQ(marks("{\"time\": 1, \"note\": \"" + std::string(70'000, 'x') + "\"}\n{\"time\": 2, \"note\": \"b\"}\n"),
        "2.000000 b\n");
}

TEST_F(BesideTest, VeryLongFileIsReadAtItsBeginning)
{
    std::string content;
    while (content.size() <= 16 * 1024 * 1024)
        content += "{\"time\": 1, \"note\": \"" + std::string(60'000, 'x') + "\"}\n";
    EXPECT_NE(marks(content), "");
    EXPECT_EQ(damage, file + ": only the first 16 MiB were read");
}

TEST_F(BesideTest, WhatIsNoFileIsReported)
{
    std::filesystem::create_directory(file);
    EXPECT_EQ(marksThere(), "");
    EXPECT_EQ(damage, file + ": is no file");
    std::filesystem::remove(file);
    ASSERT_EQ(::mkfifo(file.c_str(), 0600), 0);
    EXPECT_EQ(marksThere(), ""); // and does not wait for somebody to write
    EXPECT_EQ(damage, file + ": is no file");
}

TEST_F(BesideTest, AppendedMarksAreRead)
{
    EXPECT_TRUE(append("tunnel"));
    EXPECT_TRUE(append("a \"quoted\"\nline"));
    EXPECT_EQ(folder.read("drive.marks"),
        "{\"time\": 1733000000.123456, \"note\": \"tunnel\"}\n"
        "{\"time\": 1733000000.123456, \"note\": \"a \\\"quoted\\\"\\nline\"}\n");
    EXPECT_EQ(marksThere(), "1733000000.123456 tunnel\n1733000000.123456 a \"quoted\"\nline\n");
    EXPECT_EQ(std::filesystem::status(file).permissions(), std::filesystem::perms(0600));
}

TEST_F(BesideTest, LineThatWasCutOffIsEndedFirst)
{
    folder.write("drive.marks", "{\"time\": 1, \"no");
    EXPECT_TRUE(append("tunnel"));
    EXPECT_EQ(marksThere(), "1733000000.123456 tunnel\n");
    EXPECT_EQ(damage, file + ": line 1 is not understood");
}

TEST_F(BesideTest, NoteIsCutToItsLimitAndMadeOfCharacters)
{
    EXPECT_TRUE(append("\xFF" + std::string(LongestNote - 4, 'x') + "\xC3\xA4"));
    EXPECT_EQ(readMarks(recording).marks.at(0).note, "\xEF\xBF\xBD" + std::string(LongestNote - 4, 'x'));
}

TEST_F(BesideTest, FileThatCannotBeWrittenIsNamed)
{
    std::filesystem::create_symlink(folder.file("elsewhere"), file);
    const Outcome linked = append("tunnel");
    ASSERT_FALSE(linked);
    EXPECT_TRUE(linked.failure().text.starts_with(file + ": ")) << linked.failure().text;
    EXPECT_FALSE(std::filesystem::exists(folder.file("elsewhere")));
    std::filesystem::remove(file);
    ASSERT_EQ(::mkfifo(file.c_str(), 0600), 0);
    const Outcome piped = append("tunnel");
    ASSERT_FALSE(piped);
    EXPECT_EQ(piped.failure().text, file + ": is not a file of this user");
}

TEST_F(BesideTest, GapsAreReadLikewise)
{
    EXPECT_EQ(gaps("{\"time\": 5, \"lost\": 12}\n{\"time\": 2.25, \"lost\": 1}\n{\"time\": 3, \"lost\": 1.5}\n"
                   "{\"time\": 3, \"lost\": -1}\n{\"time\": 3, \"lost\": 1e300}\n{\"time\": 3}\n"),
        "2.250000 1\n5.000000 12\n");
    EXPECT_EQ(damage, folder.file("drive.gaps") + ": line 3 is not understood, nor are 3 further ones");
}

TEST_F(BesideTest, MarksAndGapsGoWithTheirRecording)
{
    folder.write("drive.marks", "");
    folder.write("drive.gaps", "");
    folder.write("drive-2.marks", "");
    removeBeside(recording);
    EXPECT_FALSE(std::filesystem::exists(file));
    EXPECT_FALSE(std::filesystem::exists(folder.file("drive.gaps")));
    EXPECT_TRUE(std::filesystem::exists(folder.file("drive-2.marks")));
}

} // namespace
} // namespace spectrel
