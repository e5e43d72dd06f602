#include "Platform/Syslog/FileLog.h"
#include "Tests/Fakes/ScratchFolder.h"

#include <fstream>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <iterator>

namespace spectrel {
namespace {

using namespace std::string_literals;

class FileLogTest : public testing::Test {
protected:
    std::string content() const
    {
        std::ifstream file(path, std::ios::binary);
        return {std::istreambuf_iterator<char>(file), {}};
    }

    ScratchFolder folder;
    std::string path = folder.path().string() + "/log";
};

TEST_F(FileLogTest, LinesHaveThePriorityAndTheText)
{
    const auto log = *FileLog::create(path, FileLog::Writing::EachLine);
    log->write(3, "Could not create the ports necessary");
    log->write(16, "DLF");
    EXPECT_EQ(content(), "<3>Could not create the ports necessary\n<16>DLF\n");
}

TEST_F(FileLogTest, ControlCharactersAreEscapedAsInC)
{
    const auto log = *FileLog::create(path, FileLog::Writing::EachLine);
    log->write(4, "\n\t\r\a\b\f\v\\"s + "\0"s + "1\x1b" + "7\x7f");
    EXPECT_EQ(content(), "<4>\\n\\t\\r\\a\\b\\f\\v\\\\0001\\0337\\177\n");
}

TEST_F(FileLogTest, BytesBeyondASCIIStandAsTheyAre)
{
    const auto log = *FileLog::create(path, FileLog::Writing::EachLine);
    log->write(4, "\xC3\xA4\xFF\"'");
    EXPECT_EQ(content(), "<4>\xC3\xA4\xFF\"'\n");
}

TEST_F(FileLogTest, BufferedLinesAreThereAfterFlush)
{
    const auto log = *FileLog::create(path, FileLog::Writing::Buffered);
    log->write(4, "line");
    EXPECT_EQ(content(), "");
    EXPECT_TRUE(log->flush());
    EXPECT_EQ(content(), "<4>line\n");
}

TEST_F(FileLogTest, FileThatCannotBeMadeTellsWhy)
{
    const auto created = FileLog::create(folder.path().string() + "/no/log", FileLog::Writing::Buffered);
    ASSERT_FALSE(created);
    EXPECT_EQ(created.failure().text, "No such file or directory");
}

TEST_F(FileLogTest, FullDeviceIsReportedByFlush)
{
    const auto log = *FileLog::create("/dev/full", FileLog::Writing::Buffered);
    log->write(4, "line");
    EXPECT_FALSE(log->flush());
}

} // namespace
} // namespace spectrel
