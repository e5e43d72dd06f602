#include "UI/KeyTable.h"

#include "Tests/Fakes/SourceFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <fstream>
#include <set>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {
namespace {

constexpr KeyScope Scopes[] {KeyScope::Browsing, KeyScope::Playing};
constexpr KeyTaker Takers[] {KeyTaker::Terminal, KeyTaker::Window};

std::string_view listOf(const KeyBinding& binding, KeyTaker taker)
{
    return taker == KeyTaker::Terminal ? binding.terminal : binding.window;
}

/// The line as a row of the document's tables.
std::string row(const KeyLine& line)
{
    std::string window;
    for (const KeyBinding& binding : line.bindings) {
        for (const std::string_view key : keysIn(binding.window))
            window.append(window.empty() ? "`" : " ").append(key);
    }
    return "| `" + std::string(line.keys) + "` | " + window + (window.empty() ? "" : "` ") + "| "
        + std::string(line.help) + " |";
}

TEST(KeyTableTest, NoKeyIsBoundTwice)
{
    for (const KeyTaker taker : Takers) {
        for (const KeyScope scope : Scopes) {
            std::set<std::string_view> seen;
            for (const KeyLine& line : keyTable(scope)) {
                for (const KeyBinding& binding : line.bindings) {
                    for (const std::string_view key : keysIn(listOf(binding, taker))) {
                        EXPECT_TRUE(seen.insert(key).second) << key;
                        EXPECT_EQ(actionOf(key, taker, scope), binding.action) << key;
                    }
                }
            }
        }
    }
}

TEST(KeyTableTest, EveryKeyOfTheHelpIsBound)
{
    for (const KeyScope scope : Scopes) {
        for (const KeyLine& line : keyTable(scope)) {
            for (const std::string_view key : keysIn(line.keys)) {
                EXPECT_TRUE(key == "..." || actionOf(key, KeyTaker::Terminal, scope)) << key;
            }
        }
    }
}

TEST(KeyTableTest, EveryActionOfALineHasAKeyThatTheHelpShows)
{
    for (const KeyScope scope : Scopes) {
        for (const KeyLine& line : keyTable(scope)) {
            const auto shown = keysIn(line.keys);
            for (const KeyBinding& binding : line.bindings) {
                const auto keys = keysIn(binding.terminal);
                EXPECT_TRUE(keys.empty() || std::ranges::find_first_of(keys, shown) != keys.end()) << binding.terminal;
            }
        }
    }
}

TEST(KeyTableTest, UnboundKeysDoNothing)
{
    EXPECT_EQ(actionOf("x", KeyTaker::Terminal, KeyScope::Browsing), std::nullopt);
    EXPECT_EQ(actionOf("", KeyTaker::Terminal, KeyScope::Browsing), std::nullopt);
    EXPECT_EQ(actionOf(".", KeyTaker::Terminal, KeyScope::Browsing), std::nullopt) << "a recording's key";
    EXPECT_EQ(actionOf("q", KeyTaker::Window, KeyScope::Browsing), std::nullopt) << "the terminal's key";
}

TEST(KeyTableTest, TheWindowKnowsTheKeysOfAnAction)
{
    EXPECT_THAT(windowKeys(KeyAction::FindNext), testing::ElementsAre("F3", "Ctrl+G"));
    EXPECT_THAT(windowKeys(KeyAction::Redraw), testing::IsEmpty());
}

TEST(KeyTableTest, TheDocumentListsTheTable)
{
    std::vector<std::string> wanted;
    for (const KeyScope scope : Scopes) {
        for (const KeyLine& line : keyTable(scope))
            wanted.push_back(row(line));
    }
    std::vector<std::string> listed;
    std::ifstream document(sourcePath("docs/screens.md"));
    for (std::string line; std::getline(document, line);) {
        if (line.starts_with("| `"))
            listed.push_back(line);
    }
    EXPECT_EQ(listed, wanted);
}

} // namespace
} // namespace spectrel
