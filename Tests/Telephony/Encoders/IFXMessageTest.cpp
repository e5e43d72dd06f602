#include "Telephony/Encoders/IFXMessage.h"

#include "LogGenerator/GSM/GSMLogGenerator.h"
#include "Telephony/Simulator/Baseband.h"
#include "Telephony/Simulator/IFX/IFXWorld.h"
#include "Telephony/Simulator/SimulatedRecording.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyList.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

constexpr int FiveMinutes = 3000; // steps

class IFXMessageTest : public testing::Test {
protected:
    const Value& shown(std::initializer_list<std::string_view> path)
    {
        const Value* value = &state[StateKey::Display];
        for (const std::string_view key : path)
            value = &(*value->dictionary())[key];
        return *value;
    }

    LogRecorder log;
    Dictionary state;
    GSMLogGenerator generator {log.context()};
    IFXWorld world {Scene::Drive, 5};
};

TEST_F(IFXMessageTest, MessageIsTheStateAsAPropertyList)
{
    const auto parsed = parsePropertyList(ifxMessage(world.report(), SimulatedRecordingStart));
    ASSERT_TRUE(parsed);
    EXPECT_EQ(displayText(*parsed), displayText(ifxState(world.report())));
}

TEST_F(IFXMessageTest, StateIsShownAsItIs)
{
    log.takeLog();
    for (int step = 1; step <= FiveMinutes; ++step) {
        world.advance(100ms);
        if (step % 20 != 0)
            continue;
        generator.updateState(state, ifxMessage(world.report(), SimulatedRecordingStart));
        EXPECT_EQ(shown({"Serving Cell", "Cell Identity"}), Value(std::to_string(world.serving().identity)));
        EXPECT_EQ(shown({"Serving Cell", "Timing Advance"}), Value(std::to_string(world.timingAdvance())));
        EXPECT_EQ(shown({"SIM"}), Value("Ready")) << "a chain of single entries";
        const auto neighbours = world.neighbours();
        const auto& list = shown({"Neighbour Cells"}).list();
        ASSERT_TRUE(list);
        ASSERT_EQ(list->count(), neighbours.size()) << "without the heading";
        for (std::size_t index = 0; index < neighbours.size(); ++index)
            EXPECT_EQ((*(*list)[index].dictionary())["ARFCN"], Value(std::to_string(neighbours[index].channel)));
        EXPECT_EQ(displayText(shown({"Call"})),
            world.isTalking()
                ? "{\"State\": \"Active\", \"Duration\": \"" + std::to_string(world.talkingFor().count())
                    + "\", \"Channel\": \"TCH/F\", \"Codec\": \"AMR 12.2\"}"
                : "{\"State\": \"No call\", \"Duration\": \"0\", \"Channel\": \"None\", \"Codec\": \"None\"}");
        EXPECT_EQ(shown({"Serving Cell", "Carrier", "Hopping"}).list()->count(), world.isTalking() ? 3u : 0u);
        const auto& contexts = shown({"Packet Data", "Contexts"}).list();
        ASSERT_EQ(contexts->count(), 1u);
        EXPECT_EQ((*(*contexts)[0].dictionary())["Bytes Received"], Value(std::to_string(world.bytesReceived())));
        EXPECT_EQ(displayText((*(*contexts)[0].dictionary())["Quality"]), "[\"Background\", \"4\"]");
    }
    EXPECT_EQ(log.takeLog(), "") << "nothing but texts, dictionaries and lists";
}

TEST_F(IFXMessageTest, BasebandReportsAtOnceAndThenSteadily)
{
    for (const auto& [scene, expected] :
        {std::pair(Scene::Still, 30), {Scene::Walk, 30}, {Scene::Drive, 30}, {Scene::Stress, 600}}) {
        const auto baseband = makeBaseband(Technology::IFX, scene, 1);
        int reports = 0;
        const auto count = [&reports](ByteView report) { reports += parsePropertyList(report).has_value(); };
        baseband->greet(SimulatedRecordingStart, count);
        EXPECT_EQ(reports, 1);
        for (int step = 1; step <= 600; ++step)
            baseband->advance(SimulatedRecordingStart + step * 100ms, count);
        EXPECT_EQ(reports, 1 + expected);
    }
}

} // namespace
} // namespace spectrel
