#pragma once

#include "Monitor/SpectrelModelNode.h"
#include "UI/NavigationController.h"
#include "UI/ScreenToolkit.h"

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// One row found: where it stands and what it shows.
struct Find {
    std::string name;
    std::string value; // empty for an inner node
    bool isLeaf = true;
    std::string panePath; // of the pane that shows the row
    std::vector<std::size_t> rows; // from the pane in which the search began down to the row itself
};

/// Finds rows by name or value in the pane in sight and below it, while the user types.
///
/// A text is found whatever the case of its ASCII letters. The list follows every reload of the tree, the selection its
/// row. The toolkit hears of every change as `ScreenPart::Find`.
class FindController {
public:
    static constexpr std::size_t MaximumFinds = 1000;

    /// Both outlive this.
    FindController(ScreenToolkit& toolkit, NavigationController& navigation)
        : _toolkit(toolkit)
        , _navigation(navigation)
    {
    }

    /// Opens the search in the pane in sight, with an empty text.
    void open();
    /// Closes it and opens nothing.
    void close();
    bool isOpen() const
    {
        return _isOpen;
    }

    const std::string& text() const
    {
        return _text;
    }
    void setText(std::string text);
    /// In the order of the display, at most `MaximumFinds`; none for an empty text.
    const std::vector<Find>& finds() const
    {
        return _finds;
    }
    /// There are more finds than the list holds.
    bool isCut() const
    {
        return _isCut;
    }
    /// "3 found", "1000 and more found", "nothing found"; empty for an empty text.
    std::string countText() const;

    /// None when nothing is found.
    std::optional<std::size_t> selected() const;
    /// Nothing happens where there is no such find.
    void select(std::size_t index);
    /// By that many, staying in the list.
    void moveSelection(std::ptrdiff_t by);
    /// Closes the search, opens the panes down to the selected row and marks it there. False when nothing is found.
    bool choose();
    /// After the search was closed: opens the next find or the last one of the same text, round the end. False when
    /// there is none, or the pane in which the search began is gone.
    bool chooseNext();
    bool choosePrevious();

    /// The tree was read anew.
    void treeDidReload();

private:
    std::optional<std::size_t> scopeIndex() const;
    void search();
    void collect(const SpectrelModelNode& node, const std::string& panePath, std::vector<std::size_t>& rows);
    void show(const Find& find);
    bool chooseBeside(std::ptrdiff_t by);
    void changed();

    ScreenToolkit& _toolkit;
    NavigationController& _navigation;
    bool _isOpen = false;
    std::string _scopePath; // of the pane in which the search began
    std::string _text;
    std::string _folded; // the text in lower case
    std::vector<Find> _finds;
    bool _isCut = false;
    std::size_t _selected = 0;
};

} // namespace spectrel
