#include "Sections/LTE/LTEClassIndex.h"

#include "Tests/Fakes/LogRecorder.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(LTEClassIndexTest, CodesAreRegisteredInCreationOrder)
{
    const LTEClassIndex index;
    EXPECT_EQ(index.getAllLogCodes(),
        (std::vector<std::string> {
            "45250", "45249", "16711681", "45433", "45439", "45440", "45446", "16711680", "16711682"}));
}

TEST(LTEClassIndexTest, EverySectionIsFoundUnderItsName)
{
    const LTEClassIndex index;
    for (const char* name :
        {"Serving Cell Info", "Connected mode LTE Intra-frequency Measurement", "Measured Neighbor Cells",
            "Detected Cells", "Serving Cell Measurements", "Neighbor Measurements", "Neighbor Cells List",
            "Reselection Candidates", "Reselection Candidates List", "SIM Info", "PDP Context Info"}) {
        ASSERT_NE(index.getClass(name), nullptr) << name;
        EXPECT_EQ(index.getClass(name)->getSectionName(), name);
    }
}

TEST(LTEClassIndexTest, SharedCodesAreDeliveredInCreationOrder)
{
    const LTEClassIndex index;
    const std::pair<std::uint32_t, std::vector<std::string_view>> deliveries[] {
        {0xB179, {"Connected mode LTE Intra-frequency Measurement", "Measured Neighbor Cells", "Detected Cells"}},
        {0xB180, {"Neighbor Measurements", "Neighbor Cells List"}},
        {0xB186, {"Reselection Candidates", "Reselection Candidates List"}},
        {0xB17F, {"Serving Cell Measurements"}},
    };
    for (const auto& [code, names] : deliveries) {
        std::vector<std::string_view> subscribed;
        for (const Base* section : *index.getSubscribers(code))
            subscribed.push_back(section->getSectionName());
        EXPECT_EQ(subscribed, names) << code;
    }
}

TEST(LTEClassIndexTest, HSDPAIsNotItsOwn)
{
    const LTEClassIndex index;
    EXPECT_EQ(index.getSubscribers(0x4221), nullptr);
    EXPECT_EQ(index.getClass("HSDPA Info"), nullptr);
}

TEST(LTEClassIndexTest, ReleasingItPrintsItsLineOnce)
{
    LogRecorder log;
    {
        const LTEClassIndex index(log.context());
    }
    EXPECT_EQ(log.takeConsole(), "Deallocing LTEClassIndex\nDeallocing ClassIndex\n");
}

} // namespace
} // namespace spectrel
