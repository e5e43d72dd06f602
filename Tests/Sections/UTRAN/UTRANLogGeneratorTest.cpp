#include "Sections/UTRAN/UTRANLogGenerator.h"

#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/FakeResources.h"
#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Tests/Fakes/RecordBuilder.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

class UTRANLogGeneratorTest : public testing::Test {
protected:
    FakeRunLoop time;
    LogRecorder log;
    FakeResources resources;
    Dictionary state;
};

TEST_F(UTRANLogGeneratorTest, WithoutATemplateTheStartCommandHasTwoEmptyLists)
{
    resources.lists["LTE"] = Dictionary::make();
    const auto generator = UTRANLogGenerator::generator();
    EXPECT_EQ(displayText(generator->getStartCommand()),
        "{\"SetState\": \"Streaming\", \"SetZephyrLogCodes\": [], \"SetRkExtraCodes\": []}");
    EXPECT_EQ(log.takeLog(), "");
}

TEST_F(UTRANLogGeneratorTest, WithoutATemplateItAnswersEveryOperation)
{
    const auto generator = UTRANLogGenerator::generator();
    generator->updateState(state, RecordBuilder(0xB0C2, 40));
    EXPECT_TRUE(generator->generateLogUsingState(state).isAbsent());
    EXPECT_EQ(generator->getSaveContentsFromState(state)->count(), 2u);
    EXPECT_FALSE(state.contains(StateKey::Display));
}

TEST_F(UTRANLogGeneratorTest, FirstPathWithUTRANInAnyCaseIsTheTemplate)
{
    resources.lists["LTE"] = Dictionary::make();
    resources.lists["My_utran2"] = Dictionary::make({{"Chosen", "yes"}});
    const auto generator = UTRANLogGenerator::generator();
    EXPECT_NE(log.takeLogWith("<3>Created UTRANLogGenerator object\n"), "");
    generator->updateState(state, RecordBuilder(1, 13));
    EXPECT_EQ(displayText(generator->getDisplayFromState(state)), "{\"Chosen\": \"yes\"}");
}

} // namespace
} // namespace spectrel
