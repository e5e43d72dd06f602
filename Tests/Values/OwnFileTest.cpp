#include "Values/OwnFile.h"

#include "Tests/Fakes/ScratchFolder.h"

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

namespace spectrel {
namespace {

unsigned mode(const std::string& path)
{
    struct stat status { };
    EXPECT_EQ(::lstat(path.c_str(), &status), 0);
    return status.st_mode & 07777;
}

/// "opened", or why not.
std::string opening(const std::string& path, IfThere ifThere = IfThere::Overwrite)
{
    const auto file = openOwnFile(path, ifThere);
    if (!file)
        return file.failure().text;
    ::close(*file);
    return "opened";
}

class OwnFileTest : public testing::Test {
protected:
    OwnFileTest()
        : former(::umask(0))
    {
    }
    ~OwnFileTest() override
    {
        ::umask(former);
    }

    ScratchFolder folder;
    mode_t former;
};

TEST_F(OwnFileTest, NewFileIsItsOwnersAlone)
{
    EXPECT_EQ(opening(folder.file("a"), IfThere::Refuse), "opened");
    EXPECT_EQ(opening(folder.file("b")), "opened");
    EXPECT_EQ(mode(folder.file("a")), 0600u);
    EXPECT_EQ(mode(folder.file("b")), 0600u);
}

TEST_F(OwnFileTest, FileThatIsThereIsRefusedOrOpenedAsItIs)
{
    folder.write("a", "text");
    ASSERT_EQ(::chmod(folder.file("a").c_str(), 0666), 0);
    const auto refused = openOwnFile(folder.file("a"), IfThere::Refuse);
    ASSERT_FALSE(refused);
    EXPECT_EQ(refused.failure().code, Failure::Code::Exists);
    EXPECT_EQ(mode(folder.file("a")), 0666u);
    EXPECT_EQ(opening(folder.file("a")), "opened");
    EXPECT_EQ(mode(folder.file("a")), 0600u);
    EXPECT_EQ(folder.read("a"), "text");
}

TEST_F(OwnFileTest, LinksAreNotFollowed)
{
    folder.write("victim", "text");
    std::filesystem::create_symlink("victim", folder.file("link"));
    std::filesystem::create_symlink("nothing", folder.file("dangling"));
    for (const char* name : {"link", "dangling"}) {
        EXPECT_EQ(opening(folder.file(name)), "it is a link, and links are not followed");
        EXPECT_EQ(opening(folder.file(name), IfThere::Refuse), "File exists");
    }
    std::filesystem::create_hard_link(folder.file("victim"), folder.file("hard"));
    EXPECT_EQ(opening(folder.file("hard")), "it has a further name (a hard link)");
    EXPECT_FALSE(std::filesystem::exists(folder.file("nothing")));
}

TEST_F(OwnFileTest, FileOfSomebodyElseIsRefused)
{
    if (::geteuid() != 0)
        GTEST_SKIP() << "only root can give files away";
    folder.write("foreign", "text");
    ASSERT_EQ(::chown(folder.file("foreign").c_str(), 65534, 65534), 0);
    ASSERT_EQ(::mkfifo(folder.file("fifo").c_str(), 0666), 0);
    ASSERT_EQ(::chown(folder.file("fifo").c_str(), 65534, 65534), 0);
    EXPECT_EQ(opening(folder.file("foreign")), "it belongs to somebody else");
    EXPECT_EQ(opening(folder.file("fifo")), "No such device or address") << "and is not waited for";
}

TEST_F(OwnFileTest, DevicesAndTheProcessesOwnOutputsAreOpened)
{
    EXPECT_EQ(opening("/dev/null"), "opened");
    EXPECT_EQ(opening("/dev/fd/1"), "opened");
    EXPECT_EQ(opening(folder.path().string()), "Is a directory");
}

TEST_F(OwnFileTest, MissingFoldersAreMadeForTheirOwnerAlone)
{
    EXPECT_TRUE(makeOwnFolders(folder.file("a/b/")));
    EXPECT_EQ(mode(folder.file("a")), 0700u);
    EXPECT_EQ(mode(folder.file("a/b")), 0700u);
    EXPECT_TRUE(makeOwnFolders(folder.file("a/b")));
    folder.write("file", "");
    const auto made = makeOwnFolders(folder.file("file/below"));
    ASSERT_FALSE(made);
    EXPECT_EQ(made.failure().text, folder.file("file") + ": Not a directory");
}

TEST_F(OwnFileTest, LinkWhereEverybodyCanWriteIsNoFolder)
{
    const ScratchFolder elsewhere;
    const std::string open = folder.file("open");
    ASSERT_EQ(::mkdir(open.c_str(), 0700), 0);
    std::filesystem::create_directory_symlink(elsewhere.path(), open + "/link");
    EXPECT_TRUE(makeOwnFolders(open + "/link/below")) << "its owner's alone: nobody can have planted it";
    ASSERT_EQ(::chmod(open.c_str(), 01777), 0);
    const auto made = makeOwnFolders(open + "/link/below/further");
    ASSERT_FALSE(made);
    EXPECT_EQ(made.failure().text, open + "/link: not a folder of this user, where everybody could have put it");
    EXPECT_FALSE(std::filesystem::exists(elsewhere.path() / "below/further"));
}

} // namespace
} // namespace spectrel
