#include "Tests/UI/Quick/QuickFixture.h"

#include <QQuickItem>
#include <QQuickWindow>
#include <QTest>

namespace spectrel {
namespace {

using testing::IsEmpty;
using testing::SizeIs;

class SaveScreenTest : public QuickFixture {
protected:
    /// Opens the save screen over a pane.
    void openSaveScreen()
    {
        openAllowingSave();
        model->saveContents = List::make({entries({{"Description", "First"}}), entries({{"Description", "Second"}})});
        touch(item("save"));
        ASSERT_TRUE(waitFor([this] { return item("saveButton"); }));
        waitUntilStill();
    }
    void waitUntilStill()
    {
        double last = -1;
        EXPECT_TRUE(waitFor([this, &last] {
            const QQuickItem* button = item("saveButton");
            const double y = button ? button->mapToScene({0, 0}).y() : 0;
            return std::exchange(last, y) == y && button && y < 100; // at the top, where the sheet ends up
        }));
    }
    void waitUntilClosed()
    {
        EXPECT_TRUE(waitFor([this] { return !item("saveButton"); }));
    }
    bool fieldHasFocus() const
    {
        return item("description")->hasActiveFocus();
    }
    std::string savedDescription() const
    {
        const std::string* text = (*written.back().snapshot)["Description"].string();
        return text ? *text : "(none)";
    }
};

TEST_F(SaveScreenTest, WithoutTheMarkerThereIsNoWayToIt)
{
    open();
    EXPECT_EQ(item("save"), nullptr);
    key(Qt::Key_S, Qt::ControlModifier);
    EXPECT_EQ(app->saveViewController(), nullptr);
}

TEST_F(SaveScreenTest, ListsEveryEntryWithACheckmark)
{
    openSaveScreen();
    QQuickItem* const rows = item("saveRows");
    ASSERT_EQ(rows->property("count").toInt(), 2);
    for (int index = 0; index < 2; ++index) {
        QQuickItem* entry = nullptr;
        QMetaObject::invokeMethod(rows, "itemAtIndex", Q_RETURN_ARG(QQuickItem*, entry), Q_ARG(int, index));
        ASSERT_NE(entry, nullptr);
        EXPECT_EQ(itemIn(*entry, "entryText")->property("text").toString(), index == 0 ? "First" : "Second");
        EXPECT_NE(itemIn(*entry, "checkmark"), nullptr);
    }
    EXPECT_EQ(rows->height(), rows->property("contentHeight").toDouble()); // sized to fit its contents
}

TEST_F(SaveScreenTest, ItsTitleIsWholeOnTheSmallestPhone)
{
    openSaveScreen();
    window().resize(320, 480);
    ASSERT_TRUE(waitFor([this] { return page()->width() == 320; }));
    waitForFrame();
    EXPECT_FALSE(item("saveTitle")->property("truncated").toBool());
}

TEST_F(SaveScreenTest, WritesTheDescriptionThatWasTypedButNotConfirmed)
{
    openSaveScreen();
    type("At the mast");
    touch(item("saveButton"));
    waitUntilClosed();
    ASSERT_THAT(written, SizeIs(1));
    EXPECT_EQ(savedDescription(), "At the mast");
    EXPECT_EQ(app->saveViewController(), nullptr);
}

TEST_F(SaveScreenTest, EmptyListShowsNoRowsAndIsSaved)
{
    openAllowingSave();
    model->saveContents = List::make({});
    touch(item("save"));
    ASSERT_TRUE(waitFor([this] { return item("saveButton"); }));
    waitUntilStill();
    touch(item("saveButton"));
    waitUntilClosed();
    ASSERT_THAT(written, SizeIs(1));
    EXPECT_EQ((*written[0].snapshot)["Data"].list()->count(), 0U);
    EXPECT_EQ(savedDescription(), "");
}

TEST_F(SaveScreenTest, ReturnAndTouchesBesideTheFieldGiveUpItsFocus)
{
    openSaveScreen();
    EXPECT_TRUE(fieldHasFocus());
    key(Qt::Key_Return);
    EXPECT_FALSE(fieldHasFocus());
    EXPECT_FALSE(app->saveViewController()->saveDescription()->isFirstResponder);

    touch(item("description"));
    EXPECT_TRUE(fieldHasFocus());
    EXPECT_TRUE(app->saveViewController()->saveDescription()->isFirstResponder);
    touch(item("saveRow"));
    EXPECT_FALSE(fieldHasFocus());

    touch(item("description"));
    QQuickItem* const rows = item("saveRows");
    const QPointF below = rows->mapToScene({rows->width() / 2, rows->height() + 60});
    QTest::mouseClick(&window(), Qt::LeftButton, {}, below.toPoint());
    EXPECT_FALSE(fieldHasFocus());
    EXPECT_NE(app->saveViewController(), nullptr);
}

TEST_F(SaveScreenTest, CancelWritesNothing)
{
    openSaveScreen();
    type("no");
    touch(item("cancelButton"));
    waitUntilClosed();
    EXPECT_THAT(written, IsEmpty());
}

TEST_F(SaveScreenTest, EscapeCancelsAndTheKeyboardReturnsToThePane)
{
    openSaveScreen();
    key(Qt::Key_Escape);
    waitUntilClosed();
    EXPECT_THAT(written, IsEmpty());
    show(entries({{"A", entries({})}}));
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    key(Qt::Key_Return);
    EXPECT_EQ(openPaths(), "/ /A ");
    settle();
}

TEST_F(SaveScreenTest, OpensAndSavesByKeyboardAlone)
{
    openAllowingSave();
    model->saveContents = List::make({});
    key(Qt::Key_S, Qt::ControlModifier);
    ASSERT_TRUE(waitFor([this] { return item("saveButton"); }));
    type("keys");
    key(Qt::Key_S, Qt::ControlModifier);
    waitUntilClosed();
    ASSERT_THAT(written, SizeIs(1));
    EXPECT_EQ(savedDescription(), "keys");
}

TEST_F(SaveScreenTest, FailedWriteClosesTheScreenAndLeavesTheAlert)
{
    canWrite = false;
    openSaveScreen();
    touch(item("saveButton"));
    waitUntilClosed();
    ASSERT_TRUE(waitFor([this] { return item("alertButton"); }));
    EXPECT_EQ(shownText("alertTitle"), "File Error");
    EXPECT_EQ(shownText("alertMessage"), "Unable to write file to disk");
    EXPECT_EQ(shownText("alertButton"), "Close");
    EXPECT_THAT(recorder.takeLog(), testing::HasSubstr("<3>Unable to write snapshot to /crash/SpectrelSnapshot-"));
    touch(item("alertButton"));
    EXPECT_TRUE(waitFor([this] { return !item("alertButton"); }));
}

TEST_F(SaveScreenTest, PanesGoOnBelowTheSaveScreen)
{
    openSaveScreen();
    show(entries({{"A", "1"}}));
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    EXPECT_EQ(shownRows(), treeRows());
    EXPECT_NE(item("saveButton"), nullptr);
}

TEST_F(SaveScreenTest, EndOfTheProgramTakesTheOpenSaveScreenAlong)
{
    openSaveScreen();
    app->applicationWillTerminate();
    EXPECT_FALSE(window().isVisible());
}

} // namespace
} // namespace spectrel
