#include "UI/FindController.h"

#include "UI/SpectrelPaneController.h"

#include <algorithm>
#include <utility>

namespace spectrel {

namespace {

/// Lower case of ASCII, whatever the locale.
char folded(char character)
{
    return character >= 'A' && character <= 'Z' ? static_cast<char>(character - 'A' + 'a') : character;
}

std::string folded(std::string_view text)
{
    std::string lower(text);
    std::ranges::transform(lower, lower.begin(), [](char character) { return folded(character); });
    return lower;
}

bool contains(std::string_view text, std::string_view foldedPart)
{
    return std::search(text.begin(), text.end(), foldedPart.begin(), foldedPart.end(), [](char left, char right) {
        return folded(left) == right;
    }) != text.end();
}

bool isSameRow(const Find& left, const Find& right)
{
    return left.name == right.name && left.panePath == right.panePath;
}

} // namespace

void FindController::open()
{
    if (std::exchange(_isOpen, true))
        return;
    _scopePath = _navigation.topViewController()->path();
    setText({});
}

void FindController::close()
{
    if (std::exchange(_isOpen, false))
        changed();
}

void FindController::setText(std::string text)
{
    _text = std::move(text);
    _folded = folded(_text);
    _finds.clear();
    _selected = 0;
    search();
    changed();
}

std::string FindController::countText() const
{
    if (_text.empty())
        return {};
    if (_finds.empty())
        return "nothing found";
    return std::to_string(_finds.size()) + (_isCut ? " and more found" : " found");
}

// ---- The search

/// The place on the stack of the pane in which the search began; none when it was closed.
std::optional<std::size_t> FindController::scopeIndex() const
{
    const auto& panes = _navigation.viewControllers();
    for (std::size_t index = 0; index < panes.size(); ++index) {
        if (panes[index]->path() == _scopePath)
            return index;
    }
    return std::nullopt;
}

/// Lists the finds anew; the selection stays with its row, or near it when the row is no longer found.
void FindController::search()
{
    const auto before = selected() ? std::optional(_finds[_selected]) : std::nullopt;
    _finds.clear();
    _isCut = false;
    const auto scope = scopeIndex();
    const NodeRef node = scope ? _navigation.viewControllers()[*scope]->node() : nullptr;
    if (!_text.empty() && node) {
        std::vector<std::size_t> rows;
        collect(*node, _scopePath, rows);
    }
    if (!before)
        return;
    const auto same = std::ranges::find_if(_finds, [&](const Find& find) { return isSameRow(find, *before); });
    if (same != _finds.end())
        _selected = static_cast<std::size_t>(same - _finds.begin());
    else
        _selected = std::min(_selected, _finds.empty() ? 0 : _finds.size() - 1);
}

void FindController::collect(const SpectrelModelNode& node, const std::string& panePath, std::vector<std::size_t>& rows)
{
    const NodeList* children = node.childNodes();
    for (std::size_t row = 0; children && row < children->size() && !_isCut; ++row) {
        const SpectrelModelNode& child = *(*children)[row];
        const std::string value = child.value() ? *child.value() : std::string();
        rows.push_back(row);
        if (contains(child.displayName(), _folded) || contains(value, _folded)) {
            _isCut = _finds.size() == MaximumFinds;
            if (!_isCut)
                _finds.push_back({child.displayName(), value, child.childNodes() == nullptr, panePath, rows});
        }
        if (child.childNodes())
            collect(child, pathByAppending(panePath, child.displayName()), rows);
        rows.pop_back();
    }
}

void FindController::treeDidReload()
{
    if (!_isOpen)
        return;
    if (!scopeIndex()) // the pane has gone with its path: what is in sight now is searched
        _scopePath = _navigation.topViewController()->path();
    search();
    changed();
}

// ---- The selection

std::optional<std::size_t> FindController::selected() const
{
    return _selected < _finds.size() ? std::optional(_selected) : std::nullopt;
}

void FindController::select(std::size_t index)
{
    if (index >= _finds.size())
        return;
    _selected = index;
    changed();
}

void FindController::moveSelection(std::ptrdiff_t by)
{
    const auto last = static_cast<std::ptrdiff_t>(_finds.size()) - 1;
    const auto moved =
        std::clamp<std::ptrdiff_t>(static_cast<std::ptrdiff_t>(_selected) + by, 0, std::max<std::ptrdiff_t>(last, 0));
    select(static_cast<std::size_t>(moved));
}

bool FindController::choose()
{
    if (!selected())
        return false;
    close();
    show(_finds[_selected]);
    return true;
}

bool FindController::chooseNext()
{
    return chooseBeside(1);
}

bool FindController::choosePrevious()
{
    return chooseBeside(-1);
}

bool FindController::chooseBeside(std::ptrdiff_t by)
{
    if (_isOpen || _text.empty())
        return false;
    search(); // the tree may have been read anew since
    if (_finds.empty())
        return false;
    const auto count = static_cast<std::ptrdiff_t>(_finds.size());
    _selected = static_cast<std::size_t>((static_cast<std::ptrdiff_t>(_selected) + by + count) % count);
    show(_finds[_selected]);
    return true;
}

/// Closes the panes that do not lead to the row and opens those that are missing.
void FindController::show(const Find& find)
{
    const auto scope = scopeIndex();
    if (!scope)
        return;
    const Find target = find; // opening panes may reload the list
    std::size_t open = 0; // panes on the way that are open already, the first one not counted
    std::string path = _scopePath;
    const auto& panes = _navigation.viewControllers();
    for (; open + 1 < target.rows.size() && *scope + open + 1 < panes.size(); ++open) {
        const NodeRef child = panes[*scope + open]->childAtRow(target.rows[open]);
        if (!child || panes[*scope + open + 1]->path() != pathByAppending(path, child->displayName()))
            break;
        path = panes[*scope + open + 1]->path();
    }
    _navigation.popToViewControllerAtIndex(*scope + open, Animation::Animated);
    for (; open + 1 < target.rows.size(); ++open) {
        const bool isLast = open + 2 == target.rows.size();
        _navigation.topViewController()->openRow(target.rows[open], isLast ? Animation::Animated : Animation::None);
    }
    _navigation.topViewController()->tableView().showRow(target.rows.back());
}

void FindController::changed()
{
    _toolkit.screenDidChange(ScreenPart::Find, Animation::None);
}

} // namespace spectrel
