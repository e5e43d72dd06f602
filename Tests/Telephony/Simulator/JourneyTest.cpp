#include "Telephony/Simulator/Journey.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>
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
    const std::pair<const char*, Scene> names[] = {
        {"still", Scene::Still}, {"walk", Scene::Walk}, {"drive", Scene::Drive}, {"stress", Scene::Stress}};
    for (const auto& [name, expected] : names) {
        Scene scene = expected == Scene::Still ? Scene::Walk : Scene::Still;
        EXPECT_TRUE(sceneNamed(name, scene)) << name;
        EXPECT_EQ(scene, expected) << name;
    }
    Scene scene = Scene::Walk;
    EXPECT_FALSE(sceneNamed("fly", scene));
    EXPECT_EQ(scene, Scene::Walk);
}

TEST(JourneyTest, PingPongStaysAroundItsPlace)
{
    Dice dice(3);
    Journey journey(Scene::PingPong, RingLength, dice);
    journey.stayAround(30, 100); // across the ring's seam
    double furthestAhead = 0;
    double furthestBehind = 0;
    for (int step = 0; step < 5000; ++step) {
        journey.advance(100ms, dice);
        furthestAhead = std::max(furthestAhead, journey.ahead(30));
        furthestBehind = std::min(furthestBehind, journey.ahead(30));
    }
    EXPECT_NEAR(furthestAhead, 100, 3);
    EXPECT_NEAR(furthestBehind, -100, 3);
}

TEST(JourneyTest, TunnelsTakeEverySignalForAWhile)
{
    Dice dice(4);
    Journey inTunnels(Scene::Tunnel, RingLength, dice);
    Journey outside(Scene::Drive, RingLength, dice);
    int inside = 0;
    for (int step = 0; step < 6000; ++step) {
        inTunnels.advance(100ms, dice);
        outside.advance(100ms, dice);
        inside += inTunnels.tunnelLoss() > 90;
        EXPECT_EQ(outside.tunnelLoss(), 0);
    }
    EXPECT_GT(inside, 600);
    EXPECT_LT(inside, 2400);
}

TEST(JourneyTest, PhonesOfOneJourneyStayTogetherWhateverElseTheirDiceDecide)
{
    Dice one(5);
    Dice other(5);
    Journey first(Scene::Journey, Journey::SharedLength, one);
    Journey second(Scene::Journey, Journey::SharedLength, other);
    for (int step = 0; step < 1000; ++step) {
        other.number();
        first.advance(100ms, one);
        second.advance(100ms, other);
        ASSERT_EQ(first.ahead(0), second.ahead(0));
    }
}

} // namespace
} // namespace spectrel
