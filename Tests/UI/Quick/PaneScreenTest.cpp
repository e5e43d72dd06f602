#include "Tests/UI/Quick/QuickFixture.h"
#include "UI/Quick/PaneModel.h"

#include <QAccessible>
#include <QQuickItem>
#include <QQuickWindow>
#include <QTest>

#include <array>

namespace spectrel {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class PaneScreenTest : public QuickFixture {
protected:
    /// What the row's item shows where, within the row's content.
    static Rect frame(const QQuickItem& item)
    {
        return {item.x(), item.y(), item.width(), item.height()};
    }
    PaneModel& pane() const
    {
        return *page()->property("pane").value<PaneModel*>();
    }
    double contentY() const
    {
        return list()->property("contentY").toDouble();
    }
    std::string title() const
    {
        return shownText("title");
    }
};

Value nested()
{
    return entries({{"Cells", entries({{"Serving", entries({{"PCI", "17"}, {"EARFCN", "1300"}})}})},
        {"Empty", entries({})}, {"Band", "3"}});
}

TEST_F(PaneScreenTest, RootPaneShowsThatItConnects)
{
    open();
    EXPECT_EQ(title(), "Spectrel");
    EXPECT_EQ(shownText("status"), "Connecting");
    EXPECT_NE(item("spinner"), nullptr);
    EXPECT_EQ(item("back"), nullptr);
    EXPECT_EQ(item("save"), nullptr);
    EXPECT_THAT(shownRows(), IsEmpty());
}

TEST_F(PaneScreenTest, LosingTheSessionShowsTheReasonAndTheSpinner)
{
    open();
    connect();
    show(nested());
    EXPECT_EQ(item("spinner"), nullptr);
    EXPECT_EQ(shownText("status"), "Updated 2024-03-05 at 14:07:31");
    lose("no service");
    EXPECT_EQ(shownText("status"), "Connecting...");
    EXPECT_EQ(shownText("reason"), "no service");
    EXPECT_NE(item("spinner"), nullptr);
}

TEST_F(PaneScreenTest, RowsAreWhatTheDisplayTreeHas)
{
    open();
    show(nested());
    ASSERT_TRUE(waitFor([this] { return row(2); }));
    EXPECT_EQ(shownRows(), treeRows());
    EXPECT_THAT(shownRows(), ElementsAre("Cells >", "Empty >", "Band: 3"));
}

TEST_F(PaneScreenTest, TouchingRowsOpensPanesAndTheBackArrowClosesThem)
{
    open();
    show(nested());
    for (const char* name : {"Cells", "Serving"}) {
        ASSERT_TRUE(waitFor([this] { return row(0); }));
        touch(row(0));
        EXPECT_EQ(title(), name);
        settle();
    }
    ASSERT_TRUE(waitFor([this] { return row(1); }));
    EXPECT_EQ(shownRows(), treeRows());
    EXPECT_EQ(shownText("path"), "/Cells/Serving");
    touch(item("back"));
    settle();
    EXPECT_EQ(title(), "Cells");
    touch(item("back"));
    settle();
    EXPECT_EQ(title(), "Spectrel");
    EXPECT_EQ(item("back"), nullptr);
    EXPECT_EQ(openPaths(), "/ ");
}

TEST_F(PaneScreenTest, InnerNodeWithoutChildrenOpensAnEmptyPane)
{
    open();
    show(nested());
    ASSERT_TRUE(waitFor([this] { return row(1); }));
    touch(row(1));
    settle();
    EXPECT_EQ(title(), "Empty");
    EXPECT_THAT(shownRows(), IsEmpty());
}

TEST_F(PaneScreenTest, TouchingALeafOpensNothingAndLeavesNothingSelected)
{
    open();
    show(nested());
    ASSERT_TRUE(waitFor([this] { return row(2); }));
    touch(row(2));
    EXPECT_EQ(openPaths(), "/ ");
    EXPECT_EQ(top().tableView().selectedRow(), std::nullopt);
}

TEST_F(PaneScreenTest, RowThatOpenedAPaneIsPlainAgainOnceThatIsClosed)
{
    open();
    show(nested());
    ASSERT_TRUE(waitFor([this] { return row(2); }));
    const QQuickItem* const card = itemIn(*row(0), "card");
    const auto colour = [card] { return card->property("color").value<QColor>().name().toStdString(); };
    const std::string plain = colour();
    touch(row(0));
    EXPECT_NE(colour(), plain); // while its pane slides in
    settle();
    touch(item("back"));
    settle();
    ASSERT_EQ(openPaths(), "/ ");
    EXPECT_EQ(colour(), plain);
}

TEST_F(PaneScreenTest, PageThatSlidesAwayTakesNoTouch)
{
    open();
    show(nested());
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    QQuickItem* leaving = row(0);
    touch(leaving);
    touch(leaving);
    EXPECT_EQ(openPaths(), "/ /Cells ");
    settle();
}

TEST_F(PaneScreenTest, ReloadChangesTheRowsInPlaceAndKeepsTheScrollPosition)
{
    open();
    show(manyLeaves(200, "a"));
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    drag(list(), {0, -300});
    settle();
    const double scrolled = contentY();
    EXPECT_GT(scrolled, 100);
    const int middle = static_cast<int>(scrolled / 50) + 4;
    QQuickItem* const before = row(middle);
    ASSERT_NE(before, nullptr);

    show(manyLeaves(200, "b"));
    EXPECT_EQ(contentY(), scrolled);
    EXPECT_EQ(row(middle), before);
    EXPECT_EQ(itemIn(*before, "value")->property("text").toString().toStdString(), "b" + std::to_string(middle));
}

TEST_F(PaneScreenTest, EveryRowInSightShowsItsOwnValueWhenRowsComeAndGoAboveThem)
{
    open();
    show(manyLeaves(200, "v"));
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    drag(list(), {0, -320});
    drag(list(), {0, -320});
    settle();
    const DictionaryRef more = Dictionary::make({});
    for (int number = 0; number < 30; ++number)
        more->set("New " + std::to_string(number), Value("n" + std::to_string(number)));
    for (int number = 0; number < 200; ++number)
        more->set("Leaf " + std::to_string(number), Value("v" + std::to_string(number)));
    for (const Value& display : {Value(more), manyLeaves(200, "w")}) {
        show(display);
        waitForFrame();
        settle();
        const auto tree = treeRows();
        EXPECT_GE(shownRows().size(), 10U);
        for (const std::string& shown : shownRows())
            EXPECT_THAT(tree, testing::Contains(shown));
    }
}

TEST_F(PaneScreenTest, EveryRowInSightShowsItsOwnValueWhileScrolling)
{
    open();
    show(manyLeaves(200, "v"));
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    for (int swipe = 0; swipe < 4; ++swipe) {
        drag(list(), {0, -320});
        settle();
        const auto tree = treeRows();
        for (const std::string& shown : shownRows())
            EXPECT_THAT(tree, testing::Contains(shown));
        EXPECT_GE(shownRows().size(), 10U);
    }
}

TEST_F(PaneScreenTest, RowsThatComeAndGoLeaveTheOthersAndTheKeyboardsRowInPlace)
{
    open();
    show(entries({{"A", "1"}, {"C", "3"}, {"D", "4"}}));
    ASSERT_TRUE(waitFor([this] { return row(2); }));
    key(Qt::Key_Down);
    key(Qt::Key_Down);
    ASSERT_EQ(list()->property("currentIndex").toInt(), 1);
    QQuickItem* const rowOfC = row(1);
    show(entries({{"A", "1"}, {"B", "2"}, {"C", "3"}, {"D", "4"}}));
    ASSERT_TRUE(waitFor([this] { return row(3); }));
    EXPECT_EQ(shownRows(), treeRows());
    EXPECT_EQ(row(2), rowOfC);
    EXPECT_EQ(list()->property("currentIndex").toInt(), 2);
    show(entries({{"C", "3"}, {"D", "4"}}));
    ASSERT_TRUE(waitFor([this] { return shownRows() == treeRows(); }));
    EXPECT_EQ(list()->property("currentIndex").toInt(), 0);
}

TEST_F(PaneScreenTest, LeafInACellMadeForAnInnerNodeStaysBlank)
{
    open();
    show(entries({{"Row", entries({})}}));
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    show(entries({{"Row", "7"}}));
    ASSERT_TRUE(waitFor([this] { return shownRows() == std::vector<std::string> {"Row"}; }));
    EXPECT_EQ(itemIn(*row(0), "disclosure"), nullptr);
}

TEST_F(PaneScreenTest, VanishedPathClosesItsPaneAndThoseAbove)
{
    open();
    show(nested());
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    touch(row(0));
    settle();
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    touch(row(0));
    settle();
    EXPECT_EQ(openPaths(), "/ /Cells /Cells/Serving ");
    show(entries({{"Other", entries({})}}));
    settle();
    EXPECT_EQ(title(), "Spectrel");
    EXPECT_THAT(shownRows(), ElementsAre("Other >"));
}

TEST_F(PaneScreenTest, PaneThatVanishesUnderAFingerLeavesCleanly)
{
    open();
    show(nested());
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    touch(row(0));
    settle();
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    const QPointF finger = press(row(0));
    show(entries({{"Other", "1"}}));
    settle();
    release(finger);
    EXPECT_EQ(openPaths(), "/ ");
    EXPECT_EQ(title(), "Spectrel");
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    touch(row(0)); // fingers work as before
    EXPECT_EQ(openPaths(), "/ ");
}

TEST_F(PaneScreenTest, LabelsStandWhereTheCellHasThem)
{
    open();
    show(entries({{"Short", "1"}, {"Long", std::string(200, 'x')}, {"Inner", entries({})}}));
    ASSERT_TRUE(waitFor([this] { return row(2); }));
    for (const int index : {0, 1}) {
        const SpectrelCell& cell = *top().cellAtRow(static_cast<std::size_t>(index));
        EXPECT_EQ(frame(*itemIn(*row(index), "name")), cell.key.frame);
        EXPECT_EQ(frame(*itemIn(*row(index), "value")), cell.value->frame);
        const QQuickItem& area = *itemIn(*row(index), "area");
        EXPECT_EQ(area.property("contentWidth").toDouble(), cell.view->contentSize.width);
        EXPECT_EQ(area.width(), cell.view->frame.width);
        EXPECT_EQ(area.height(), cell.view->frame.height);
    }
    EXPECT_EQ(frame(*itemIn(*row(2), "name")), top().cellAtRow(2)->key.frame);
    const SpectrelCell& brief = *top().cellAtRow(0);
    EXPECT_DOUBLE_EQ(brief.value->frame.x + brief.value->frame.width, itemIn(*row(0), "area")->width());
}

TEST_F(PaneScreenTest, LongNameOfAnInnerNodeEndsBeforeItsMark)
{
    open(240);
    show(entries({{"Connected mode LTE Intra-frequency Measurement", entries({})}}));
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    const QQuickItem* const name = itemIn(*row(0), "name");
    const QQuickItem* const mark = itemIn(*row(0), "disclosure");
    ASSERT_TRUE(name && mark);
    EXPECT_LE(name->mapToScene({name->width(), 0}).x(), mark->mapToScene({0, 0}).x());
    EXPECT_TRUE(name->property("truncated").toBool());
}

TEST_F(PaneScreenTest, LongValueScrollsSidewaysInItsRowAndKeepsItsPlace)
{
    open();
    show(entries({{"Long", std::string(200, 'x')}, {"Other", "1"}}));
    ASSERT_TRUE(waitFor([this] { return row(1); }));
    drag(row(0), {-150, 0});
    settle();
    QQuickItem* const area = itemIn(*row(0), "area");
    ASSERT_TRUE(waitFor([area] { return !area->property("moving").toBool(); }));
    const double moved = area->property("contentX").toDouble();
    EXPECT_GT(moved, 50);
    EXPECT_EQ(top().cellAtRow(0)->view->contentOffset, moved);
    EXPECT_EQ(contentY(), list()->property("originY").toDouble());
    show(entries({{"Long", std::string(200, 'y')}, {"Other", "1"}}));
    EXPECT_EQ(area->property("contentX").toDouble(), moved);
    show(entries({{"Long", "short"}, {"Other", "1"}}));
    EXPECT_EQ(area->property("contentX").toDouble(), 0);
}

TEST_F(PaneScreenTest, LongValueKeepsItsPlaceInAScrolledListToo)
{
    open();
    show(manyLeaves(100, std::string(200, 'x')));
    ASSERT_TRUE(waitFor([this] { return row(3); }));
    drag(list(), {0, -200});
    settle();
    const int middle = static_cast<int>(contentY() / 50) + 4;
    drag(row(middle), {-150, 0});
    QQuickItem* const area = itemIn(*row(middle), "area");
    ASSERT_TRUE(waitFor([area] { return !area->property("moving").toBool(); }));
    const double moved = area->property("contentX").toDouble();
    EXPECT_GT(moved, 50);
    for (int refresh = 0; refresh < 3; ++refresh) {
        show(manyLeaves(100, std::string(200, 'y')));
        EXPECT_EQ(area->property("contentX").toDouble(), moved);
    }
}

TEST_F(PaneScreenTest, VerticalDragOverALongValueScrollsTheList)
{
    open();
    show(manyLeaves(100, std::string(200, 'x')));
    ASSERT_TRUE(waitFor([this] { return row(3); }));
    drag(row(8), {0, -200});
    settle();
    EXPECT_GT(contentY(), 50);
    for (int index = 0; index < 100; ++index) {
        const QQuickItem* shown = row(index);
        EXPECT_TRUE(!shown || itemIn(*shown, "area")->property("contentX").toDouble() == 0) << index;
    }
}

TEST_F(PaneScreenTest, TouchingALongValueIsATouchOfItsRow)
{
    open();
    show(entries({{"Long", std::string(200, 'x')}}));
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    touch(row(0));
    EXPECT_EQ(list()->property("currentIndex").toInt(), 0);
    EXPECT_EQ(openPaths(), "/ ");
}

class EdgeSwipeTest : public PaneScreenTest {
protected:
    /// Two panes are open over the root pane, the top one with long values.
    void openPanes()
    {
        open();
        show(panes("x"));
        for (int level = 0; level < 2; ++level) {
            ASSERT_TRUE(waitFor([this] { return row(0); }));
            touch(row(0));
            settle();
        }
        ASSERT_TRUE(waitFor([this] { return row(3); }));
        ASSERT_EQ(openPaths(), Both);
    }
    static Value panes(const std::string& value)
    {
        return entries({{"One", entries({{"Two", manyLeaves(100, value + std::string(200, 'x'))}})}});
    }

    static constexpr const char* Both = "/ /One /One/Two ";
    static constexpr QPointF Edge {4, 300};
};

TEST_F(EdgeSwipeTest, GoesBackPaneByPaneAndLeavesTheRootPane)
{
    openPanes();
    for (const char* left : {"/ /One ", "/ ", "/ "}) {
        drag(Edge, {160, 10});
        EXPECT_EQ(openPaths(), left);
        settle();
    }
}

TEST_F(EdgeSwipeTest, ShortOrDrawnBackOrTakenAwayItDoesNothing)
{
    openPanes();
    drag(Edge, {40, 0});
    EXPECT_EQ(openPaths(), Both);
    press(Edge);
    moveFinger(Edge, Edge + QPointF(160, 0));
    EXPECT_NE(item("edgeSign"), nullptr);
    moveFinger(Edge + QPointF(160, 0), Edge + QPointF(20, 0));
    release(Edge + QPointF(20, 0));
    EXPECT_EQ(openPaths(), Both);
    press(Edge);
    moveFinger(Edge, Edge + QPointF(160, 0));
    cancelTouch();
    EXPECT_EQ(openPaths(), Both);
    EXPECT_EQ(item("edgeSign"), nullptr);
}

TEST_F(EdgeSwipeTest, BesideTheEdgeAValueScrollsInstead)
{
    openPanes();
    QQuickItem* const area = itemIn(*row(3), "area");
    pane().scrollSideways(3, 120);
    ASSERT_EQ(area->property("contentX").toDouble(), 120);
    const double left = area->mapToScene({0, 0}).x();
    drag({left + 1, row(3)->mapToScene({0, 25}).y()}, {160, 0});
    ASSERT_TRUE(waitFor([area] { return !area->property("moving").toBool(); }));
    EXPECT_LT(area->property("contentX").toDouble(), 120);
    EXPECT_EQ(openPaths(), Both);
}

TEST_F(EdgeSwipeTest, AValueIsNotMovedByASwipeFromTheEdge)
{
    openPanes();
    pane().scrollSideways(3, 120);
    QQuickItem* const area = itemIn(*row(3), "area");
    const QPointF from {4, row(3)->mapToScene({0, 25}).y()};
    press(from);
    moveFinger(from, from + QPointF(160, 0));
    EXPECT_EQ(area->property("contentX").toDouble(), 120);
    release(from + QPointF(160, 0));
    EXPECT_EQ(openPaths(), "/ /One ");
    settle();
}

TEST_F(EdgeSwipeTest, VerticalDragsAndTouchesAtTheEdgeAreTheLists)
{
    openPanes();
    drag({15, 300}, {3, -200});
    settle();
    EXPECT_GT(contentY(), 50);
    EXPECT_EQ(openPaths(), Both);
    touch(item("back"));
    settle();
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    const QPointF at {15, row(0)->mapToScene({0, 25}).y()};
    press(at);
    release(at);
    EXPECT_EQ(openPaths(), Both);
    settle();
}

TEST_F(EdgeSwipeTest, PaneThatVanishesDuringASwipeTakesNoOtherAlong)
{
    openPanes();
    press(Edge);
    moveFinger(Edge, Edge + QPointF(160, 0));
    show(entries({{"One", entries({{"Other", "1"}})}}));
    release(Edge + QPointF(160, 0));
    settle();
    EXPECT_EQ(openPaths(), "/ /One ");
}

TEST_F(PaneScreenTest, BackArrowOfAPageThatSlidesAwayClosesNoOtherPane)
{
    open();
    show(nested());
    for (int level = 0; level < 2; ++level) {
        ASSERT_TRUE(waitFor([this] { return row(0); }));
        touch(row(0));
        settle();
    }
    const QPointF finger = press(item("back"));
    show(entries({{"Cells", entries({})}}));
    release(finger);
    settle();
    EXPECT_EQ(openPaths(), "/ /Cells ");
}

TEST_F(PaneScreenTest, KeyboardBrowsesAsAFingerDoes)
{
    open();
    show(nested());
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    key(Qt::Key_Return);
    EXPECT_EQ(openPaths(), "/ /Cells ");
    settle();
    key(Qt::Key_Right);
    EXPECT_EQ(openPaths(), "/ /Cells /Cells/Serving ");
    settle();
    key(Qt::Key_Escape);
    settle();
    key(Qt::Key_Backspace);
    settle();
    EXPECT_EQ(openPaths(), "/ ");
    key(Qt::Key_Backspace); // the root pane stays
    key(Qt::Key_End);
    EXPECT_EQ(list()->property("currentIndex").toInt(), 2);
    key(Qt::Key_Home);
    EXPECT_EQ(list()->property("currentIndex").toInt(), 0);
}

TEST_F(PaneScreenTest, ArrowsScrollALongValueAndThenGoBack)
{
    open();
    show(entries({{"Inner", entries({{"Long", std::string(200, 'x')}})}}));
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    key(Qt::Key_Return);
    settle();
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    key(Qt::Key_Right);
    EXPECT_EQ(itemIn(*row(0), "area")->property("contentX").toDouble(), 80);
    key(Qt::Key_Left);
    EXPECT_EQ(itemIn(*row(0), "area")->property("contentX").toDouble(), 0);
    key(Qt::Key_Left);
    EXPECT_EQ(openPaths(), "/ ");
    settle();
}

TEST_F(PaneScreenTest, WhateverANameOrValueHoldsIsShownAsOneLineOfPlainText)
{
    open();
    show(entries({{"<b>Name</b>", "<img src='x'>\nnext\xFF"}}));
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    EXPECT_THAT(shownRows(), ElementsAre("<b>Name</b>: <img src='x'>\uFFFDnext\uFFFD"));
    EXPECT_EQ(itemIn(*row(0), "value")->property("lineCount").toInt(), 1);
}

TEST_F(PaneScreenTest, WhatAThumbPressesIsLargeEnough)
{
    openAllowingSave();
    show(nested());
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    EXPECT_GE(row(0)->height(), 44);
    touch(row(0));
    settle();
    for (const char* name : {"back", "save"}) {
        EXPECT_GE(item(name)->width(), 44) << name;
        EXPECT_GE(item(name)->height(), 44) << name;
    }
}

TEST_F(PaneScreenTest, AScreenReaderHearsWhatIsShown)
{
    openAllowingSave();
    show(nested());
    ASSERT_TRUE(waitFor([this] { return row(2); }));
    const auto spoken = [](QQuickItem* shown) {
        QAccessibleInterface* interface = QAccessible::queryAccessibleInterface(shown);
        return interface ? interface->text(QAccessible::Name).toStdString() : "(silent)";
    };
    EXPECT_EQ(spoken(row(0)), "Cells");
    EXPECT_EQ(QAccessible::queryAccessibleInterface(row(0))->role(), QAccessible::Button);
    EXPECT_EQ(spoken(row(2)), "Band, 3");
    EXPECT_EQ(QAccessible::queryAccessibleInterface(row(2))->role(), QAccessible::ListItem);
    EXPECT_EQ(spoken(item("save")), "Save snapshot");
    EXPECT_EQ(spoken(item("status")), "Connecting...");
}

TEST_F(PaneScreenTest, AScreenReaderHearsNoRowThatIsGone)
{
    open();
    const auto spoken = [this] {
        std::vector<std::string> rows;
        const QAccessibleInterface* const rowsList = QAccessible::queryAccessibleInterface(list());
        for (int index = 0; index < rowsList->childCount(); ++index) {
            const QAccessibleInterface* const shown = rowsList->child(index);
            if (shown->role() == QAccessible::ListItem && !shown->state().invisible)
                rows.push_back(shown->text(QAccessible::Name).replace(", ", ": ").toStdString());
        }
        return rows;
    };
    show(manyLeaves(100, "v"));
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    for (int swipe = 0; swipe < 3; ++swipe) {
        drag(list(), {0, -330});
        settle();
        waitForFrame();
        auto rows = shownRows();
        rows.emplace_back("Leaf 0: v0"); // where the keyboard is: the list keeps it
        EXPECT_THAT(spoken(), testing::UnorderedElementsAreArray(rows));
    }
    show(manyLeaves(3, "v"));
    ASSERT_TRUE(waitFor([this] { return shownRows() == treeRows(); }));
    waitForFrame();
    EXPECT_THAT(spoken(), testing::UnorderedElementsAreArray(shownRows()));
}

TEST_F(PaneScreenTest, AScreenReaderFollowsTheKeyboardsRow)
{
    open();
    show(nested());
    ASSERT_TRUE(waitFor([this] { return row(2); }));
    const auto isFocused = [this](int index) {
        return QAccessible::queryAccessibleInterface(row(index))->state().focused == 1;
    };
    EXPECT_TRUE(isFocused(0));
    key(Qt::Key_Down); // which only shows where the keyboard is
    key(Qt::Key_Down);
    EXPECT_FALSE(isFocused(0));
    EXPECT_TRUE(isFocused(1));
    show(entries({{"Empty", entries({})}}));
    ASSERT_TRUE(waitFor([this] { return shownRows() == treeRows(); }));
    key(Qt::Key_Home); // the keys are still the page's
    EXPECT_TRUE(isFocused(0));
    show(nested());
    ASSERT_TRUE(waitFor([this] { return row(2); }));
    key(Qt::Key_Home);
    key(Qt::Key_Return);
    EXPECT_EQ(openPaths(), "/ /Cells ");
    settle();
    key(Qt::Key_Escape);
    EXPECT_EQ(openPaths(), "/ ");
    settle();
    EXPECT_TRUE(isFocused(0));
}

TEST_F(PaneScreenTest, ClosingTheWindowAsksToEndAndLeavesTheHidingToTheApplication)
{
    open();
    window().close();
    EXPECT_EQ(quits, 1);
    EXPECT_TRUE(window().isVisible());
    app->applicationWillTerminate();
    EXPECT_FALSE(window().isVisible());
}

TEST_F(PaneScreenTest, NarrowAndWideWindowsLayTheRowsOutAnew)
{
    open(400, 700);
    show(entries({{"Name", "1"}}));
    ASSERT_TRUE(waitFor([this] { return row(0); }));
    for (const int width : {320, 1200}) {
        window().resize(width, 600);
        ASSERT_TRUE(waitFor([this, width] { return page()->width() == width; }));
        const Rect value = top().cellAtRow(0)->value->frame;
        EXPECT_DOUBLE_EQ(value.x + value.width, itemIn(*row(0), "area")->width());
        EXPECT_LE(row(0)->width(), 760);
    }
}

} // namespace
} // namespace spectrel
