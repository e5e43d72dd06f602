#include "Tests/Fakes/ScratchFolder.h"
#include "Tests/Records/RecordingText.h"

#include <gtest/gtest.h>

namespace spectrel {

namespace {

class RecordingKindTest : public testing::Test {
protected:
    std::string reason(const std::string& bytes)
    {
        return readRecording(_folder.write("x", bytes)).reason;
    }
    ScratchFolder _folder;
};

constexpr const char* Unknown = "neither a capture nor a snapshot nor a DLF file";

} // namespace

TEST_F(RecordingKindTest, MissingFilesFoldersAndEmptyFilesAreTold)
{
    EXPECT_EQ(readRecording(_folder.file("missing")).reason, "No such file or directory");
    EXPECT_EQ(readRecording(_folder.path().string()).reason, "Is a directory");
    EXPECT_EQ(reason(""), "the file is empty");
}

TEST_F(RecordingKindTest, UnknownContentIsTold)
{
    EXPECT_EQ(reason("garbage"), Unknown);
    EXPECT_EQ(reason("x"), Unknown);
    EXPECT_EQ(reason(std::string(5000, '\0')), Unknown);
    EXPECT_EQ(reason("# A text file\n" + std::string(100000, 'x')), Unknown);
    EXPECT_EQ(reason("\xA1\xB2\xC3"), Unknown);
}

TEST_F(RecordingKindTest, EndlessFileIsTold)
{
    EXPECT_EQ(readRecording("/dev/zero").reason, "larger than 268435456 bytes");
}

TEST_F(RecordingKindTest, PropertyListsThatAreNoSnapshotAreTold)
{
    EXPECT_EQ(reason("<plist><dict></plist>"), "a property list that does not parse");
    EXPECT_EQ(reason("bplist00"), "a property list that does not parse");
    const char* foreign = "a property list, but no snapshot: it has no list \"Data\"";
    EXPECT_EQ(reason("<plist><dict/></plist>"), foreign);
    EXPECT_EQ(reason("<plist><dict><key>Data</key><string/></dict></plist>"), foreign);
    EXPECT_EQ(reason("\xEF\xBB\xBF<?xml version=\"1.0\"?><plist><array/></plist>"), foreign);
    EXPECT_EQ(reason("\n <!-- a comment --><plist><array/></plist>"), foreign);
}

TEST_F(RecordingKindTest, ContentTellsTheKindNotTheName)
{
    const auto path = _folder.write("snapshot.pcap", "<plist><dict><key>Data</key><array/></dict></plist>");
    EXPECT_TRUE(readRecording(path).isOpen);
    EXPECT_TRUE(readRecording(_folder.write("dlf.spectrel", versionReport())).isOpen);
}

} // namespace spectrel
