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
    const Context context {time, resources, log, log};
    Dictionary state;

    std::string displayOf(UTRANLogGenerator& generator)
    {
        generator.updateState(state, RecordBuilder(1, 13));
        return displayText(generator.getDisplayFromState(state));
    }
};

TEST_F(UTRANLogGeneratorTest, WithoutATemplateTheStartCommandHasTwoEmptyLists)
{
    resources.lists["LTE"] = Dictionary::make();
    const auto generator = UTRANLogGenerator::generator(context);
    EXPECT_EQ(displayText(generator->getStartCommand()),
        "{\"SetState\": \"Streaming\", \"SetZephyrLogCodes\": [], \"SetRkExtraCodes\": []}");
    EXPECT_EQ(log.takeLog(), "");
}

TEST_F(UTRANLogGeneratorTest, WithoutATemplateItAnswersEveryOperation)
{
    const auto generator = UTRANLogGenerator::generator(context);
    generator->updateState(state, RecordBuilder(0xB0C2, 40));
    EXPECT_TRUE(generator->generateLogUsingState(state).isAbsent());
    EXPECT_EQ(generator->getSaveContentsFromState(state)->count(), 2u);
    EXPECT_FALSE(state.contains(StateKey::Display));
}

TEST_F(UTRANLogGeneratorTest, FirstPathWithUTRANInAnyCaseIsTheTemplate)
{
    resources.lists["LTE"] = Dictionary::make();
    resources.lists["My_utran2"] = Dictionary::make({{"Chosen", "yes"}});
    const auto generator = UTRANLogGenerator::generator(context);
    EXPECT_NE(log.takeLogWith("<3>Created UTRANLogGenerator object\n"), "");
    EXPECT_EQ(displayOf(*generator), "{\"Chosen\": \"yes\"}");
}

TEST_F(UTRANLogGeneratorTest, FirstOfSeveralInTheListedOrderIsTheTemplate)
{
    resources.lists["B.utran.1"] = Dictionary::make({{"Chosen", "first"}});
    resources.lists["UTRAN"] = Dictionary::make({{"Chosen", "second"}});
    EXPECT_EQ(displayOf(*UTRANLogGenerator::generator(context)), "{\"Chosen\": \"first\"}");
}

TEST_F(UTRANLogGeneratorTest, UTRANAnywhereInThePathCounts)
{
    resources.lists["LTE"] = Dictionary::make({{"Chosen", "no"}});
    resources.lists["Of utran/LTE"] = Dictionary::make();
    EXPECT_EQ(displayOf(*UTRANLogGenerator::generator(context)), "{\"Chosen\": \"no\"}")
        << "the name alone tells the resource";
}

TEST_F(UTRANLogGeneratorTest, LogTellsItOnceItIsThere)
{
    resources.lists["UTRAN"] = Dictionary::make();
    {
        const auto generator = UTRANLogGenerator::generator(context);
        const std::string lines = log.takeLog();
        const auto initialised = lines.find("<3>Class Index: 1\n");
        ASSERT_NE(initialised, std::string::npos) << lines;
        EXPECT_EQ(lines.substr(initialised), "<3>Class Index: 1\n<3>Created UTRANLogGenerator object\n");
    }
    const std::string ending = log.takeLog();
    EXPECT_EQ(ending.find("<4>ZPH_GSMLogGenerator is destructed 0x"), 0u) << ending;
    EXPECT_EQ(ending.find('\n'), ending.size() - 1) << "it has no line of its own";
}

} // namespace
} // namespace spectrel
