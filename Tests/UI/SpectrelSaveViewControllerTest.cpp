#include "Tests/UI/AppFixture.h"

namespace spectrel {
namespace {

using namespace std::chrono_literals;

class SpectrelSaveViewControllerTest : public AppFixture {
protected:
    SpectrelSaveViewController& open(ListRef contents)
    {
        launchAllowingSave();
        model->saveContents = std::move(contents);
        app->showSaveView();
        return *app->saveViewController();
    }
    static ListRef twoEntries()
    {
        return List::make({entries({{"Description", "Snapshot (2024)"}}), entries({{"DLF", "x"}})});
    }
    const Dictionary& snapshot() const
    {
        return *written.at(0).snapshot;
    }
};

TEST_F(SpectrelSaveViewControllerTest, AnEmptyListShowsNoRowsAndStillWritesAnEmptyDataList)
{
    auto& screen = open(List::make());
    EXPECT_EQ(screen.numberOfRows(), 0U);
    screen.savePressed();
    ASSERT_EQ(written.size(), 1U);
    ASSERT_NE(snapshot()["Data"].list(), nullptr);
    EXPECT_EQ(snapshot()["Data"].list()->count(), 0U);
    EXPECT_TRUE(snapshot().contains("Description"));
}

TEST_F(SpectrelSaveViewControllerTest, TheTimestampIsWhenTheScreenOpenedAndTheNameWhenSaveWasPressed)
{
    auto& screen = open(twoEntries());
    loop.advance(90s);
    screen.savePressed();
    EXPECT_EQ(*snapshot()["Timestamp"].string(), "2024-03-05 14:07:31 +0000");
    EXPECT_EQ(written.at(0).path, "/crash/SpectrelSnapshot-1709647741.spectrel");
}

TEST_F(SpectrelSaveViewControllerTest, ADescriptionTypedAndNotConfirmedIsSaved)
{
    auto& screen = open(twoEntries());
    screen.beginEditing();
    screen.setDescriptionText("at the bridge");
    screen.savePressed();
    EXPECT_EQ(*snapshot()["Description"].string(), "at the bridge");
}

TEST_F(SpectrelSaveViewControllerTest, AnUnwritableDirectoryGivesTheLogLineTheAlertAndAClosedScreen)
{
    auto& screen = open(twoEntries());
    canWrite = false;
    recorder.takeLog();
    screen.savePressed();
    EXPECT_EQ(recorder.takeLog(), "<3>Unable to write snapshot to /crash/SpectrelSnapshot-1709647651.spectrel\n");
    ASSERT_EQ(toolkit.alerts.size(), 1U);
    EXPECT_EQ(toolkit.alerts[0].title, "File Error");
    EXPECT_EQ(toolkit.alerts[0].message, "Unable to write file to disk");
    EXPECT_EQ(toolkit.alerts[0].button, "Close");
    EXPECT_NE(app->saveViewController(), nullptr);
    loop.runQueued();
    EXPECT_EQ(app->saveViewController(), nullptr);
}

TEST_F(SpectrelSaveViewControllerTest, SavingClosesTheScreenAfterTheButtonsActionHasEnded)
{
    auto& screen = open(twoEntries());
    screen.savePressed();
    EXPECT_NE(app->saveViewController(), nullptr);
    loop.runQueued();
    EXPECT_EQ(app->saveViewController(), nullptr);
    EXPECT_TRUE(toolkit.alerts.empty());
}

TEST_F(SpectrelSaveViewControllerTest, CancellingClosesTheScreenWithoutWriting)
{
    auto& screen = open(twoEntries());
    screen.cancelPressed();
    EXPECT_NE(app->saveViewController(), nullptr);
    loop.runQueued();
    EXPECT_EQ(app->saveViewController(), nullptr);
    EXPECT_TRUE(written.empty());
}

TEST_F(SpectrelSaveViewControllerTest, ClosingTwiceInOneTurnDoesNoHarm)
{
    auto& screen = open(twoEntries());
    screen.savePressed();
    screen.cancelPressed();
    loop.runQueued();
    EXPECT_EQ(app->saveViewController(), nullptr);
}

TEST_F(SpectrelSaveViewControllerTest, EveryEntryIsARowWithItsDescriptionAndACheckmark)
{
    auto& screen = open(twoEntries());
    screen.saveContentTable()->setVisibleRows(0, 10, {0, 0, 320, 44});
    ASSERT_EQ(screen.saveContentTable()->numberOfRows(), 2U);
    const CellRef first = screen.saveContentTable()->cellAtRow(0);
    EXPECT_EQ(first->textLabel.text, "Snapshot (2024)");
    EXPECT_EQ(first->textLabel.font, (Font {13, FontWeight::Regular, "Helvetica"}));
    EXPECT_EQ(first->accessory, CellAccessory::Checkmark);
    EXPECT_EQ(first->reuseIdentifier(), "SaveHistoryContentCell");
    const CellRef second = screen.saveContentTable()->cellAtRow(1);
    EXPECT_EQ(second->textLabel.text, "");
    EXPECT_EQ(second->accessory, CellAccessory::Checkmark);
}

TEST_F(SpectrelSaveViewControllerTest, TheListIsACopyOfWhatWasGiven)
{
    const ListRef given = twoEntries();
    auto& screen = open(given);
    given->removeAll();
    EXPECT_EQ(screen.numberOfRows(), 2U);
    screen.savePressed();
    EXPECT_EQ(snapshot()["Data"].list()->count(), 2U);
}

TEST_F(SpectrelSaveViewControllerTest, AnAbsentDescriptionLeavesOutOnlyTheDescription)
{
    auto& screen = open(twoEntries());
    screen.saveDescription()->text.reset();
    screen.savePressed();
    EXPECT_EQ(snapshot().count(), 2U);
    EXPECT_FALSE(snapshot().contains("Description"));
}

TEST_F(SpectrelSaveViewControllerTest, AnAbsentListEndsTheSnapshotAfterItsTimestamp)
{
    auto& screen = open(nullptr);
    EXPECT_EQ(screen.numberOfRows(), 0U);
    screen.savePressed();
    EXPECT_EQ(snapshot().count(), 1U);
    EXPECT_TRUE(snapshot().contains("Timestamp"));
}

TEST_F(SpectrelSaveViewControllerTest, ReturnATouchOfTheBackgroundAndARowTakeTheFocusFromTheField)
{
    auto& screen = open(twoEntries());
    TextField& field = *screen.saveDescription();
    screen.beginEditing();
    EXPECT_TRUE(field.isFirstResponder);
    EXPECT_TRUE(screen.textFieldShouldReturn(field));
    EXPECT_FALSE(field.isFirstResponder);
    screen.beginEditing();
    screen.backgroundTouched();
    EXPECT_FALSE(field.isFirstResponder);
    screen.beginEditing();
    screen.saveContentTable()->selectRow(1);
    EXPECT_FALSE(field.isFirstResponder);
    EXPECT_TRUE(written.empty());
}

TEST_F(SpectrelSaveViewControllerTest, TheScreenFillsTheApplicationsFrame)
{
    EXPECT_EQ(open(twoEntries()).frame(), (Rect {0, 0, 320, 480}));
}

} // namespace
} // namespace spectrel
