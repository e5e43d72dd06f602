#include "Platform/Syslog/DiagnosticFile.h"

#include "Tests/Fakes/ScratchFolder.h"

#include <fstream>
#include <gtest/gtest.h>
#include <iterator>

namespace spectrel {
namespace {

class DiagnosticFileTest : public testing::Test {
protected:
    ScratchFolder folder;
    std::string path = folder.path().string() + "/diagnostics";
};

TEST_F(DiagnosticFileTest, LineIsInTheFileAtOnce)
{
    const auto log = *DiagnosticFile::create(path);
    log->write("Display Dict = {}\nmore");
    std::ifstream file(path, std::ios::binary);
    EXPECT_EQ(std::string(std::istreambuf_iterator<char>(file), {}), "<7>Display Dict = {}\\nmore\n");
}

TEST_F(DiagnosticFileTest, FileThatCannotBeMadeIsTold)
{
    const auto created = DiagnosticFile::create(folder.path().string() + "/no/such/folder");
    ASSERT_FALSE(created);
    EXPECT_EQ(created.failure().text, "No such file or directory");
}

} // namespace
} // namespace spectrel
