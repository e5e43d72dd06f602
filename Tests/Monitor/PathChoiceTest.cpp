#include "Monitor/PathChoice.h"

#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace spectrel {
namespace {

using Names = std::vector<std::string>;

bool takes(const PathChoice& choice, const Names& names)
{
    PathChoice::Position position = choice.root();
    for (const std::string& name : names)
        position = choice.below(position, name);
    return choice.takesLeaf(position);
}

bool takes(const std::string& glob, const Names& names)
{
    return takes(PathChoice({glob}), names);
}

TEST(PathChoiceTest, WithoutAGlobEveryLeafIsTaken)
{
    EXPECT_TRUE(takes(PathChoice(), {"A", "B"}));
    EXPECT_TRUE(PathChoice(std::vector<std::string>()).takesAll());
    EXPECT_FALSE(PathChoice({"/A"}).takesAll());
}

TEST(PathChoiceTest, PathItselfTakesItsLeafOnly)
{
    EXPECT_TRUE(takes("/SIM Info/EF-ICCID", {"SIM Info", "EF-ICCID"}));
    EXPECT_TRUE(takes("SIM Info/EF-ICCID", {"SIM Info", "EF-ICCID"}));
    EXPECT_FALSE(takes("/SIM Info/EF-ICCID", {"SIM Info", "EF-ICCID2"}));
    EXPECT_FALSE(takes("/SIM Info/EF-ICCID", {"SIM Info"}));
    EXPECT_FALSE(takes("/SIM Info", {"SIM Info", "EF-ICCID"}));
    EXPECT_FALSE(takes("/EF-ICCID", {"SIM Info", "EF-ICCID"}));
}

TEST(PathChoiceTest, OneStarStaysWithinAName)
{
    EXPECT_TRUE(takes("/SIM*/EF-*", {"SIM Info", "EF-ICCID"}));
    EXPECT_TRUE(takes("/A/*", {"A", "B"}));
    EXPECT_FALSE(takes("/A/*", {"A", "B", "C"}));
    EXPECT_FALSE(takes("/A/*", {"A"}));
    EXPECT_FALSE(takes("*", {"A", "B"}));
    EXPECT_TRUE(takes("*", {"A"}));
    EXPECT_TRUE(takes("/*a*b*", {"xaxbx"}));
    EXPECT_FALSE(takes("/*a*b*", {"xbxax"}));
}

TEST(PathChoiceTest, TwoStarsGoAcrossNames)
{
    EXPECT_TRUE(takes("/A/**", {"A", "B"}));
    EXPECT_TRUE(takes("/A/**", {"A", "B", "C"}));
    EXPECT_FALSE(takes("/A/**", {"A"}));
    EXPECT_FALSE(takes("/A/**", {"AB", "C"}));
    EXPECT_TRUE(takes("**", {"A", "B", "C"}));
    EXPECT_TRUE(takes("**/RSRP", {"A", "B", "RSRP"}));
    EXPECT_TRUE(takes("**/RSRP", {"RSRP"}));
    EXPECT_FALSE(takes("**/RSRP", {"A", "NRSRP"}));
    EXPECT_TRUE(takes("**RSRP", {"A", "NRSRP"}));
}

TEST(PathChoiceTest, TwoStarsBetweenSlashesMayBeNoName)
{
    EXPECT_TRUE(takes("/A/**/D", {"A", "D"}));
    EXPECT_TRUE(takes("/A/**/D", {"A", "B", "D"}));
    EXPECT_TRUE(takes("/A/**/D", {"A", "B", "C", "D"}));
    EXPECT_FALSE(takes("/A/**/D", {"A", "BD"}));
    EXPECT_FALSE(takes("/A/**/D", {"AD"}));
    EXPECT_TRUE(takes("/**/D", {"D"}));
    EXPECT_FALSE(takes("/**/D", {"BD"}));
}

TEST(PathChoiceTest, SlashWithinANameIsOfTheName)
{
    EXPECT_TRUE(takes("/Finger/Ec/Io", {"Finger", "Ec/Io"}));
    EXPECT_TRUE(takes("/Finger/*", {"Finger", "Ec/Io"}));
    EXPECT_TRUE(takes("/Finger/*Io", {"Finger", "Ec/Io"}));
    EXPECT_FALSE(takes("/Finger/*/*/*", {"Finger", "Ec/Io"}));
}

TEST(PathChoiceTest, NamesJoinAsInPaths)
{
    EXPECT_TRUE(takes("/A/B", {"A", "", "/B"}));
    EXPECT_TRUE(takes("/A/B", {"/A", "//B"}));
}

TEST(PathChoiceTest, AnyOfSeveralGlobsIsEnough)
{
    const PathChoice choice({"/A/*", "/B"});
    EXPECT_TRUE(takes(choice, {"A", "1"}));
    EXPECT_TRUE(takes(choice, {"B"}));
    EXPECT_FALSE(takes(choice, {"C"}));
}

TEST(PathChoiceTest, BranchThatLeadsNowhereIsSeenAtItsBeginning)
{
    const PathChoice choice({"/A/B*"});
    const auto at = [&](const Names& names) {
        PathChoice::Position position = choice.root();
        for (const std::string& name : names)
            position = choice.below(position, name);
        return choice.reaches(position);
    };
    EXPECT_TRUE(at({"A"}));
    EXPECT_FALSE(at({"B"}));
    EXPECT_FALSE(at({"AA"}));
    EXPECT_TRUE(at({"A", "BC"}));
    EXPECT_FALSE(at({"A", "CB"}));
}

TEST(PathChoiceTest, GlobOfManyStarsIsMatchedInItsStride)
{
    std::string glob;
    for (int star = 0; star < 200; ++star)
        glob += "*a";
    EXPECT_FALSE(takes(glob, {std::string(199, 'a') + "b"})); // trying each way would never end
    EXPECT_TRUE(takes(glob, {std::string(200, 'a')}));
}

} // namespace
} // namespace spectrel
