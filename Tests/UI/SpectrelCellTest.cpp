#include "UI/SpectrelCell.h"
#include "Tests/Fakes/FakeToolkit.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

class SpectrelCellTest : public testing::Test {
protected:
    /// A leaf's row with a name and a value of the given widths, laid out.
    std::shared_ptr<SpectrelCell> leaf(double keyWidth, double valueWidth, const Rect& bounds)
    {
        toolkit.sizes["name"] = {keyWidth, 18};
        toolkit.sizes["value"] = {valueWidth, 20};
        auto cell = SpectrelCell::initWithStyle(toolkit, CellStyle::Default, "id");
        cell->key.text = "name";
        cell->value->text = "value";
        cell->bounds = bounds;
        cell->setLayout();
        return cell;
    }

    FakeToolkit toolkit;
};

TEST_F(SpectrelCellTest, ALongValueFollowsTheNameAndCanBeScrolled)
{
    const auto cell = leaf(100, 300, {0, 0, 320, 50});
    EXPECT_EQ(cell->value->frame.x, 160);
    EXPECT_EQ(cell->view->contentSize, (Size {720, 50}));
    EXPECT_EQ(cell->view->frame, (Rect {0, 0, 320, 50}));
    EXPECT_EQ(cell->view->scrollableWidth(), 400);
}

TEST_F(SpectrelCellTest, AShortValuesRightEdgeTouchesTheRows)
{
    const auto cell = leaf(40, 30, {0, 0, 320, 50});
    EXPECT_EQ(cell->value->frame, (Rect {290, 15, 30, 20}));
    EXPECT_EQ(cell->value->frame.x + cell->value->frame.width, 320);
    EXPECT_EQ(cell->view->contentSize, (Size {320, 50}));
    EXPECT_EQ(cell->view->scrollableWidth(), 0);
}

TEST_F(SpectrelCellTest, BothSidesOfTheWidthThatFits)
{
    EXPECT_EQ(leaf(100, 159, {0, 0, 320, 50})->value->frame.x, 161); // one point to spare: right-aligned
    const auto exact = leaf(100, 160, {0, 0, 320, 50});
    EXPECT_EQ(exact->value->frame.x, 160);
    EXPECT_EQ(exact->view->contentSize.width, 320);
    const auto over = leaf(100, 161, {0, 0, 320, 50});
    EXPECT_EQ(over->value->frame.x, 160);
    EXPECT_EQ(over->view->contentSize.width, 581);
}

TEST_F(SpectrelCellTest, TheNameStandsTenPointsInAndInTheMiddle)
{
    const auto cell = leaf(100, 300, {5, 7, 320, 60});
    EXPECT_EQ(cell->key.frame, (Rect {15, 21, 100, 18}));
    EXPECT_EQ(cell->value->frame.x, 165);
    EXPECT_EQ(cell->view->frame, (Rect {5, 7, 320, 50}));
}

TEST_F(SpectrelCellTest, TheValueIsMeasuredInTheNamesBoldFontAndShownInTheRegularOne)
{
    const auto cell = leaf(100, 300, {0, 0, 320, 50});
    EXPECT_EQ(toolkit.measuredFonts, (std::vector<Font>(2, Font {15, FontWeight::Bold})));
    EXPECT_EQ(cell->key.font, (Font {15, FontWeight::Bold}));
    EXPECT_EQ(cell->value->font, (Font {15, FontWeight::Regular}));
}

TEST_F(SpectrelCellTest, ARowForAnInnerNodeHasOnlyTheName)
{
    const auto cell = SpectrelCell::initWithStyleKey(toolkit, CellStyle::Default, "id");
    cell->key.text = "four";
    cell->bounds = {0, 0, 320, 50};
    cell->setLayoutKey();
    EXPECT_EQ(cell->key.frame, (Rect {10, 16, 40, 18}));
    EXPECT_FALSE(cell->value);
    EXPECT_FALSE(cell->view);
}

TEST_F(SpectrelCellTest, ARowForAnInnerNodeLaidOutForALeafPlacesTheName)
{
    const auto cell = SpectrelCell::initWithStyleKey(toolkit, CellStyle::Default, "id");
    cell->key.text = "four";
    cell->bounds = {0, 0, 320, 50};
    cell->setLayout();
    EXPECT_EQ(cell->key.frame, (Rect {10, 16, 40, 18}));
    EXPECT_FALSE(cell->view);
}

TEST_F(SpectrelCellTest, ScrollingEndsAtBothEnds)
{
    const auto cell = leaf(100, 300, {0, 0, 320, 50});
    EXPECT_FALSE(cell->view->scrollBy(-10));
    EXPECT_TRUE(cell->view->scrollBy(390));
    EXPECT_TRUE(cell->view->scrollBy(100));
    EXPECT_EQ(cell->view->contentOffset, 400);
    EXPECT_FALSE(cell->view->scrollBy(1));
}

} // namespace
} // namespace spectrel
