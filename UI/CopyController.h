#pragma once

#include "UI/ScreenToolkit.h"

#include <cstddef>
#include <string>

namespace spectrel {

class SpectrelPaneController;

/// Copies what is shown to the clipboard, in the text form of `decode --format tree`.
///
/// `message` says what became of it; the toolkit hears of its changes as `ScreenPart::Notice`.
class CopyController {
public:
    explicit CopyController(ScreenToolkit& toolkit)
        : _toolkit(toolkit)
    {
    }

    /// The value of a leaf's row, the name and all below it of any other; nothing when there is no such row.
    void copyRow(const SpectrelPaneController& pane, std::size_t row);
    /// Every row of the pane with all below it.
    void copyPane(const SpectrelPaneController& pane);

    /// What became of the latest copy, for people; empty once the front end has shown it long enough.
    const std::string& message() const
    {
        return _message;
    }
    void clearMessage();

private:
    void copy(const std::string& text, const std::string& what);

    ScreenToolkit& _toolkit;
    std::string _message;
};

} // namespace spectrel
