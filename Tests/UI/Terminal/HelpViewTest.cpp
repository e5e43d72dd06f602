#include "Tests/Fakes/FakePlayback.h"
#include "Tests/UI/Terminal/TerminalFixture.h"

namespace spectrel {
namespace {

using testing::HasSubstr;
using testing::Not;

class HelpViewTest : public TerminalFixture {
protected:
    void open(int width, int height)
    {
        start();
        show(entries({{"A", entries({})}}));
        screen.resize(width, height);
        type(U"?");
    }
};

TEST_F(HelpViewTest, QuestionMarkShowsTheKeysAndAnyKeyHidesThem)
{
    open(60, 24);
    EXPECT_THAT(text(), HasSubstr("Enter Right       open"));
    EXPECT_THAT(text(), HasSubstr("Spectrel 0."));
    press(Key::Enter);
    EXPECT_THAT(text(), Not(HasSubstr("Enter Right       open")));
    EXPECT_EQ(openPaths(), "/ ");
}

TEST_F(HelpViewTest, InASmallWindowItScrolls)
{
    open(70, 8);
    EXPECT_THAT(text(), HasSubstr("Keys"));
    EXPECT_THAT(text(), HasSubstr("more below"));
    EXPECT_THAT(text(), Not(HasSubstr("more above")));
    for (int page = 0; page < 3; ++page)
        press(Key::PageDown);
    EXPECT_THAT(text(), HasSubstr("Live radio diagnostics"));
    EXPECT_THAT(text(), HasSubstr("more above"));
    EXPECT_THAT(text(), Not(HasSubstr("more below")));
    press(Key::Up);
    EXPECT_THAT(text(), HasSubstr("more below"));
    wheel(MouseEvent::Action::WheelDown);
    EXPECT_THAT(text(), Not(HasSubstr("more below")));
    type(U"x");
    EXPECT_THAT(text(), Not(HasSubstr("more above")));
}

TEST_F(HelpViewTest, InANarrowWindowWhatAKeyDoesGoesOnBelow)
{
    open(36, 30);
    EXPECT_THAT(text(), HasSubstr("│ /                 find a name or │"));
    EXPECT_THAT(text(), HasSubstr("│                   value here and │"));
    EXPECT_THAT(text(), HasSubstr("│ Live radio diagnostics: which    │"));
    for (const int width : {20, 24, 40}) {
        press(Key::Escape);
        open(width, 12);
        std::string seen;
        for (int step = 0; step < 60; ++step) {
            seen += text();
            wheel(MouseEvent::Action::WheelDown);
        }
        for (const char* word : {"below", "pane", "allowed", "quit", "else"})
            EXPECT_THAT(seen, HasSubstr(word)) << width;
    }
}

TEST_F(HelpViewTest, EveryKeyIsReachedInEveryWindow)
{
    for (const int height : {1, 2, 4, 5, 12}) {
        open(70, height);
        std::string seen;
        for (int step = 0; step < 40; ++step) {
            seen += text();
            wheel(MouseEvent::Action::WheelDown);
        }
        for (const char* key : {"Keys", "Up Down", "Home End", "Control-L", "quit", "Spectrel 0."})
            EXPECT_THAT(seen, HasSubstr(key)) << height;
        press(Key::Escape);
    }
}

TEST_F(HelpViewTest, ARecordingsKeysAreListedOnlyWhereOneIsPlayed)
{
    open(60, 30);
    EXPECT_THAT(text(), Not(HasSubstr("play, pause")));
    press(Key::Escape);
    app.reset();
    FakePlayback playback;
    playing = &playback;
    open(60, 30);
    EXPECT_THAT(text(), HasSubstr("play, pause"));
    app.reset();
}

TEST_F(HelpViewTest, AWheelClosesNothingAndAPressDoes)
{
    open(60, 24);
    wheel(MouseEvent::Action::WheelDown);
    EXPECT_THAT(text(), HasSubstr("Keys"));
    click(1, 1);
    EXPECT_THAT(text(), Not(HasSubstr("Keys")));
    EXPECT_EQ(openPaths(), "/ ");
}

} // namespace
} // namespace spectrel
