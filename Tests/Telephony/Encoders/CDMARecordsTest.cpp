#include "Telephony/Encoders/CDMARecords.h"

#include "LogGenerator/CDMA/C2KLogGenerator.h"
#include "Telephony/Simulator/Baseband.h"
#include "Telephony/Simulator/CDMA/CDMAWorld.h"
#include "Telephony/Simulator/SimulatedRecording.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/FakeResources.h"
#include "Tests/Fakes/LogRecorder.h"

#include <cmath>
#include <cstdio>
#include <functional>
#include <gtest/gtest.h>
#include <map>

namespace spectrel {
namespace {

using namespace std::chrono_literals;
using Activity = CDMAWorld::Activity;

constexpr Moment Time = SimulatedRecordingStart;
constexpr int FiveMinutes = 3000; // steps

class CDMARecordsTest : public testing::Test {
protected:
    CDMARecordsTest()
    {
        auto layout = Dictionary::make();
        for (const char* variable : {"kChannel", "k1xEVDODeviceState", "kBandClass", "kRxAGC0", "kRxAGC1", "kTxAGC",
                 "kServingPNOffset", "kSessionState", "kUATI24", "kColorCode", "kActiveSetPilots", "kFingerC2I",
                 "k1xDeviceState", "k1xRx0BandClass", "k1xRx0ChanNum", "k1xRxAGC0", "k1xRx1BandClass", "k1xRx1ChanNum",
                 "k1xRxAGC1", "k1xTxAGC", "k1xActiveSetInfo", "k1xTrafficFER", "kFLDataRate", "kRLDataRate",
                 "k1xRoamingHome", "kSystemId", "kNetworkId", "kPacketZoneId", "kBaseId", "kProtocolRevision"})
            layout->set(variable, variable);
        resources.lists["C2KTemplate"] = layout;
        generator.getDisplayFromState(state);
        log.takeLog();
    }

    void deliver(const Bytes& record)
    {
        generator.updateState(state, record);
    }
    const Value& value(std::string_view variable)
    {
        return (*state[StateKey::Display].dictionary())[variable];
    }
    std::string text(std::string_view variable)
    {
        const std::string* shown = value(variable).string();
        return shown ? *shown : "no text";
    }
    double number(std::string_view variable)
    {
        return std::strtod(text(variable).c_str(), nullptr);
    }
    /// PN and text of each pilot in the list, by key.
    std::vector<std::pair<int, std::string>> pilots(std::string_view variable)
    {
        std::vector<std::pair<int, std::string>> list;
        if (const auto& dictionary = value(variable).dictionary()) {
            for (const auto& [key, strength] : dictionary->entries()) {
                if (key != "_sorted")
                    list.emplace_back(std::atoi(key.c_str() + key.find(';') + 1), *strength.string());
            }
        }
        return list;
    }
    /// Calls `look` after every so many steps of a drive.
    void drive(int every, const std::function<void(const CDMAWorld& world)>& look)
    {
        CDMAWorld world(Scene::Drive, 11);
        for (int step = 1; step <= FiveMinutes; ++step) {
            world.advance(100ms);
            if (step % every == 0)
                look(world);
        }
        EXPECT_EQ(log.takeLog(), "") << "no record is refused";
    }

    LogRecorder log;
    FakeResources resources;
    Dictionary state;
    C2KLogGenerator generator {{.resources = resources, .log = log, .console = log}};
};

std::string decimals(double number)
{
    char characters[64];
    std::snprintf(characters, sizeof characters, "%.2f", number);
    return characters;
}

TEST_F(CDMARecordsTest, LengthsAreThoseOfTheRecords)
{
    CDMAWorld world(Scene::Drive, 1);
    EXPECT_EQ(cdmaSystemInformationRecord(world.report(), Time).size(), 186u);
    EXPECT_EQ(evdoAirLinkRecord(world.report(), Time).size(), 50u);
    EXPECT_EQ(evdoForwardCountersRecord(world.report(), Time).size(), 241u);
    EXPECT_EQ(evdoReverseCountersRecord(world.report(), Time).size(), 1750u);
    EXPECT_EQ(evdoFingersRecord(world.report(), Time).size(), 23u + 4 * 14);
    EXPECT_EQ(evdoPilotsRecord(world.report(), Time).size(), 25u + 12);
}

TEST_F(CDMARecordsTest, SubpacketsFollowEachOtherUpToTheRecordsEnd)
{
    drive(50, [](const CDMAWorld& world) {
        const Bytes record = cdmaSearcherRecord(world.report(), Time);
        EXPECT_EQ(record[14], 4);
        std::size_t place = 17;
        for (std::uint8_t id = 1; id <= 4; ++id) {
            ASSERT_LT(place + 3, record.size());
            EXPECT_EQ(record[place], id);
            place += record[place + 2] | record[place + 3] << 8;
        }
        EXPECT_EQ(place, record.size());
    });
}

TEST_F(CDMARecordsTest, AirLinkIsShownAsItIs)
{
    drive(10, [this](const CDMAWorld& world) {
        deliver(evdoAirLinkRecord(world.report(), Time));
        EXPECT_EQ(text("kChannel"), "325");
        EXPECT_EQ(text("kBandClass"), "1.8 to 2.0GHz PCS band [1]");
        EXPECT_NEAR(number("kRxAGC0"), world.received(), 0.51);
        EXPECT_EQ(text("kSessionState"), "Open [4]");
        EXPECT_EQ(text("kUATI24"), "0x0a4c17");
        const std::map<Activity, std::string> states {{Activity::Voice, "Inactive [0]"}, {Activity::Idle, "Idle [3]"},
            {Activity::DataSetup, "Access [4]"}, {Activity::Data, "Connected [5]"}};
        EXPECT_EQ(text("k1xEVDODeviceState"), states.at(world.activity()));
        EXPECT_EQ(text("kServingPNOffset"),
            world.activity() == Activity::Voice ? "Invalid Value"
                                                : std::to_string(world.serving().pn) + " \u00D7 64chips");
        if (world.activity() == Activity::Data) {
            EXPECT_NEAR(number("kTxAGC"), world.transmitted(), 0.51);
            EXPECT_NEAR(number("kRxAGC1"), world.receivedBySecond(), 0.51);
        } else if (world.activity() != Activity::DataSetup) {
            EXPECT_EQ(text("kTxAGC"), "N/A");
        }
    });
}

TEST_F(CDMARecordsTest, SearcherIsShownAsItIs)
{
    drive(10, [this](const CDMAWorld& world) {
        deliver(cdmaSearcherRecord(world.report(), Time));
        EXPECT_EQ(text("k1xRx0ChanNum"), "425");
        EXPECT_NEAR(number("k1xRxAGC0"), world.received(), 0.18);
        if (world.activity() == Activity::Voice) {
            EXPECT_EQ(text("k1xDeviceState"), "Traffic [8]");
            EXPECT_NEAR(number("k1xRxAGC1"), world.receivedBySecond(), 0.18);
            EXPECT_NEAR(number("k1xTxAGC"), world.transmitted(), 0.06);
        } else {
            EXPECT_EQ(text("k1xDeviceState"), world.isAwake() ? "Paging [6]" : "Slotted mode sleep state [7]");
            EXPECT_EQ(text("k1xTxAGC"), "N/A");
        }
        const auto shown = pilots("k1xActiveSetInfo");
        const auto heard = world.activePilots();
        ASSERT_EQ(shown.size(), heard.size());
        for (std::size_t index = 0; index < heard.size(); ++index) {
            EXPECT_EQ(shown[index].first, heard[index].pn);
            constexpr std::string_view Mark = "(ref pilot) ";
            EXPECT_EQ(shown[index].second.starts_with(Mark), index == 0);
            const double strength = std::strtod(shown[index].second.c_str() + (index == 0 ? Mark.size() : 0), nullptr);
            EXPECT_NEAR(strength, 10 * std::log10(0.2 * heard[index].share), 0.05);
        }
    });
}

TEST_F(CDMARecordsTest, PilotsAndFingersAreShownAsTheyAre)
{
    drive(10, [this](const CDMAWorld& world) {
        deliver(evdoPilotsRecord(world.report(), Time));
        deliver(evdoFingersRecord(world.report(), Time));
        if (world.activity() == Activity::Voice) {
            EXPECT_EQ(text("kActiveSetPilots"), "(none)");
            EXPECT_EQ(text("kFingerC2I"), "(none)");
            return;
        }
        const auto shown = pilots("kActiveSetPilots");
        const auto heard = world.activePilots();
        ASSERT_EQ(shown.size(), heard.size());
        for (std::size_t index = 0; index < heard.size(); ++index) {
            EXPECT_EQ(shown[index].first, heard[index].pn);
            EXPECT_NEAR(512 * std::pow(10, std::stod(shown[index].second) / 10), 512 * heard[index].share, 1.1);
        }
        const auto fingers = pilots("kFingerC2I");
        ASSERT_EQ(fingers.size(), std::min<std::size_t>(heard.size() + 1, 4));
        EXPECT_EQ(fingers[0].first, world.serving().pn);
        EXPECT_EQ(fingers[1].first, world.serving().pn);
        EXPECT_NEAR(std::stod(fingers[0].second), 10 * std::log10(0.8 * world.servingSignal()), 0.05);
    });
}

TEST_F(CDMARecordsTest, CountersAddUpToTheShownRates)
{
    std::uint64_t forwardBefore = 0;
    std::uint64_t reverseBefore = 0;
    std::uint32_t secondBefore = 0;
    int rates = 0;
    drive(20, [&](const CDMAWorld& world) {
        if (world.activity() == Activity::Voice)
            return;
        deliver(evdoForwardCountersRecord(world.report(), Time));
        deliver(evdoReverseCountersRecord(world.report(), Time));
        const EVDOCounts& counts = world.countsAtSecond();
        if (secondBefore != 0) {
            const double span = 1024.0 * (world.second() - secondBefore);
            EXPECT_EQ(text("kFLDataRate"),
                decimals(static_cast<double>(counts.forwardBits - forwardBefore) / span) + " kbps");
            EXPECT_EQ(text("kRLDataRate"),
                decimals(static_cast<double>(counts.reverseBits - reverseBefore) / span) + " kbps");
            ++rates;
        }
        secondBefore = world.second();
        forwardBefore = counts.forwardBits;
        reverseBefore = counts.reverseBits;
    });
    EXPECT_GT(rates, 90);
}

TEST_F(CDMARecordsTest, FramesAddUpToTheShownRate)
{
    float rate = 0;
    drive(1, [&](const CDMAWorld& world) {
        if (world.activity() != Activity::Voice)
            return;
        deliver(cdmaFrameRecord(world.report(), Time));
        rate = (world.isFrameBad() ? 1.0F / 64 : 0) + 63.0F / 64 * rate;
        ASSERT_EQ(text("k1xTrafficFER"), decimals(100.0 * rate) + "%");
    });
    EXPECT_GT(rate, 0);
}

TEST_F(CDMARecordsTest, SystemInformationIsThatOfTheServingSector)
{
    drive(50, [&](const CDMAWorld& world) {
        deliver(cdmaSystemInformationRecord(world.report(), Time));
        EXPECT_EQ(text("kSystemId"), std::to_string(world.serving().systemId));
        EXPECT_EQ(text("kNetworkId"), std::to_string(world.serving().networkId));
        EXPECT_EQ(text("kBaseId"), std::to_string(world.serving().baseId));
        EXPECT_EQ(text("kPacketZoneId"), std::to_string(world.serving().packetZone));
        EXPECT_EQ(text("kProtocolRevision"), "6");
        EXPECT_EQ(text("k1xRoamingHome"), world.serving().isHome ? "OFF [0]" : "Alliance partner [7]");
    });
}

TEST_F(CDMARecordsTest, OneCarrierCountsNothingWhileTheOtherHasTheRadio)
{
    drive(10, [](const CDMAWorld& world) {
        const bool isTalking = world.activity() == Activity::Voice;
        EXPECT_NE(cdmaFrameRecord(world.report(), Time).empty(), isTalking);
        for (auto* record : {evdoForwardCountersRecord, evdoReverseCountersRecord})
            EXPECT_EQ(record(world.report(), Time).empty(), isTalking);
    });
}

TEST_F(CDMARecordsTest, WholeDriveFillsEveryVariable)
{
    for (const Scene scene : {Scene::Still, Scene::Walk, Scene::Drive, Scene::Stress}) {
        const auto baseband = makeBaseband(Technology::CDMA, scene, 1);
        const auto receive = [this](ByteView record) { generator.updateState(state, record); };
        baseband->greet(Time, receive);
        for (int step = 1; step <= 1200; ++step)
            baseband->advance(Time + step * 100ms, receive);
        for (const auto& [variable, shown] : state[StateKey::Display].dictionary()->entries())
            EXPECT_NE(displayText(shown), "\"\"") << variable;
        EXPECT_EQ(log.takeLog(), "");
    }
}

} // namespace
} // namespace spectrel
