#include "Monitor/Viewing/OfflineSession.h"

#include "Tests/Fakes/FakeResources.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Tests/Fakes/RecordBuilder.h"
#include "Tests/Fakes/ScratchFolder.h"
#include "Values/PropertyList/PropertyList.h"

#include <cstdlib>
#include <filesystem>
#include <gtest/gtest.h>
#include <initializer_list>
#include <utility>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

class OfflineSessionTest : public testing::Test {
protected:
    OfflineSessionTest()
    {
        resources.lists["LTE"] = Dictionary::make({{"Serving Cell Info", Dictionary::make()}});
        session.useTechnology(Technology::LTE);
    }
    void applyAt(std::chrono::milliseconds offset)
    {
        session.apply({Start + offset, record});
    }
    /// How many messages each history entry of the saved snapshot holds, and when it was made.
    std::string history()
    {
        const Outcome saved = session.saveSnapshot(folder);
        EXPECT_TRUE(saved) << (saved ? "" : saved.failure().text);
        std::string text;
        for (const auto& file : std::filesystem::directory_iterator(folder)) {
            const auto snapshot = readPropertyListFile(file.path().string());
            for (const Value& entry : (*snapshot->dictionary())["Data"].list()->elements()) {
                const Dictionary& fields = *entry.dictionary();
                if (const auto& raw = fields["DisplayState"].data())
                    text += std::to_string(raw->size() / record.size()) + "@" + fields["Date"].string()->substr(17, 2)
                        + " ";
            }
        }
        return text;
    }

    static constexpr Moment Start {std::chrono::seconds(1'700'000'000 - 1'700'000'000 % 60)};
    const Bytes record = RecordBuilder(0xB0C2, 38).bytes();
    LogRecorder log;
    FakeResources resources;
    const ScratchFolder scratch;
    const std::string folder = scratch.path().string();
    OfflineSession session {
        &LogGenerator::generatorFromTechnology, true, {.resources = resources, .log = log, .console = log}};
};

TEST_F(OfflineSessionTest, MessageAtTheVeryTimeOfATickComesBeforeIt)
{
    for (const auto offset : {0ms, 1999ms, 2000ms, 2001ms})
        applyAt(offset);
    EXPECT_EQ(history(), "3@02 1@02 ");
}

TEST_F(OfflineSessionTest, IdleTicksAddNothing)
{
    applyAt(0ms);
    applyAt(30s);
    EXPECT_EQ(history(), "1@02 1@30 ");
}

TEST_F(OfflineSessionTest, FirstMessageIsRefreshedAtTheFirstTickAfterIt)
{
    applyAt(0ms);
    applyAt(2001ms);
    applyAt(5s);
    EXPECT_EQ(history(), "1@02 1@04 1@05 ");
}

TEST_F(OfflineSessionTest, TimeThatRunsBackwardsStandsStill)
{
    applyAt(3s);
    applyAt(0ms);
    EXPECT_EQ(history(), "2@03 ");
}

TEST_F(OfflineSessionTest, RecordingOfAnotherTechnologyReplacesTheDisplayAndKeepsTheHistory)
{
    applyAt(0ms);
    resources.lists["ZPH_GSM"] = Dictionary::make({{"SIM Info", Dictionary::make()}});
    session.useTechnology(Technology::GSM);
    EXPECT_TRUE(session.display().isAbsent());
    applyAt(1s);
    EXPECT_EQ(history(), "1@00 1@01 ");
}

TEST_F(OfflineSessionTest, NothingToSaveIsSaid)
{
    const Outcome saved = session.saveSnapshot(folder);
    ASSERT_FALSE(saved);
    EXPECT_EQ(saved.failure().text, "there is no message to save");
}

/// Hears the ticks of a session that keeps no history, as seconds after its start.
class OfflineTicksTest : public OfflineSessionTest {
protected:
    OfflineTicksTest()
    {
        decoding.setTickHandler([this](Moment tick) {
            ticks += std::to_string(std::chrono::duration_cast<std::chrono::seconds>(tick - Start).count()) + " ";
        });
    }
    std::string ticksUpTo(std::initializer_list<std::chrono::milliseconds> offsets)
    {
        for (const auto offset : offsets)
            decoding.apply({Start + offset, record});
        return std::exchange(ticks, {});
    }

    std::string ticks;
    OfflineSession decoding {
        &LogGenerator::generatorFromTechnology, false, {.resources = resources, .log = log, .console = log}};
};

TEST_F(OfflineTicksTest, TicksFallEveryTwoSecondsWhetherMessagesComeOrNot)
{
    EXPECT_EQ(ticksUpTo({0s, 1s}), "");
    EXPECT_EQ(ticksUpTo({2000ms}), ""); // a message at the very time of a tick comes before it
    EXPECT_EQ(ticksUpTo({2001ms}), "2 ");
    EXPECT_EQ(ticksUpTo({9s}), "4 6 8 ");
    EXPECT_EQ(decoding.lastTime(), Start + 9s);
}

TEST_F(OfflineTicksTest, LongPauseEndsTheTicksUntilTheNextMessage)
{
    ticksUpTo({0s});
    const std::string pause = ticksUpTo({24h * 365 + 1s});
    EXPECT_TRUE(pause.starts_with("2 4 ")) << pause;
    EXPECT_TRUE(pause.ends_with(" 598 600 ")) << pause;
    EXPECT_EQ(ticksUpTo({24h * 365 + 3s}), "31536002 ");
}

} // namespace
} // namespace spectrel
