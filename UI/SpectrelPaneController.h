#pragma once

#include "Monitor/SpectrelModelNode.h"
#include "UI/Application.h"
#include "UI/ScreenToolkit.h"
#include "UI/TableView.h"

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

class NavigationController;
class SpectrelCell;

/// One pane: the children of one node as rows, in the node's order.
class SpectrelPaneController final : public TableSource {
public:
    static constexpr std::string_view CellIdentifier = "SpectrelPaneControllerCell";
    static const Font StatusFont;

    /// `node` may be null: the first tree may not exist yet.
    SpectrelPaneController(Application& application, ScreenToolkit& toolkit, NodeRef node, std::string path);
    ~SpectrelPaneController() override = default;
    SpectrelPaneController(const SpectrelPaneController&) = delete;
    SpectrelPaneController& operator=(const SpectrelPaneController&) = delete;

    const std::string& path() const
    {
        return _keyPath;
    }
    const NodeRef& node() const
    {
        return _nodes;
    }
    const std::string& status() const
    {
        return _status;
    }
    bool isLoading() const
    {
        return _isLoading;
    }
    /// Why there is no session; empty where nothing is known. As of the latest change of the toolbar, as is `canSave`.
    const std::string& lostReason() const
    {
        return _lostReason;
    }
    bool canSave() const
    {
        return _canSave;
    }
    const std::string& title() const
    {
        return _title;
    }
    const std::vector<ToolbarItem>& toolbarItems() const
    {
        return _toolbarItems;
    }

    /// Keeps the text ("" when none) and the flag and rebuilds the toolbar.
    void setStatus(std::optional<std::string> text, bool isLoading);
    /// Shows the children of another node; the rows are filled anew.
    void reloadWithNode(NodeRef node);
    /// Left to right: loading indicator, status, why there is no session when that is known, flexible space, and the
    /// save button where saving is allowed.
    void createToolbarItems();
    /// Opens the save screen where saving is allowed.
    void pressSaveButton();

    void viewWillAppear();
    void viewWillDisappear();
    bool isFirstResponder() const
    {
        return _isFirstResponder;
    }
    /// The stack that the pane is on; null when it is on none.
    NavigationController* navigationController() const
    {
        return _navigationController;
    }
    void setNavigationController(NavigationController* navigationController)
    {
        _navigationController = navigationController;
    }

    TableView& tableView()
    {
        return _tableView;
    }
    std::size_t numberOfRows() const override;
    /// Opens the pane of the inner node at the row; nothing where there is none.
    void openRow(std::size_t row, Animation animation);
    /// The child shown at the row; null when there is no such row.
    NodeRef childAtRow(std::size_t row) const;
    /// The cell of a row in sight; null for any other row.
    SpectrelCell* cellAtRow(std::size_t row) const;

private:
    CellRef cellForRow(TableView& table, std::size_t row) override;
    void layOutCell(TableCell& cell, std::size_t row) override;
    void didSelectRow(std::optional<std::size_t> row) override;
    void setTitle();

    Application& _application;
    ScreenToolkit& _toolkit;
    NodeRef _nodes;
    std::string _keyPath;
    std::string _status;
    bool _isLoading = true;
    std::string _lostReason;
    bool _canSave = false;
    std::string _title;
    std::vector<ToolbarItem> _toolbarItems;
    TableView _tableView;
    NavigationController* _navigationController = nullptr;
    bool _isFirstResponder = false;
};

} // namespace spectrel
