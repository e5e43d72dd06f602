#include "Sections/LTE/LTEClassIndex.h"

#include "Tests/Fakes/LogRecorder.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(LTEClassIndexTest, CodesAreRegisteredInCreationOrder)
{
    const LTEClassIndex index;
    EXPECT_EQ(
        index.getAllLogCodes(), (std::vector<std::string> {"45250", "45249", "16711681", "16711680", "16711682"}));
}

TEST(LTEClassIndexTest, EverySectionIsFoundUnderItsName)
{
    const LTEClassIndex index;
    for (const char* name : {"Serving Cell Info", "SIM Info", "PDP Context Info"}) {
        ASSERT_NE(index.getClass(name), nullptr) << name;
        EXPECT_EQ(index.getClass(name)->getSectionName(), name);
    }
}

TEST(LTEClassIndexTest, ReleasingItPrintsItsLineOnce)
{
    LogRecorder log;
    {
        const LTEClassIndex index;
    }
    EXPECT_EQ(log.takeConsole(), "Deallocing LTEClassIndex\nDeallocing ClassIndex\n");
}

} // namespace
} // namespace spectrel
