#include "UI/FindController.h"

#include "Tests/UI/AppFixture.h"

namespace spectrel {
namespace {

class FindControllerTest : public AppFixture {
protected:
    void start()
    {
        launch();
        connect();
        show(display("248"));
    }
    static DictionaryRef display(const std::string& identity)
    {
        return entries({{"Serving Cell", entries({{"Physical Cell ID", identity}, {"Band", "3"}})},
            {"Neighbours", List::make({entries({{"Cell", "17"}}), entries({{"Cell", "248"}, {"Band", "20"}})})},
            {"State", "Idle"}});
    }
    FindController& find() const
    {
        return *app->find();
    }
    void findText(const std::string& text) const
    {
        find().open();
        find().setText(text);
    }
    /// The finds, one "PANE:NAME=VALUE" each, the selected one in brackets.
    std::string found() const
    {
        std::string text;
        for (std::size_t index = 0; index < find().finds().size(); ++index) {
            const Find& each = find().finds()[index];
            const std::string row = each.panePath + ":" + each.name + (each.isLeaf ? "=" + each.value : "");
            text += (find().selected() == index ? "[" + row + "]" : row) + " ";
        }
        return text;
    }
    /// The row that is marked in the pane in sight, by its name.
    std::string marked() const
    {
        const auto row = top().tableView().selectedRow();
        return row ? top().childAtRow(*row)->displayName() : "none";
    }
};

TEST_F(FindControllerTest, NamesAndValuesAreFoundInDisplayOrder)
{
    start();
    findText("cell");
    EXPECT_EQ(
        found(), "[/:Serving Cell] /Serving Cell:Physical Cell ID=248 /Neighbours/0:Cell=17 /Neighbours/1:Cell=248 ");
    EXPECT_EQ(find().countText(), "4 found");
    find().setText("248");
    EXPECT_EQ(found(), "[/Serving Cell:Physical Cell ID=248] /Neighbours/1:Cell=248 ");
}

TEST_F(FindControllerTest, TheCaseOfLettersDoesNotMatter)
{
    start();
    findText("iDLe");
    EXPECT_EQ(found(), "[/:State=Idle] ");
}

TEST_F(FindControllerTest, AnEmptyTextFindsNothingAndSaysNothing)
{
    start();
    find().open();
    EXPECT_EQ(found(), "");
    EXPECT_EQ(find().countText(), "");
    EXPECT_FALSE(find().choose());
    EXPECT_TRUE(find().isOpen());
    find().setText("no such thing");
    EXPECT_EQ(find().countText(), "nothing found");
    EXPECT_EQ(find().selected(), std::nullopt);
}

TEST_F(FindControllerTest, OnlyThePaneInSightAndWhatIsBelowIsSearched)
{
    start();
    tap(1);
    findText("band");
    EXPECT_EQ(found(), "[/Neighbours/1:Band=20] ");
}

TEST_F(FindControllerTest, ChoosingOpensThePanesDownToTheRowAndMarksIt)
{
    start();
    findText("20");
    ASSERT_TRUE(find().choose());
    EXPECT_FALSE(find().isOpen());
    EXPECT_EQ(openPaths(), "/ /Neighbours /Neighbours/1 ");
    EXPECT_EQ(marked(), "Band");
    EXPECT_EQ(top().tableView().takeRowToShow(), 1U);
    EXPECT_EQ(top().tableView().takeRowToShow(), std::nullopt);
}

TEST_F(FindControllerTest, ChoosingARowOfThePaneInSightOnlyMarksIt)
{
    start();
    findText("state");
    ASSERT_TRUE(find().choose());
    EXPECT_EQ(openPaths(), "/ ");
    EXPECT_EQ(marked(), "State");
}

TEST_F(FindControllerTest, TheNextAndTheLastFindGoRoundTheEndAndClosePanesThatDoNotLeadThere)
{
    start();
    findText("cell");
    find().select(3);
    find().choose();
    EXPECT_EQ(openPaths(), "/ /Neighbours /Neighbours/1 ");
    EXPECT_TRUE(find().chooseNext());
    EXPECT_EQ(openPaths(), "/ ");
    EXPECT_EQ(marked(), "Serving Cell");
    EXPECT_TRUE(find().chooseNext());
    EXPECT_EQ(openPaths(), "/ /Serving Cell ");
    EXPECT_TRUE(find().choosePrevious());
    EXPECT_TRUE(find().choosePrevious());
    EXPECT_EQ(openPaths(), "/ /Neighbours /Neighbours/1 ");
    const auto neighbours = panes()[1];
    EXPECT_TRUE(find().choosePrevious());
    EXPECT_EQ(openPaths(), "/ /Neighbours /Neighbours/0 ");
    EXPECT_EQ(panes()[1], neighbours) << "a pane on the way stays open";
}

TEST_F(FindControllerTest, ThereIsNoNextFindBeforeAnyOrOnceItsPaneIsGone)
{
    start();
    EXPECT_FALSE(find().chooseNext());
    tap(1);
    findText("band");
    find().choose();
    app->navController()->popToViewControllerAtIndex(0, Animation::None);
    EXPECT_FALSE(find().chooseNext());
    EXPECT_EQ(openPaths(), "/ ");
}

TEST_F(FindControllerTest, TheListFollowsAReloadAndTheSelectionItsRow)
{
    start();
    findText("248");
    find().select(1);
    toolkit.changes.clear();
    show(display("99"));
    EXPECT_EQ(found(), "[/Neighbours/1:Cell=248] ");
    EXPECT_EQ(toolkit.changes.back().part, ScreenPart::Find);
    show(display("248"));
    EXPECT_EQ(found(), "/Serving Cell:Physical Cell ID=248 [/Neighbours/1:Cell=248] ");
}

TEST_F(FindControllerTest, ASelectionWhoseRowIsNoLongerFoundStaysInTheList)
{
    start();
    findText("cell");
    find().select(3);
    show(entries({{"Cell", "1"}}));
    EXPECT_EQ(found(), "[/:Cell=1] ");
    show(entries({}));
    EXPECT_EQ(find().selected(), std::nullopt);
    EXPECT_FALSE(find().choose());
}

TEST_F(FindControllerTest, WhenItsPaneVanishesThePaneBelowIsSearched)
{
    start();
    tap(0);
    findText("i");
    show(entries({{"Idle Mode", "yes"}}));
    EXPECT_EQ(openPaths(), "/ ");
    EXPECT_EQ(found(), "[/:Idle Mode=yes] ");
}

TEST_F(FindControllerTest, TheSelectionStaysInTheList)
{
    start();
    findText("cell");
    find().moveSelection(-5);
    EXPECT_EQ(find().selected(), 0U);
    find().moveSelection(2);
    EXPECT_EQ(find().selected(), 2U);
    find().moveSelection(50);
    EXPECT_EQ(find().selected(), 3U);
    find().select(4);
    EXPECT_EQ(find().selected(), 3U);
}

TEST_F(FindControllerTest, ClosingOpensNothingAndTheNextSearchStartsEmpty)
{
    start();
    findText("cell");
    find().close();
    EXPECT_FALSE(find().isOpen());
    EXPECT_EQ(openPaths(), "/ ");
    find().open();
    EXPECT_EQ(find().text(), "");
}

TEST_F(FindControllerTest, AListTooLongIsCutAndSaysSo)
{
    start();
    auto many = Dictionary::make();
    for (std::size_t row = 0; row < FindController::MaximumFinds; ++row)
        many->set("Row " + std::to_string(row), "x");
    show(many);
    findText("row");
    EXPECT_EQ(find().countText(), "1000 found");
    many->set("Row more", "x");
    show(many);
    EXPECT_EQ(find().countText(), "1000 and more found");
    EXPECT_EQ(find().finds().size(), FindController::MaximumFinds);
}

TEST_F(FindControllerTest, WithoutATreeNothingIsFound)
{
    launch();
    findText("x");
    EXPECT_EQ(find().countText(), "nothing found");
}

} // namespace
} // namespace spectrel
