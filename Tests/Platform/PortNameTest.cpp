#include "Platform/Sockets/PortName.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Tests/Fakes/ScratchFolder.h"

#include <filesystem>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace spectrel {
namespace {

using testing::HasSubstr;
using namespace std::string_literals;

class UnusableNameTest : public testing::TestWithParam<std::string> { };

TEST_P(UnusableNameTest, IsRefusedAndLogged)
{
    LogRecorder log;
    EXPECT_FALSE(portAddress("/run/ports", GetParam(), log));
    EXPECT_THAT(log.takeLog(), HasSubstr("refused: it must not be empty, start with a dot, or hold"));
}

INSTANTIATE_TEST_SUITE_P(
    Names, UnusableNameTest, testing::Values("", ".", "..", ".hidden", "a/b", "/absolute", "../up", "zero\0byte"s));

TEST(PortNameTest, PathMayHave107BytesAndNoMore)
{
    LogRecorder log;
    const std::string fits(107 - 6, 'n');
    const auto address = portAddress("/ports"s.substr(0, 5), fits, log);
    ASSERT_TRUE(address);
    EXPECT_EQ(std::string(address->sun_path), "/port/" + fits);
    EXPECT_EQ(log.takeLog(), "");
    EXPECT_FALSE(portAddress("/port", fits + "n", log));
    EXPECT_THAT(log.takeLog(), HasSubstr("refused: with its folder it is longer than 107 bytes"));
}

TEST(PortNameTest, LockIsExclusiveUntilItEnds)
{
    const ScratchFolder folder;
    {
        const auto first = NameLock::take(folder.path().string(), "name");
        EXPECT_TRUE(first);
        EXPECT_FALSE(NameLock::take(folder.path().string(), "name"));
        EXPECT_TRUE(NameLock::take(folder.path().string(), "other"));
    }
    EXPECT_TRUE(std::filesystem::is_empty(folder.path().string()));
    EXPECT_TRUE(NameLock::take(folder.path().string(), "name"));
}

TEST(PortNameTest, FolderThatIsNotThereYieldsNoLock)
{
    EXPECT_FALSE(NameLock::take("/nonexistent", "name"));
}

} // namespace
} // namespace spectrel
