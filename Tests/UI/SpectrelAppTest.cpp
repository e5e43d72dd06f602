#include "Tests/UI/AppFixture.h"

namespace spectrel {
namespace {

using namespace std::chrono_literals;

class SpectrelAppTest : public AppFixture { };

Value nested()
{
    return entries({{"A", entries({{"B", entries({{"C", "1"}})}})}, {"D", entries({})}});
}

TEST_F(SpectrelAppTest, NoPaneShowsTheSaveButtonWithoutTheMarker)
{
    launch();
    show(nested());
    tap(0);
    EXPECT_FALSE(app->allowSaveButton());
    EXPECT_EQ(toolbar(*panes()[0]), "(spinning)|Connecting...|...");
    EXPECT_EQ(toolbar(*panes()[1]), "(spinning)|Connecting...|...");
}

TEST_F(SpectrelAppTest, EveryPaneShowsTheSaveButtonWithTheMarker)
{
    launchAllowingSave();
    show(nested());
    tap(0);
    EXPECT_TRUE(app->allowSaveButton());
    EXPECT_EQ(toolbar(*panes()[0]), "(spinning)|Connecting...|...|[save]");
    EXPECT_EQ(toolbar(*panes()[1]), "(spinning)|Connecting...|...|[save]");
}

TEST_F(SpectrelAppTest, LaunchShowsTheRootPaneConnectingInTheWindow)
{
    app = makeApp(toolkit);
    EXPECT_EQ(SpectrelApp::sharedApplication(), app.get());
    app->applicationDidFinishLaunching();
    EXPECT_EQ(openPaths(), "/ ");
    EXPECT_EQ(top().title(), "Spectrel");
    EXPECT_EQ(toolbar(top()), "(spinning)|Connecting|...");
    EXPECT_EQ(app->updateMessage(), "Connecting...");
    ASSERT_NE(app->window(), nullptr);
    EXPECT_TRUE(app->window()->isKeyAndVisible);
    EXPECT_EQ(app->window()->frame, (Rect {0, 0, 320, 480}));
    EXPECT_EQ(app->window()->rootViewController, app->navController());
}

TEST_F(SpectrelAppTest, TheSessionStartsOnlyAfterLaunchHasReturned)
{
    app = makeApp(toolkit);
    app->applicationDidFinishLaunching();
    EXPECT_EQ(model->restarts, 0);
    loop.runQueued();
    EXPECT_EQ(model->restarts, 1);
}

TEST_F(SpectrelAppTest, TheQueuedStartDoesNothingOnceTheApplicationIsGone)
{
    app = makeApp(toolkit);
    app->applicationDidFinishLaunching();
    app.reset();
    loop.runQueued();
    EXPECT_EQ(SpectrelApp::sharedApplication(), nullptr);
}

TEST_F(SpectrelAppTest, AReloadWhileConnectedShowsItsTime)
{
    launch();
    connect();
    EXPECT_EQ(toolbar(top()), "(spinning)|Connecting|...");
    show(nested());
    EXPECT_EQ(toolbar(top()), "(stopped)|Updated 2024-03-05 at 14:07:31|...");
    loop.advance(2s);
    show(nested());
    EXPECT_EQ(toolbar(top()), "(stopped)|Updated 2024-03-05 at 14:07:33|...");
}

TEST_F(SpectrelAppTest, TheTimeIsTheDevicesOwn)
{
    loop.setZone({3600, false});
    launch();
    connect();
    show(nested());
    EXPECT_EQ(top().status(), "Updated 2024-03-05 at 15:07:31");
}

TEST_F(SpectrelAppTest, AReloadWhileNotConnectedLeavesTheUpdateMessageAndShowsConnecting)
{
    launch();
    connect();
    show(nested());
    model->connected = false; // nobody has been told yet
    show(nested());
    EXPECT_EQ(app->updateMessage(), "Updated 2024-03-05 at 14:07:31");
    EXPECT_EQ(toolbar(top()), "(spinning)|Connecting...|...");
}

TEST_F(SpectrelAppTest, OnlyTheTopPanesStatusIsUpdatedAtAReload)
{
    launch();
    connect();
    show(nested());
    tap(0);
    loop.advance(2s);
    show(nested());
    EXPECT_EQ(panes()[0]->status(), "Updated 2024-03-05 at 14:07:31");
    EXPECT_EQ(panes()[1]->status(), "Updated 2024-03-05 at 14:07:33");
}

TEST_F(SpectrelAppTest, GoingBackUpdatesTheStatusOfThePaneComingIntoSight)
{
    launch();
    connect();
    show(nested());
    tap(0);
    loop.advance(2s);
    show(nested());
    app->navController()->popViewController(Animation::Animated);
    EXPECT_EQ(top().status(), "Updated 2024-03-05 at 14:07:33");
}

TEST_F(SpectrelAppTest, APaneWhosePathVanishedClosesWithAllAboveItAndTheOneBelowIsReloaded)
{
    launch();
    connect();
    show(nested());
    tap(0);
    tap(0);
    EXPECT_EQ(openPaths(), "/ /A /A/B ");
    const auto closed = panes()[2];
    show(entries({{"A", entries({{"X", "2"}})}}));
    EXPECT_EQ(openPaths(), "/ /A ");
    display(top());
    EXPECT_EQ(top().cellAtRow(0)->key.text, "X");
    EXPECT_EQ(top().status(), "Updated 2024-03-05 at 14:07:31");
    EXPECT_EQ(closed->childAtRow(0)->displayName(), "C"); // it went with what it showed
}

TEST_F(SpectrelAppTest, TheWalkStopsAtTheFirstPaneWithoutANode)
{
    launch();
    show(nested());
    tap(0);
    tap(0);
    toolkit.changes.clear();
    show(entries({{"D", "1"}}));
    EXPECT_EQ(openPaths(), "/ ");
    EXPECT_EQ(top().childAtRow(0)->displayName(), "D");
    EXPECT_THAT(
        toolkit.changes, testing::Contains(FakeToolkit::Change {ScreenPart::Navigation, Animation::Animated}).Times(1));
}

TEST_F(SpectrelAppTest, TheRootPaneIsReloadedEvenWithoutATree)
{
    launch();
    show(nested());
    model->root.reset();
    model->index.clear();
    app->updateViewControllerFromModel();
    EXPECT_EQ(openPaths(), "/ ");
    EXPECT_EQ(top().numberOfRows(), 0U);
    EXPECT_EQ(top().title(), "Spectrel");
}

TEST_F(SpectrelAppTest, LosingTheSessionShowsAtOnceInTheTopPaneWithTheReason)
{
    launch();
    connect();
    show(nested());
    tap(0);
    lose("Could not create RKServerConnection");
    EXPECT_EQ(toolbar(top()), "(spinning)|Connecting...|Could not create RKServerConnection|...");
    EXPECT_EQ(top().status(), "Connecting...");
}

TEST_F(SpectrelAppTest, AnOldTimeNeverPassesForANewSessions)
{
    launch();
    connect();
    show(nested());
    lose("No response to GetTechnology; cannot configure");
    connect();
    EXPECT_EQ(toolbar(top()), "(spinning)|Connecting...|...");
    tap(0);
    EXPECT_EQ(top().status(), "Connecting...");
    show(nested());
    EXPECT_EQ(toolbar(top()), "(stopped)|Updated 2024-03-05 at 14:07:31|...");
}

TEST_F(SpectrelAppTest, TheRSSIFlagIsOnlyEverWrittenFalseAndOnlyAtTermination)
{
    launchAllowingSave();
    connect();
    show(nested());
    tap(0);
    app->showSaveView();
    app->closeSaveView();
    lose("");
    EXPECT_EQ(preferences.calls, "");
    app->applicationWillTerminate();
    EXPECT_EQ(preferences.calls,
        "set org.spectrel.HomeScreen THShowGSMRSSI false\n"
        "synchronize org.spectrel.HomeScreen\n"
        "changed org.spectrel.HomeScreen THShowGSMRSSI\n");
}

TEST_F(SpectrelAppTest, TerminationClosesTheScreensAndThenTheModel)
{
    launchAllowingSave();
    app->showSaveView();
    bool windowWasGone = false;
    model->onEnd = [this, &windowWasGone] {
        windowWasGone = app->window() == nullptr && !app->saveViewController();
        observer->sessionDidChange(); // a model that closes its session says so
    };
    app->applicationWillTerminate();
    EXPECT_TRUE(windowWasGone);
    EXPECT_EQ(app->model(), nullptr);
    EXPECT_EQ(app->updateMessage(), "");
}

TEST_F(SpectrelAppTest, AReloadAfterTerminationDoesNothing)
{
    launch();
    app->applicationWillTerminate();
    app->updateViewControllerFromModel();
    app->showSaveView();
    EXPECT_EQ(app->saveViewController(), nullptr);
}

TEST_F(SpectrelAppTest, TheSaveScreenOpensOnceAndClosesOnce)
{
    launchAllowingSave();
    app->closeSaveView();
    toolkit.changes.clear();
    app->showSaveView();
    const auto* shown = app->saveViewController();
    ASSERT_NE(shown, nullptr);
    app->showSaveView();
    EXPECT_EQ(app->saveViewController(), shown);
    EXPECT_EQ(model->saveRequests, 1);
    app->closeSaveView();
    app->closeSaveView();
    EXPECT_EQ(app->saveViewController(), nullptr);
    EXPECT_THAT(
        toolkit.changes, testing::Contains(FakeToolkit::Change {ScreenPart::Modal, Animation::Animated}).Times(2));
}

} // namespace
} // namespace spectrel
