#pragma once

#include <optional>
#include <string_view>
#include <vector>

namespace spectrel {

/// What a key does where a pane is in sight.
enum class KeyAction {
    RowUp,
    RowDown,
    PageUp,
    PageDown,
    FirstRow,
    LastRow,
    Open, // the row's pane
    Forward, // opens the row's pane, or scrolls its value
    Back,
    Backward, // scrolls the row's value back, or goes back
    ScrollRight,
    ScrollLeft,
    Find,
    FindNext,
    FindPrevious,
    Copy, // the row where the keyboard is, or the whole pane where it is not in use
    CopyRow,
    CopyPane,
    Save,
    Redraw,
    Help,
    Quit,
    PlayOrPause,
    NextMessage,
    PreviousMessage,
    NextTick,
    PreviousTick,
    SeekForward,
    SeekBackward,
    SeekToTenth, // the key is the digit
    SeekToEnd,
    Faster,
    Slower,
};

/// The keys of one action. A front end names a key by its character or as "Up", "PgUp", "Space", "Ctrl+F"; in the
/// window, the toolkit's names.
struct KeyBinding {
    KeyAction action;
    std::string_view terminal; // names, a blank between two; may be empty
    std::string_view window;
};

/// One line of the list of the keys.
struct KeyLine {
    std::string_view keys; // the terminal's, as its help shows them
    std::string_view help;
    std::vector<KeyBinding> bindings;
};

/// Where a key is bound.
enum class KeyScope { Browsing, Playing };
/// Who takes it.
enum class KeyTaker { Terminal, Window };

/// The keys of every pane, or those of a recording's time line, in the order of the help.
const std::vector<KeyLine>& keyTable(KeyScope scope);

/// The names in a list of a binding.
std::vector<std::string_view> keysIn(std::string_view list);

/// None when the key is not bound.
std::optional<KeyAction> actionOf(std::string_view key, KeyTaker taker, KeyScope scope);
/// The window's keys for the action.
std::vector<std::string_view> windowKeys(KeyAction action);

} // namespace spectrel
