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

std::string whyNotWritten(const Value& value, const std::string& path)
{
    const auto written = writePropertyListToFile(value, path);
    return written ? "written" : written.failure().text;
}

TEST(PropertyListFileTest, WrittenFileReadsBack)
{
    const ScratchFolder folder;
    const Value value = Dictionary::make({{"k", "v"}});
    ASSERT_TRUE(writePropertyListToFile(value, folder.file("x")));
    EXPECT_EQ(readPropertyListFile(folder.file("x")), value);
    EXPECT_EQ(folder.read("x"), serialisePropertyList(value));
}

TEST(PropertyListFileTest, FileIsPrivateAlsoWhenItWasThere)
{
    const ScratchFolder folder;
    folder.write("old", std::string(5000, 'x'));
    ASSERT_EQ(::chmod(folder.file("old").c_str(), 0644), 0);
    for (const char* name : {"old", "new"}) {
        ASSERT_TRUE(writePropertyListToFile("text", folder.file(name)));
        EXPECT_EQ(mode(folder.file(name)), 0600u) << name;
        EXPECT_EQ(folder.read(name), serialisePropertyList("text")) << name;
    }
}

TEST(PropertyListFileTest, PlacesThatCannotBeWrittenAreReported)
{
    const ScratchFolder folder;
    EXPECT_EQ(whyNotWritten("text", folder.file("no/such/folder")), "No such file or directory");
    EXPECT_EQ(whyNotWritten("text", folder.path().string()), "Is a directory");
}

TEST(PropertyListFileTest, FullDiskIsReportedAndTheDeviceIsLeftAlone)
{
    const unsigned before = mode("/dev/full");
    EXPECT_EQ(whyNotWritten("text", "/dev/full"), "No space left on device");
    EXPECT_EQ(mode("/dev/full"), before);
}

TEST(PropertyListFileTest, ValueThatCannotBeWrittenLeavesTheFileAsItWas)
{
    const ScratchFolder folder;
    folder.write("x", "old");
    EXPECT_EQ(whyNotWritten(Value(), folder.file("x")), "the value cannot be written as a property list");
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
