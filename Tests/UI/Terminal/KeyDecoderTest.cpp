#include "UI/Terminal/KeyDecoder.h"

#include <gtest/gtest.h>

#include <ncurses.h>
#include <string_view>
#include <vector>

namespace spectrel {
namespace {

class KeyDecoderTest : public testing::Test {
protected:
    void key(int code)
    {
        decoder.feed({true, static_cast<unsigned>(code)}, note);
    }
    void characters(std::u32string_view text)
    {
        for (const char32_t character : text)
            decoder.feed({false, character}, note);
    }
    void endOfInput()
    {
        decoder.flush(note);
    }
    KeyDecoder decoder;
    std::vector<KeyEvent> events;
    KeyDecoder::Handler note = [this](const KeyEvent& event) { events.push_back(event); };
};

TEST_F(KeyDecoderTest, FunctionKeysHaveNames)
{
    for (const int code : {KEY_UP, KEY_SLEFT, KEY_NPAGE, KEY_BACKSPACE, KEY_BTAB, KEY_F(5)})
        key(code);
    EXPECT_EQ(events,
        (std::vector<KeyEvent> {{Key::Up}, {Key::ShiftLeft}, {Key::PageDown}, {Key::Backspace}, {Key::BackTab}}));
}

TEST_F(KeyDecoderTest, CharactersComeAsTheyAre)
{
    characters(U"q日\r\t\x7f\x15\f\x02");
    EXPECT_EQ(events,
        (std::vector<KeyEvent> {{Key::Character, U'q'}, {Key::Character, U'日'}, {Key::Enter}, {Key::Tab},
            {Key::Backspace}, {Key::ClearLine}, {Key::Redraw}}));
}

TEST_F(KeyDecoderTest, ALineIsEditedWithTheUsualKeys)
{
    key(KEY_DC);
    characters(U"\x01\x05\x17");
    EXPECT_EQ(events, (std::vector<KeyEvent> {{Key::Delete}, {Key::Home}, {Key::End}, {Key::EraseWord}}));
}

TEST_F(KeyDecoderTest, EscapeIsAKeyWhenNothingFollows)
{
    characters(U"\x1b");
    EXPECT_TRUE(events.empty());
    endOfInput();
    endOfInput();
    EXPECT_EQ(events, (std::vector<KeyEvent> {{Key::Escape}}));
}

TEST_F(KeyDecoderTest, AnUnknownSequenceIsSwallowedWhole)
{
    characters(U"\x1b[1;7Dx\x1bOPy");
    endOfInput();
    EXPECT_EQ(events, (std::vector<KeyEvent> {{Key::Character, U'x'}, {Key::Character, U'y'}}));
}

TEST_F(KeyDecoderTest, EscapeAndAKeyAreTwoKeysHoweverFastTheyCome)
{
    characters(U"\x1bq\x1b\x1b");
    key(KEY_UP);
    endOfInput();
    EXPECT_EQ(events,
        (std::vector<KeyEvent> {{Key::Escape}, {Key::Character, U'q'}, {Key::Escape}, {Key::Escape}, {Key::Up}}));
}

TEST_F(KeyDecoderTest, TheMouseHasOneButtonAndAWheel)
{
    EXPECT_EQ(KeyDecoder::mouse(BUTTON1_PRESSED, 3, 4), (MouseEvent {MouseEvent::Action::Press, 3, 4}));
    EXPECT_EQ(KeyDecoder::mouse(BUTTON4_PRESSED, 3, 4), (MouseEvent {MouseEvent::Action::WheelUp, 3, 4}));
    EXPECT_EQ(KeyDecoder::mouse(BUTTON5_PRESSED, 3, 4), (MouseEvent {MouseEvent::Action::WheelDown, 3, 4}));
    EXPECT_EQ(KeyDecoder::mouse(BUTTON3_PRESSED, 3, 4), std::nullopt);
}

} // namespace
} // namespace spectrel
