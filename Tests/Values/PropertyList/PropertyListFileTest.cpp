#include "Values/PropertyList/PropertyList.h"

#include "Tests/Fakes/ScratchFolder.h"
#include "Tests/Values/PropertyList/ValueText.h"
#include "Values/Dictionary.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

namespace spectrel {

namespace {

unsigned mode(const std::string& path)
{
    struct stat status { };
    EXPECT_EQ(::stat(path.c_str(), &status), 0);
    return status.st_mode & 0777;
}

} // namespace

TEST(PropertyListFileTest, WrittenFileReadsBack)
{
    const ScratchFolder folder;
    const Value value = Dictionary::make({{"k", "v"}});
    std::string reason;
    ASSERT_TRUE(writePropertyListToFile(value, folder.file("x"), reason)) << reason;
    EXPECT_EQ(readPropertyListFile(folder.file("x")), value);
    EXPECT_EQ(folder.read("x"), serialisePropertyList(value));
}

TEST(PropertyListFileTest, FileIsPrivateAlsoWhenItWasThere)
{
    const ScratchFolder folder;
    folder.write("old", std::string(5000, 'x'));
    ASSERT_EQ(::chmod(folder.file("old").c_str(), 0644), 0);
    std::string reason;
    for (const char* name : {"old", "new"}) {
        ASSERT_TRUE(writePropertyListToFile("text", folder.file(name), reason)) << reason;
        EXPECT_EQ(mode(folder.file(name)), 0600u) << name;
        EXPECT_EQ(folder.read(name), serialisePropertyList("text")) << name;
    }
}

TEST(PropertyListFileTest, PlacesThatCannotBeWrittenAreReported)
{
    const ScratchFolder folder;
    std::string reason;
    EXPECT_FALSE(writePropertyListToFile("text", folder.file("no/such/folder"), reason));
    EXPECT_EQ(reason, "No such file or directory");
    EXPECT_FALSE(writePropertyListToFile("text", folder.path().string(), reason));
    EXPECT_EQ(reason, "Is a directory");
}

TEST(PropertyListFileTest, FullDiskIsReportedAndTheDeviceIsLeftAlone)
{
    const unsigned before = mode("/dev/full");
    std::string reason;
    EXPECT_FALSE(writePropertyListToFile("text", "/dev/full", reason));
    EXPECT_EQ(reason, "No space left on device");
    EXPECT_EQ(mode("/dev/full"), before);
}

TEST(PropertyListFileTest, ValueThatCannotBeWrittenLeavesTheFileAsItWas)
{
    const ScratchFolder folder;
    folder.write("x", "old");
    std::string reason;
    EXPECT_FALSE(writePropertyListToFile(Value(), folder.file("x"), reason));
    EXPECT_EQ(reason, "the value cannot be written as a property list");
    EXPECT_EQ(folder.read("x"), "old");
}

TEST(PropertyListFileTest, UnreadableFilesAreNone)
{
    const ScratchFolder folder;
    EXPECT_FALSE(readPropertyListFile(folder.file("missing")));
    EXPECT_FALSE(readPropertyListFile(folder.path().string()));
    EXPECT_FALSE(readPropertyListFile(folder.write("empty", "")));
    EXPECT_FALSE(readPropertyListFile(folder.write("garbage", "garbage")));
}

TEST(PropertyListFileTest, EndlessFileEndsAtTheLimit)
{
    EXPECT_FALSE(readPropertyListFile("/dev/zero"));
}

} // namespace spectrel
