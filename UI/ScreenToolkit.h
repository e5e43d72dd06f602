#pragma once

#include "Values/Result.h"

#include <functional>
#include <string>
#include <string_view>

namespace spectrel {

class SpectrelApp;

/// Lengths are in points (pt), the device's unit of layout; x grows to the right, y downwards.
struct Size {
    double width = 0;
    double height = 0;
    friend bool operator==(const Size&, const Size&) = default;
};

struct Rect {
    double x = 0;
    double y = 0;
    double width = 0;
    double height = 0;
    friend bool operator==(const Rect&, const Rect&) = default;
};

enum class FontWeight { Regular, Bold };

struct Font {
    double points = 0;
    FontWeight weight = FontWeight::Regular;
    std::string family = {}; // empty: the system font
    friend bool operator==(const Font&, const Font&) = default;
};

enum class Animation { None, Animated };

/// One item of a toolbar, left to right.
struct ToolbarItem {
    enum class Kind {
        LoadingIndicator, // hidden unless `isSpinning`
        Label, // sized to its text
        FlexibleSpace,
        SaveButton, // the platform's standard one
    };
    Kind kind = Kind::FlexibleSpace;
    std::string text = {}; // of a label
    Font font = {}; // of a label; its background is clear, its colour the dark text colour
    bool isSpinning = false; // of a loading indicator
    std::function<void()> action = {}; // of a button
};

/// A message above everything else, with one button that only closes it.
struct Alert {
    std::string title;
    std::string message;
    std::string button;
};

/// What of the screen has changed; whoever draws reads the new state from the controllers.
enum class ScreenPart {
    Window, // shown or hidden
    Navigation, // the stack of panes
    Title, // of a pane
    Rows, // of a table
    Toolbar, // of a pane
    Modal, // a modal screen was presented or dismissed
    Text, // of a text field, or which one has the input focus
    Find, // the search was opened or closed, or its text, list or selection has changed
    Playback, // the place on a recording's time line, or how it moves
    Notice, // a short message for people came or went
};

/// The toolkit that draws the controllers: measures texts, shows alerts, and hears what to draw again.
///
/// The controllers hold the state of the screens as plain properties and decide everything; a toolkit draws them and
/// hands the user's taps and keys back.
class ScreenToolkit {
public:
    virtual ~ScreenToolkit() = default;

    /// The application whose controllers are drawn; null where there is none. The application itself sets it.
    void setApplication(SpectrelApp* application)
    {
        _application = application;
    }
    SpectrelApp* application() const
    {
        return _application;
    }

    /// The room that one line of text takes. Any bytes may come: what is no UTF-8 is measured as it will be drawn.
    virtual Size sizeOfText(std::string_view text, const Font& font) const = 0;
    /// The bounds of the main screen.
    virtual Size mainScreenSize() const = 0;
    virtual void screenDidChange(ScreenPart part, Animation animation) = 0;
    virtual void showAlert(const Alert& alert) = 0;
    /// Puts the text on the clipboard.
    virtual Outcome copyToClipboard(const std::string& text) = 0;

private:
    SpectrelApp* _application = nullptr;
};

} // namespace spectrel
