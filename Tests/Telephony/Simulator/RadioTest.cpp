#include "Telephony/Simulator/Radio.h"

#include <cmath>
#include <gtest/gtest.h>
#include <string_view>
#include <utility>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

constexpr double RingLength = 6000;

double covered(Scene scene)
{
    Dice dice(1);
    Journey journey(scene, RingLength, dice);
    const double before = journey.distanceTo(0, 0);
    for (int step = 0; step < 100; ++step)
        journey.advance(100ms, dice);
    return std::fabs(journey.distanceTo(0, 0) - before);
}

TEST(JourneyTest, ScenesDifferInPace)
{
    EXPECT_EQ(covered(Scene::Still), 0);
    EXPECT_GT(covered(Scene::Walk), 5);
    EXPECT_LT(covered(Scene::Walk), 25);
    EXPECT_GT(covered(Scene::Drive), 50);
    EXPECT_GT(covered(Scene::Stress), 250);
}

TEST(JourneyTest, RoadIsARing)
{
    Dice dice(2);
    Journey journey(Scene::Stress, RingLength, dice);
    for (int step = 0; step < 5000; ++step) {
        journey.advance(100ms, dice);
        EXPECT_LE(journey.distanceTo(0, 0), RingLength / 2);
    }
}

TEST(JourneyTest, PlacesAreAheadOrBehindByTheShorterWay)
{
    Dice dice(3);
    const Journey journey(Scene::Still, RingLength, dice);
    const double here = std::fmod(RingLength - journey.ahead(0), RingLength);
    EXPECT_NEAR(journey.ahead(here), 0, 1e-9);
    EXPECT_NEAR(journey.ahead(here + 100), 100, 1e-9);
    EXPECT_NEAR(journey.ahead(here + RingLength - 100), -100, 1e-9);
    EXPECT_NEAR(std::fabs(journey.ahead(1234)), journey.distanceTo(1234, 0), 1e-9);
}

TEST(SceneTest, NamesAreThoseOfTheCommandLine)
{
    const std::pair<std::string_view, Scene> names[] {
        {"still", Scene::Still}, {"walk", Scene::Walk}, {"drive", Scene::Drive}, {"stress", Scene::Stress}};
    for (const auto& [name, wanted] : names) {
        Scene scene = wanted == Scene::Still ? Scene::Stress : Scene::Still;
        EXPECT_TRUE(sceneNamed(name, scene)) << name;
        EXPECT_EQ(scene, wanted) << name;
        EXPECT_FALSE(sceneNamed("fly", scene));
        EXPECT_EQ(scene, wanted) << "an unknown name changes nothing";
    }
}

TEST(PathLossTest, FollowsTheUrbanMacroCell)
{
    EXPECT_DOUBLE_EQ(pathLoss(1000), 128.1);
    EXPECT_NEAR(pathLoss(100), 90.5, 1e-9);
    EXPECT_EQ(pathLoss(0), pathLoss(35));
}

} // namespace
} // namespace spectrel
