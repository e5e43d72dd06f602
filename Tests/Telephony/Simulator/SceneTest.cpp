#include "Telephony/Simulator/Scene.h"

#include "Telephony/Simulator/Baseband.h"

#include <gtest/gtest.h>
#include <sstream>

namespace spectrel {
namespace {

TEST(SceneTest, EachSceneHasANameThatFindsIt)
{
    std::istringstream names(sceneNames(" "));
    unsigned count = 0;
    for (std::string name; names >> name; ++count) {
        Scene scene;
        ASSERT_TRUE(sceneNamed(name, scene));
        EXPECT_EQ(sceneName(scene), name);
    }
    EXPECT_EQ(count, 10U);
    Scene scene;
    EXPECT_FALSE(sceneNamed("fly", scene));
}

TEST(SceneTest, TechnologiesAreListedByName)
{
    EXPECT_EQ(technologiesOf(Scene::Tunnel), "lte, gsm, utran, cdma, ifx");
    EXPECT_EQ(technologiesOf(Scene::Journey), "lte, gsm, utran");
    EXPECT_EQ(technologiesOf(Scene::Rejected), "gsm");
    EXPECT_EQ(sceneNames("|"), "still|walk|drive|stress|handover|tunnel|rejected|ping-pong|overshoot|journey");
}

TEST(SceneTest, BasebandExistsWhereTheSceneDoes)
{
    EXPECT_TRUE(makeBaseband(Technology::GSM, Scene::Rejected, 1));
    EXPECT_FALSE(makeBaseband(Technology::LTE, Scene::Rejected, 1));
    EXPECT_FALSE(makeBaseband(Technology::CDMA, Scene::Journey, 1));
}

} // namespace
} // namespace spectrel
