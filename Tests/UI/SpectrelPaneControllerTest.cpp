#include "Tests/UI/AppFixture.h"

namespace spectrel {
namespace {

class SpectrelPaneControllerTest : public AppFixture {
protected:
    std::string rows(SpectrelPaneController& pane)
    {
        display(pane);
        std::string text;
        for (std::size_t row = 0; row < pane.numberOfRows(); ++row) {
            const SpectrelCell& cell = *pane.cellAtRow(row);
            text += cell.key.text + (cell.value ? "=" + cell.value->text : "")
                + (cell.accessory == CellAccessory::DisclosureIndicator ? ">" : "") + "\n";
        }
        return text;
    }
};

TEST_F(SpectrelPaneControllerTest, APaneWithNoNodeShowsNoRowsAndTheTitleSpectrel)
{
    FakeApplication application;
    SpectrelPaneController pane(application, toolkit, nullptr, "/");
    pane.viewWillAppear();
    EXPECT_EQ(pane.title(), "Spectrel");
    EXPECT_EQ(pane.numberOfRows(), 0U);
    EXPECT_EQ(pane.path(), "/");
    EXPECT_EQ(pane.status(), "");
    EXPECT_TRUE(pane.isLoading());
}

TEST_F(SpectrelPaneControllerTest, ARootLeafShowsNoRows)
{
    launch();
    show("text");
    EXPECT_EQ(rows(top()), "");
    EXPECT_EQ(top().title(), "Spectrel");
}

TEST_F(SpectrelPaneControllerTest, RowsShowTheChildrenInTheNodesOrder)
{
    launch();
    show(entries({{"Z", "1"}, {"M", entries({{"x", "y"}})}, {"A", List::make()}}));
    EXPECT_EQ(rows(top()), "Z=1\nM>\nA>\n");
}

TEST_F(SpectrelPaneControllerTest, AnInnerNodeWithoutChildrenHasADisclosureIndicatorAndOpensAnEmptyPane)
{
    launch();
    show(entries({{"Empty", entries({})}}));
    EXPECT_EQ(rows(top()), "Empty>\n");
    tap(0);
    EXPECT_EQ(openPaths(), "/ /Empty ");
    EXPECT_EQ(top().title(), "Empty");
    EXPECT_EQ(rows(top()), "");
}

TEST_F(SpectrelPaneControllerTest, TappingALeafRowOnlyDeselectsIt)
{
    launch();
    show(entries({{"Leaf", "1"}}));
    toolkit.changes.clear();
    tap(0);
    EXPECT_EQ(openPaths(), "/ ");
    EXPECT_EQ(top().tableView().selectedRow(), std::nullopt);
    EXPECT_EQ(toolkit.changes, (std::vector<FakeToolkit::Change> {{ScreenPart::Rows, Animation::None}}));
}

TEST_F(SpectrelPaneControllerTest, SelectingNoRowIsIgnored)
{
    launch();
    show(entries({{"Inner", entries({})}}));
    top().tableView().selectRow(std::nullopt);
    top().tableView().selectRow(7);
    EXPECT_EQ(openPaths(), "/ ");
}

TEST_F(SpectrelPaneControllerTest, AnOpenedPaneTakesPathStatusAndIndicatorFromTheOneBelow)
{
    launch();
    show(entries({{"Cells", List::make({entries({{"PCI", "17"}})})}}));
    tap(0);
    tap(0);
    EXPECT_EQ(openPaths(), "/ /Cells /Cells/0 ");
    EXPECT_EQ(toolbar(top()), "(spinning)|Connecting...|...");
    EXPECT_EQ(top().title(), "0");
    EXPECT_FALSE(panes()[1]->isFirstResponder());
    EXPECT_TRUE(top().isFirstResponder());
    EXPECT_FALSE(app->navController()->isToolbarHidden());
}

TEST_F(SpectrelPaneControllerTest, NoStatusTextReadsAsAnEmptyOne)
{
    FakeApplication application;
    SpectrelPaneController pane(application, toolkit, nullptr, "/");
    pane.setStatus("text", false);
    EXPECT_EQ(toolbar(pane), "(stopped)|text|...");
    pane.setStatus(std::nullopt, true);
    EXPECT_EQ(toolbar(pane), "(spinning)||...");
}

TEST_F(SpectrelPaneControllerTest, TheStatusLabelIsInThe14PointSystemFont)
{
    FakeApplication application;
    SpectrelPaneController pane(application, toolkit, nullptr, "/");
    pane.setStatus("text", false);
    EXPECT_EQ(pane.toolbarItems()[1].font, (Font {14, FontWeight::Regular}));
}

TEST_F(SpectrelPaneControllerTest, TheSaveButtonOpensTheSaveScreen)
{
    launchAllowingSave();
    ASSERT_EQ(top().toolbarItems().back().kind, ToolbarItem::Kind::SaveButton);
    const auto action = top().toolbarItems().back().action;
    action();
    EXPECT_NE(app->saveViewController(), nullptr);
}

TEST_F(SpectrelPaneControllerTest, WhatItSaysOfTheSessionIsThatOfTheToolbar)
{
    FakeApplication application;
    SpectrelPaneController pane(application, toolkit, nullptr, "/");
    pane.pressSaveButton();
    EXPECT_EQ(application.saveViews, 0);
    application.reason = "no service";
    application.allowsSaving = true;
    EXPECT_EQ(pane.lostReason(), "");
    EXPECT_FALSE(pane.canSave());
    pane.createToolbarItems();
    EXPECT_EQ(toolbar(pane), "(spinning)||no service|...|[save]");
    EXPECT_EQ(pane.lostReason(), "no service");
    EXPECT_TRUE(pane.canSave());
    pane.pressSaveButton();
    EXPECT_EQ(application.saveViews, 1);
}

TEST_F(SpectrelPaneControllerTest, ARowMadeForAnInnerNodeLeavesTheValueOfALeafBlank)
{
    launch();
    show(entries({{"Inner", entries({})}}));
    EXPECT_EQ(rows(top()), "Inner>\n");
    show(entries({{"Leaf", "1"}}));
    EXPECT_EQ(rows(top()), "Leaf\n");
}

TEST_F(SpectrelPaneControllerTest, ARowMadeForALeafLosesItsValueForAnInnerNodeAndGetsItBack)
{
    launch();
    show(entries({{"Leaf", "1"}}));
    EXPECT_EQ(rows(top()), "Leaf=1\n");
    show(entries({{"Inner", entries({})}}));
    EXPECT_EQ(rows(top()), "Inner=>\n");
    show(entries({{"Leaf", "2"}}));
    EXPECT_EQ(rows(top()), "Leaf=2\n");
}

TEST_F(SpectrelPaneControllerTest, AllRowsInSightReturnToThePoolInOrderBeforeAReloadTakesThemInThatOrder)
{
    launch();
    show(entries({{"Leaf", "1"}, {"Inner", entries({})}, {"Last", "3"}}));
    EXPECT_EQ(rows(top()), "Leaf=1\nInner>\nLast=3\n");
    const std::vector<const void*> before {top().cellAtRow(0), top().cellAtRow(1), top().cellAtRow(2)};
    show(entries({{"Leaf", "4"}, {"Inner", entries({})}, {"Last", "5"}}));
    EXPECT_EQ(rows(top()), "Leaf=4\nInner>\nLast=5\n");
    EXPECT_EQ(before, (std::vector<const void*> {top().cellAtRow(0), top().cellAtRow(1), top().cellAtRow(2)}));
}

TEST_F(SpectrelPaneControllerTest, ScrollingFillsTheRowsComingIntoSightFromThoseThatLeft)
{
    launch();
    show(entries({{"a", "1"}, {"b", "2"}, {"c", "3"}, {"d", "4"}, {"e", "5"}}));
    TableView& table = top().tableView();
    const Rect bounds {0, 0, 320, 50};
    table.setVisibleRows(0, 3, bounds);
    const void* first = top().cellAtRow(0);
    const void* second = top().cellAtRow(1);
    const void* third = top().cellAtRow(2);
    table.setVisibleRows(2, 3, bounds);
    EXPECT_EQ(top().cellAtRow(1), nullptr);
    EXPECT_EQ(top().cellAtRow(2), third);
    EXPECT_EQ(top().cellAtRow(3), first);
    EXPECT_EQ(top().cellAtRow(4), second);
    EXPECT_EQ(top().cellAtRow(4)->value->text, "5");
}

TEST_F(SpectrelPaneControllerTest, ValuesAreScrolledBackWhenTheirRowShowsAnotherChild)
{
    launch();
    show(entries({{"a", std::string(100, 'x')}, {"b", "2"}}));
    TableView& table = top().tableView();
    table.setVisibleRows(0, 1, {0, 0, 320, 50});
    ASSERT_TRUE(top().cellAtRow(0)->view->scrollBy(50));
    top().reloadWithNode(top().node());
    EXPECT_EQ(top().cellAtRow(0)->view->contentOffset, 50);
    table.setVisibleRows(1, 1, {0, 0, 320, 50});
    EXPECT_EQ(top().cellAtRow(1)->view->contentOffset, 0);
}

TEST_F(SpectrelPaneControllerTest, AScrolledValueKeepsItsPlaceThroughReloadsWhicheverCellItsRowGets)
{
    launch();
    const std::string longText(100, 'x');
    show(entries({{"a", "1"}, {"b", longText}, {"c", longText}, {"d", "4"}}));
    TableView& table = top().tableView();
    table.setVisibleRows(0, 4, {0, 0, 320, 50});
    table.setVisibleRows(1, 2, {0, 0, 320, 50}); // two cells wait in the pool
    ASSERT_TRUE(top().cellAtRow(1)->view->scrollBy(50));
    for (int refresh = 0; refresh < 3; ++refresh) {
        top().reloadWithNode(top().node());
        EXPECT_EQ(top().cellAtRow(1)->view->contentOffset, 50);
        EXPECT_EQ(top().cellAtRow(2)->view->contentOffset, 0);
    }
    show(entries({{"a", "1"}, {"b", "short"}, {"c", longText}, {"d", "4"}}));
    EXPECT_EQ(top().cellAtRow(1)->view->contentOffset, 0);
}

TEST_F(SpectrelPaneControllerTest, ANewWidthLaysTheRowsInSightOutAgain)
{
    launch();
    show(entries({{"a", "1"}, {"b", entries({})}}));
    display(top(), 320);
    EXPECT_EQ(top().cellAtRow(0)->value->frame.x, 310);
    display(top(), 200);
    EXPECT_EQ(top().cellAtRow(0)->value->frame.x, 190);
}

} // namespace
} // namespace spectrel
