#include "Tests/Telephony/Simulator/BasebandFixture.h"

namespace spectrel {
namespace {

using namespace std::chrono_literals;

constexpr std::uint32_t ConnectedMode = 0xB179;
constexpr std::uint32_t ServingMeasurement = 0xB17F;

class LTEBasebandTest : public BasebandFixture {
protected:
    LTEBasebandTest()
        : BasebandFixture(Technology::LTE)
    {
    }
};

TEST_F(LTEBasebandTest, EveryCodeOfTheCatalogueComesAndNoOther)
{
    drive(5min);
    for (const std::uint32_t code : {0xB0C1, 0xB0C2, 0xB179, 0xB17F, 0xB180, 0xB186, 0xFF0000, 0xFF0001, 0xFF0002})
        EXPECT_GT(count(code), 0u) << std::hex << code;
    EXPECT_EQ(records.size(), 9u);
}

TEST_F(LTEBasebandTest, PhoneMeasuresForIdleModeOrForItsConnectionNeverForBoth)
{
    start(Scene::Stress, 1); // every record at every step
    int idle = 0;
    int connected = 0;
    for (int step = 0; step < 3000; ++step) {
        records.clear();
        drive(Baseband::Step);
        EXPECT_EQ(count(ConnectedMode) + count(ServingMeasurement), 1u);
        EXPECT_EQ(count(0xB186), count(ServingMeasurement));
        connected += static_cast<int>(count(ConnectedMode));
        idle += static_cast<int>(count(ServingMeasurement));
    }
    EXPECT_GT(idle, 300);
    EXPECT_GT(connected, 300);
}

} // namespace
} // namespace spectrel
