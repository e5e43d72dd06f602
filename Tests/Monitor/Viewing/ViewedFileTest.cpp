#include "Monitor/Viewing/ViewedFile.h"

#include "Tests/Monitor/Viewing/ViewFixture.h"

#include <sys/stat.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

class ViewedFileTest : public ViewFixture {
protected:
    std::string refusal(const std::string& path)
    {
        return view(path) ? "viewed" : reason;
    }
};

TEST_F(ViewedFileTest, WhatIsNoRecordingIsRefusedWithItsReason)
{
    EXPECT_EQ(refusal(scratch.file("missing")), "No such file or directory");
    EXPECT_EQ(refusal(scratch.path().string()), "Is a directory");
    EXPECT_EQ(refusal(scratch.write("empty", "")), "the file is empty");
    EXPECT_EQ(refusal(scratch.write("text", "~~~~ no recording")), "neither a capture nor a snapshot nor a DLF file");
    EXPECT_EQ(refusal(scratch.write("list", "<plist><dict/></plist>")),
        "a property list, but no snapshot: it has no list \"Data\"");
}

TEST_F(ViewedFileTest, APipeIsRefusedBecauseItCannotBeReadAgain)
{
    ASSERT_EQ(::mkfifo(scratch.file("pipe").c_str(), 0600), 0);
    EXPECT_EQ(refusal(scratch.file("pipe")), "not a plain file: it could not be read again for going back");
}

TEST_F(ViewedFileTest, ARecordingWithoutAMessageIsRefused)
{
    EXPECT_EQ(refusal(writeRecording({})), "the recording holds no message");
}

TEST_F(ViewedFileTest, AFileThatTellsNoTechnologyIsAskedFor)
{
    const Bytes item = cell(9); // a DLF item is a record without its type byte
    const std::string path = scratch.write("a.dlf", {reinterpret_cast<const char*>(item.data()) + 1, item.size() - 1});
    EXPECT_EQ(refusal(path), "does not tell its technology; name it with --technology");
    ASSERT_TRUE(view(path, Technology::LTE)) << reason;
    EXPECT_EQ(place(), "0 ms, 1: 9");
}

TEST_F(ViewedFileTest, TheFilesOwnTechnologyCounts)
{
    ASSERT_TRUE(view(writeRecording({{0s, cell(9)}}), Technology::GSM)) << reason;
    EXPECT_EQ(identity(), "9");
}

} // namespace
} // namespace spectrel
