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
        const auto second = NameLock::take(folder.path().string(), "name");
        ASSERT_FALSE(second);
        EXPECT_EQ(second.failure().code, Failure::Code::Exists);
        EXPECT_TRUE(NameLock::take(folder.path().string(), "other"));
    }
    EXPECT_TRUE(std::filesystem::is_empty(folder.path().string()));
    EXPECT_TRUE(NameLock::take(folder.path().string(), "name"));
}

TEST(PortNameTest, FolderThatIsNotThereYieldsNoLock)
{
    const auto nowhere = NameLock::take("/nonexistent", "name");
    ASSERT_FALSE(nowhere);
    EXPECT_EQ(nowhere.failure().code, Failure::Code::Missing) << "another process holds nothing there";
}

} // namespace
} // namespace spectrel
