#include "UI/CopyController.h"

#include "Tests/UI/AppFixture.h"
#include "UI/AboutText.h"

namespace spectrel {
namespace {

class CopyControllerTest : public AppFixture {
protected:
    void start()
    {
        launch();
        connect();
        show(entries({{"Cell", entries({{"ID", "248"}, {"Bands", List::make({"3", "20"})}})}, {"Note", "a\nb"}}));
    }
};

TEST_F(CopyControllerTest, ALeafsRowIsItsValue)
{
    start();
    tap(0);
    app->copying()->copyRow(top(), 0);
    EXPECT_EQ(toolkit.clipboard, "248");
    EXPECT_EQ(app->copying()->message(), "Copied the value of ID");
}

TEST_F(CopyControllerTest, AnInnerNodesRowIsItsNameAndAllBelow)
{
    start();
    app->copying()->copyRow(top(), 0);
    EXPECT_EQ(toolkit.clipboard, "Cell\n  ID: 248\n  Bands\n    0: 3\n    1: 20\n");
    EXPECT_EQ(app->copying()->message(), "Copied 5 lines");
}

TEST_F(CopyControllerTest, APaneIsItsRowsAsDecodePrintsThem)
{
    start();
    tap(0);
    app->copying()->copyPane(top());
    EXPECT_EQ(toolkit.clipboard, "ID: 248\nBands\n  0: 3\n  1: 20\n");
}

TEST_F(CopyControllerTest, ControlCharactersAreCopiedEscaped)
{
    start();
    app->copying()->copyRow(top(), 1);
    EXPECT_EQ(toolkit.clipboard, "a\\x0ab");
}

TEST_F(CopyControllerTest, WhereThereIsNothingNothingIsCopied)
{
    launch();
    toolkit.clipboard = "before";
    app->copying()->copyPane(top());
    app->copying()->copyRow(top(), 0);
    EXPECT_EQ(toolkit.clipboard, "before");
    EXPECT_EQ(app->copying()->message(), "");
}

TEST_F(CopyControllerTest, ARefusalIsToldUntilTheMessageIsCleared)
{
    start();
    toolkit.refusesToCopy = "too long";
    toolkit.changes.clear();
    app->copying()->copyPane(top());
    EXPECT_EQ(app->copying()->message(), "Not copied: too long");
    app->copying()->clearMessage();
    app->copying()->clearMessage();
    EXPECT_EQ(app->copying()->message(), "");
    EXPECT_EQ(toolkit.changes.size(), 2U);
}

TEST(AboutTextTest, TellsTheNameTheVersionAndWhatItIs)
{
    const AboutText about = AboutText::text();
    EXPECT_EQ(about.name, "Spectrel");
    EXPECT_THAT(about.version, testing::MatchesRegex("[0-9]+[.][0-9]+[.][0-9]+"));
    EXPECT_NE(about.summary, "");
}

} // namespace
} // namespace spectrel
