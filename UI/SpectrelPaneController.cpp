#include "UI/SpectrelPaneController.h"

#include "UI/NavigationController.h"
#include "UI/SpectrelCell.h"

#include <memory>
#include <utility>

namespace spectrel {

const Font SpectrelPaneController::StatusFont {14};

SpectrelPaneController::SpectrelPaneController(
    Application& application, ScreenToolkit& toolkit, NodeRef node, std::string path)
    : _application(application)
    , _toolkit(toolkit)
    , _nodes(std::move(node))
    , _keyPath(std::move(path))
    , _tableView(toolkit, *this)
{
}

void SpectrelPaneController::setStatus(std::optional<std::string> text, bool isLoading)
{
    _status = std::move(text).value_or("");
    _isLoading = isLoading;
    createToolbarItems();
}

void SpectrelPaneController::reloadWithNode(NodeRef node)
{
    _nodes = std::move(node);
    setTitle();
    _tableView.reloadData();
    createToolbarItems();
}

void SpectrelPaneController::createToolbarItems()
{
    using Item = ToolbarItem::Kind;
    _lostReason = _application.lostReason();
    _canSave = _application.allowSaveButton();
    _toolbarItems.clear();
    _toolbarItems.push_back({.kind = Item::LoadingIndicator, .isSpinning = _isLoading});
    _toolbarItems.push_back({.kind = Item::Label, .text = _status, .font = StatusFont});
    if (!_lostReason.empty())
        _toolbarItems.push_back({.kind = Item::Label, .text = _lostReason, .font = StatusFont});
    _toolbarItems.push_back({.kind = Item::FlexibleSpace});
    if (_canSave)
        _toolbarItems.push_back({.kind = Item::SaveButton, .action = [this] { pressSaveButton(); }});
    _toolkit.screenDidChange(ScreenPart::Toolbar, Animation::Animated);
}

void SpectrelPaneController::pressSaveButton()
{
    if (_canSave)
        _application.showSaveView();
}

void SpectrelPaneController::setTitle()
{
    _title = _nodes ? _nodes->displayName() : "Spectrel";
    _toolkit.screenDidChange(ScreenPart::Title, Animation::None);
}

void SpectrelPaneController::viewWillAppear()
{
    setTitle();
    if (_navigationController)
        _navigationController->setToolbarHidden(false);
    createToolbarItems();
    _tableView.deselectRow(Animation::Animated); // the row that opened the pane above is plain again
    _isFirstResponder = true;
}

void SpectrelPaneController::viewWillDisappear()
{
    _isFirstResponder = false;
}

std::size_t SpectrelPaneController::numberOfRows() const
{
    const NodeList* children = _nodes ? _nodes->childNodes() : nullptr;
    return children ? children->size() : 0;
}

NodeRef SpectrelPaneController::childAtRow(std::size_t row) const
{
    return row < numberOfRows() ? (*_nodes->childNodes())[row] : nullptr;
}

SpectrelCell* SpectrelPaneController::cellAtRow(std::size_t row) const
{
    // Every cell of this table was made by cellForRow.
    return static_cast<SpectrelCell*>(_tableView.cellAtRow(row).get());
}

CellRef SpectrelPaneController::cellForRow(TableView& table, std::size_t row)
{
    const NodeRef child = childAtRow(row);
    auto cell = std::static_pointer_cast<SpectrelCell>(table.dequeueReusableCell(CellIdentifier));
    if (child->childNodes()) {
        if (!cell)
            cell = SpectrelCell::initWithStyleKey(_toolkit, CellStyle::Default, std::string(CellIdentifier));
        cell->key.text = child->displayName();
        cell->accessory = CellAccessory::DisclosureIndicator;
        if (cell->value)
            cell->value->text.clear();
    } else {
        if (!cell)
            cell = SpectrelCell::initWithStyle(_toolkit, CellStyle::Default, std::string(CellIdentifier));
        cell->key.text = child->displayName();
        cell->accessory = CellAccessory::None;
        // A row made for an inner node has no value label; the value stays blank, and that is meant to be so.
        if (cell->value && child->value())
            cell->value->text = *child->value();
    }
    cell->bounds = table.rowBounds();
    layOutCell(*cell, row);
    return cell;
}

void SpectrelPaneController::layOutCell(TableCell& cell, std::size_t row)
{
    auto& rowCell = static_cast<SpectrelCell&>(cell);
    if (childAtRow(row)->childNodes())
        rowCell.setLayoutKey();
    else
        rowCell.setLayout();
}

void SpectrelPaneController::didSelectRow(std::optional<std::size_t> row)
{
    if (!row)
        return;
    if (childAtRow(*row)->childNodes())
        openRow(*row, Animation::Animated);
    else
        _tableView.deselectRow(Animation::None);
}

void SpectrelPaneController::openRow(std::size_t row, Animation animation)
{
    const NodeRef child = childAtRow(row);
    if (!child || !child->childNodes())
        return;
    auto pane = std::make_shared<SpectrelPaneController>(
        _application, _toolkit, child, pathByAppending(_keyPath, child->displayName()));
    pane->setStatus(_status, _isLoading);
    if (_navigationController)
        _navigationController->pushViewController(std::move(pane), animation);
}

} // namespace spectrel
