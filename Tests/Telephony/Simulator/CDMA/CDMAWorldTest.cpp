#include "Telephony/Simulator/CDMA/CDMAWorld.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <set>
#include <string>

namespace spectrel {
namespace {

using namespace std::chrono_literals;
using Activity = CDMAWorld::Activity;

constexpr int FiveMinutes = 3000; // steps

/// Calls `look` after every step of a drive.
template <typename Look> void drive(Scene scene, std::uint32_t seed, int steps, Look look)
{
    CDMAWorld world(scene, seed);
    for (int step = 0; step < steps; ++step) {
        world.advance(100ms);
        look(world);
    }
}

std::string diary(std::uint32_t seed)
{
    std::string text;
    drive(Scene::Drive, seed, 600, [&text](const CDMAWorld& world) {
        text += std::to_string(world.serving().pn) + " " + std::to_string(world.received()) + " "
            + std::to_string(world.countsAtSecond().forwardBits) + "\n";
    });
    return text;
}

TEST(CDMAWorldTest, SameSeedGivesTheSameDrive)
{
    EXPECT_EQ(diary(7), diary(7));
    EXPECT_NE(diary(7), diary(8));
}

TEST(CDMAWorldTest, DrivePassesSeveralSitesAndDoesEverything)
{
    std::set<std::uint16_t> pilots;
    std::set<Activity> activities;
    std::size_t maxActiveSet = 0;
    drive(Scene::Drive, 1, FiveMinutes, [&](const CDMAWorld& world) {
        pilots.insert(world.serving().pn);
        activities.insert(world.activity());
        maxActiveSet = std::max(maxActiveSet, world.activePilots().size());
    });
    EXPECT_GE(pilots.size(), 4u);
    EXPECT_EQ(activities.size(), 4u);
    EXPECT_GE(maxActiveSet, 2u) << "soft handoff";
}

TEST(CDMAWorldTest, StandingStillKeepsTheSite)
{
    std::set<std::uint16_t> pilots;
    drive(Scene::Still, 1, 600, [&](const CDMAWorld& world) { pilots.insert(world.serving().pn); });
    EXPECT_LE(pilots.size(), 2u) << "shadowing alone may move it between two";
}

TEST(CDMAWorldTest, ValuesBelongTogether)
{
    for (const Scene scene : {Scene::Walk, Scene::Drive, Scene::Stress}) {
        drive(scene, 3, FiveMinutes, [](const CDMAWorld& world) {
            const auto pilots = world.activePilots();
            ASSERT_GE(pilots.size(), 1u);
            ASSERT_LE(pilots.size(), 6u);
            EXPECT_EQ(pilots.front().pn, world.serving().pn);
            double shares = 0;
            std::set<std::uint16_t> different;
            for (const CDMAPilot& pilot : pilots) {
                EXPECT_LT(pilot.pn, 512);
                different.insert(pilot.pn);
                shares += pilot.share;
            }
            EXPECT_LT(shares, 1);
            EXPECT_EQ(different.size(), pilots.size());
            EXPECT_GT(world.received(), -105);
            EXPECT_LT(world.received(), -25);
            EXPECT_GE(world.transmitted(), -50);
            EXPECT_LE(world.transmitted(), 23);
        });
    }
}

TEST(CDMAWorldTest, IdlePhoneHearsOnlyItsOwnPilot)
{
    drive(Scene::Drive, 1, FiveMinutes, [](const CDMAWorld& world) {
        if (world.activity() == Activity::Idle) {
            EXPECT_EQ(world.activePilots().size(), 1u);
        }
    });
}

TEST(CDMAWorldTest, CountersMoveOnceASecondAndOnlyWithData)
{
    std::uint32_t second = 0;
    std::uint64_t bits = 0;
    bool wasMovingData = false;
    drive(Scene::Drive, 1, FiveMinutes, [&](const CDMAWorld& world) {
        const bool hasNewCount = world.countsAtSecond().forwardBits != bits;
        if (world.second() == second) {
            EXPECT_FALSE(hasNewCount);
        } else {
            EXPECT_EQ(world.second(), second + 1);
            EXPECT_TRUE(!hasNewCount || wasMovingData || world.activity() == Activity::Data);
        }
        wasMovingData = world.activity() == Activity::Data;
        second = world.second();
        bits = world.countsAtSecond().forwardBits;
    });
    EXPECT_GT(bits, 50'000'000u) << "in two and a half sessions";
}

TEST(CDMAWorldTest, SomeFramesOfACallAreBadAndMostAreGood)
{
    int frames = 0;
    int bad = 0;
    drive(Scene::Drive, 1, FiveMinutes, [&](const CDMAWorld& world) {
        frames += world.activity() == Activity::Voice;
        bad += world.activity() == Activity::Voice && world.isFrameBad();
    });
    EXPECT_GT(bad, 0);
    EXPECT_LT(bad * 20, frames);
}

} // namespace
} // namespace spectrel
