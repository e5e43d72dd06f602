#pragma once

#include "Tests/UI/AppFixture.h"
#include "UI/Terminal/TerminalScreen.h"

#include <string>
#include <string_view>
#include <utility>

namespace spectrel {

/// A launched application on a terminal screen of 40 by 7, compared as text.
class TerminalFixture : public AppFixture {
protected:
    TerminalFixture()
    {
        screen.resize(40, 7);
    }
    ~TerminalFixture() override
    {
        app.reset(); // before the screen
    }
    void start()
    {
        app = makeApp(screen);
        app->applicationDidFinishLaunching();
        loop.runQueued();
        connect();
    }
    void startAllowingSave()
    {
        root.addMarker();
        start();
    }
    std::string text()
    {
        return screen.draw().text();
    }
    std::string styles()
    {
        return screen.draw().styles();
    }
    /// One line of the screen.
    std::string line(int number)
    {
        std::string all = text();
        for (; number > 0; --number)
            all.erase(0, all.find('\n') + 1);
        return all.substr(0, all.find('\n'));
    }
    /// The number of the line that is shown reversed from its first column, below the title; -1 when none is.
    int cursorLine()
    {
        const Grid& grid = screen.draw();
        for (int y = 1; y < grid.height(); ++y) {
            if (grid.at(0, y).style.isReversed)
                return y;
        }
        return -1;
    }
    void press(Key key, int times = 1)
    {
        for (; times > 0; --times)
            screen.handle(KeyEvent {key});
    }
    void type(std::u32string_view characters)
    {
        for (const char32_t character : characters)
            screen.handle(KeyEvent {Key::Character, character});
    }
    void click(int x, int y)
    {
        screen.handle(MouseEvent {MouseEvent::Action::Press, x, y});
    }
    void wheel(MouseEvent::Action action)
    {
        screen.handle(MouseEvent {action, 1, 2});
    }
    static DictionaryRef numbered(int count)
    {
        auto dictionary = Dictionary::make();
        for (int row = 0; row < count; ++row)
            dictionary->set("Row " + std::to_string(row), std::to_string(row * 10));
        return dictionary;
    }

    int drawings = 0; // asked for
    int quits = 0;
    std::string clipboard;
    TerminalScreen screen {
        {[this] { ++drawings; }, [this] { ++quits; }, [this](const std::string& text) { clipboard = text; }}};
};

} // namespace spectrel
