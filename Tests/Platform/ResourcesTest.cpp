#include "Platform/Resources.h"

#include "Tests/Fakes/ScratchFolder.h"
#include "Values/Dictionary.h"

#include <gtest/gtest.h>

namespace spectrel {

namespace {

constexpr std::string_view OneKey = "<plist><dict><key>k</key><string>v</string></dict></plist>";

} // namespace

TEST(ResourcesTest, NamedListIsReadFromItsFile)
{
    const ScratchFolder folder;
    folder.write("LTE.plist", OneKey);
    const auto list = DirectoryResources(folder.path().string()).propertyList("LTE");
    ASSERT_TRUE(list);
    EXPECT_EQ(*(*list->dictionary())["k"].string(), "v");
}

TEST(ResourcesTest, MissingAndMalformedListsAreNone)
{
    const ScratchFolder folder;
    folder.write("Broken.plist", "<plist><dict>");
    const DirectoryResources resources(folder.path().string());
    EXPECT_FALSE(resources.propertyList("Broken"));
    EXPECT_FALSE(resources.propertyList("Absent"));
}

TEST(ResourcesTest, PathsAreThePropertyListsSortedByName)
{
    const ScratchFolder folder;
    for (const char* name : {"b.plist", "a.plist", "c.txt", "C.plist"})
        folder.write(name, OneKey);
    const auto paths = DirectoryResources(folder.path().string()).propertyListPaths();
    EXPECT_EQ(paths, (std::vector {folder.file("C.plist"), folder.file("a.plist"), folder.file("b.plist")}));
}

TEST(ResourcesTest, MissingFolderHasNoPaths)
{
    const ScratchFolder folder;
    EXPECT_TRUE(DirectoryResources(folder.file("nowhere")).propertyListPaths().empty());
}

TEST(ResourcesTest, NoneHoldNothing)
{
    EXPECT_FALSE(Resources::none().propertyList("LTE"));
    EXPECT_TRUE(Resources::none().propertyListPaths().empty());
}

} // namespace spectrel
