#pragma once

#include "UI/KeyTable.h"
#include "UI/NavigationController.h"
#include "UI/SpectrelPaneController.h"
#include "UI/Terminal/Grid.h"
#include "UI/Terminal/TerminalInput.h"

#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// The row layout's arithmetic on a terminal: a column is 10 pt wide, a line 20 pt high.
struct TerminalMetrics {
    static constexpr double Column = 10; // pt
    static constexpr double Line = 20; // pt
    static int columns(double points)
    {
        return static_cast<int>(points / Column);
    }
};

/// One pane on the terminal: draws its controller and keeps what only the eye needs, the cursor and how far the rows
/// are scrolled. Both stay through reloads; the cursor follows its row's name.
class PaneView {
public:
    explicit PaneView(const std::shared_ptr<SpectrelPaneController>& pane)
        : _pane(pane)
    {
    }
    bool shows(const std::shared_ptr<SpectrelPaneController>& pane) const
    {
        return _pane.lock() == pane;
    }

    /// What a drawing takes from around the pane.
    struct Surroundings {
        int height = 0; // the first lines of the screen are the pane's
        bool isRoot = false;
        char spinner = ' ';
        std::string_view notice; // behind the status; may be empty
    };
    void draw(Grid& grid, const Surroundings& around);
    /// The row under the cursor; absent in an empty pane.
    std::optional<std::size_t> cursorRow(int height);
    /// `height` is as in `Surroundings`.
    void perform(KeyAction action, int height, NavigationController& navigation);
    void handle(const MouseEvent& event, int height, NavigationController& navigation);

private:
    /// Which lines hold what: title and toolbar give way on the smallest screens.
    struct Layout {
        explicit Layout(int height)
            : hasTitle(height >= 2)
            , hasToolbar(height >= 3)
            , rows(height - (hasTitle ? 1 : 0) - (hasToolbar ? 1 : 0))
        {
        }
        int firstRow() const
        {
            return hasTitle ? 1 : 0;
        }
        bool hasTitle;
        bool hasToolbar;
        int rows;
    };

    void settle(SpectrelPaneController& pane, int rows);
    void follow(SpectrelPaneController& pane);
    void moveTo(SpectrelPaneController& pane, std::size_t row, int rows);
    void move(SpectrelPaneController& pane, std::ptrdiff_t by, int rows);
    void scroll(SpectrelPaneController& pane, std::ptrdiff_t by, int rows);
    void performSideways(KeyAction action, SpectrelPaneController& pane, NavigationController& navigation) const;
    bool scrollSideways(SpectrelPaneController& pane, double columns) const;
    void drawTitle(Grid& grid, const SpectrelPaneController& pane, bool isRoot) const;
    void drawRow(Grid& grid, int y, const SpectrelCell& cell) const;
    void drawToolbar(Grid& grid, const SpectrelPaneController& pane, const Surroundings& around);

    std::weak_ptr<SpectrelPaneController> _pane;
    std::size_t _cursor = 0;
    std::string _cursorName;
    std::size_t _top = 0; // the first row in sight
    Span _saveButton; // where the toolbar shows it; empty when it does not
};

} // namespace spectrel
