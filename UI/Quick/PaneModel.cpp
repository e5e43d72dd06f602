#include "UI/Quick/PaneModel.h"

#include "UI/NavigationController.h"
#include "UI/Quick/QuickText.h"
#include "UI/SpectrelCell.h"

#include <algorithm>
#include <utility>

namespace spectrel {

namespace {

int childCount(const NodeRef& node)
{
    const NodeList* children = node ? node->childNodes() : nullptr;
    return children ? static_cast<int>(children->size()) : 0;
}

bool isSameRow(const NodeRef& one, const NodeRef& other)
{
    return one->displayName() == other->displayName() && !one->childNodes() == !other->childNodes();
}

/// How many rows are the same at the beginning of both nodes, and how many of the others at their end.
std::pair<int, int> sameRows(const NodeRef& before, const NodeRef& after)
{
    const int shorter = std::min(childCount(before), childCount(after));
    if (shorter == 0)
        return {0, 0};
    const NodeList& olds = *before->childNodes();
    const NodeList& news = *after->childNodes();
    const auto first = std::mismatch(olds.begin(), olds.begin() + shorter, news.begin(), isSameRow).first;
    const auto atStart = static_cast<int>(first - olds.begin());
    const auto last = std::mismatch(olds.rbegin(), olds.rbegin() + (shorter - atStart), news.rbegin(), isSameRow).first;
    return {atStart, static_cast<int>(last - olds.rbegin())};
}

} // namespace

PaneModel::PaneModel(std::shared_ptr<SpectrelPaneController> pane, bool isRoot, QObject* parent)
    : QAbstractListModel(parent)
    , _pane(std::move(pane))
    , _isRoot(isRoot)
    , _node(_pane->node())
    , _count(childCount(_node))
{
}

// ---- Rows

int PaneModel::rowCount(const QModelIndex& parent) const
{
    return parent.isValid() ? 0 : _count;
}

QHash<int, QByteArray> PaneModel::roleNames() const
{
    return {{NameRole, "name"}, {ValueRole, "value"}, {IsInnerRole, "isInner"}, {NameFrameRole, "nameFrame"},
        {ValueFrameRole, "valueFrame"}, {ContentWidthRole, "rowContentWidth"}, {ContentOffsetRole, "rowContentOffset"}};
}

QVariant PaneModel::data(const QModelIndex& index, int role) const
{
    if (!index.isValid())
        return {};
    const auto row = static_cast<std::size_t>(index.row());
    const SpectrelCell* cell = _pane->cellAtRow(row);
    return cell ? cellData(*cell, role) : nodeData(row, role);
}

QVariant PaneModel::cellData(const SpectrelCell& cell, int role) const
{
    const bool isInner = cell.accessory == CellAccessory::DisclosureIndicator;
    const bool hasValue = !isInner && cell.value;
    switch (role) {
    case NameRole:
        return shownText(cell.key.text);
    case ValueRole:
        return hasValue ? shownText(cell.value->text) : QString();
    case IsInnerRole:
        return isInner;
    case NameFrameRole:
        return shownRect(cell.key.frame);
    case ValueFrameRole:
        return hasValue ? shownRect(cell.value->frame) : QRectF();
    case ContentWidthRole:
        return hasValue && cell.view ? cell.view->contentSize.width : cell.contentBounds.width;
    case ContentOffsetRole:
        return cell.view ? cell.view->contentOffset : 0.0;
    default:
        return {};
    }
}

/// What can be said of a row that is not in sight yet: it has no cell, and so no place for its labels.
QVariant PaneModel::nodeData(std::size_t row, int role) const
{
    const NodeRef child = _pane->childAtRow(row);
    switch (role) {
    case NameRole:
        return child ? shownText(child->displayName()) : QString();
    case ValueRole:
        return QString();
    case IsInnerRole:
        return child && child->childNodes();
    case NameFrameRole:
    case ValueFrameRole:
        return QRectF();
    default:
        return 0.0;
    }
}

void PaneModel::emitChanged(int first, int end)
{
    first = std::max(first, 0);
    end = std::min(end, _count);
    if (first < end)
        emit dataChanged(index(first), index(end - 1));
}

void PaneModel::setVisibleRows(int first, int count, double width)
{
    first = std::max(first, 0);
    count = std::max(count, 0);
    TableView& table = _pane->tableView();
    const bool hasNewWidth = table.rowBounds().width != width;
    table.setVisibleRows(static_cast<std::size_t>(first), static_cast<std::size_t>(count),
        {0, 0, width, SpectrelCell::ScrollViewHeight});
    const int end = first + count;
    const int oldFirst = std::exchange(_firstVisible, first);
    const int oldEnd = std::exchange(_endVisible, end);
    if (hasNewWidth || first >= oldEnd || end <= oldFirst) {
        emitChanged(first, end);
    } else {
        emitChanged(first, oldFirst);
        emitChanged(oldEnd, end);
    }
}

void PaneModel::rowsDidChange()
{
    if (_pane->node() != _node)
        adoptNode();
    adoptSelection();
    emit rowToShowChanged();
}

void PaneModel::adoptSelection()
{
    const auto selected = _pane->tableView().selectedRow();
    const int row = selected ? static_cast<int>(*selected) : -1;
    if (std::exchange(_selectedRow, row) != row)
        emit selectedRowChanged();
}

int PaneModel::takeRowToShow()
{
    const auto row = _pane->tableView().takeRowToShow();
    return row ? static_cast<int>(*row) : -1;
}

void PaneModel::adoptNode()
{
    const NodeRef old = std::exchange(_node, _pane->node());
    const auto [atStart, atEnd] = sameRows(old, _node);
    const int goneRows = _count - atStart - atEnd;
    const int newRows = childCount(_node) - atStart - atEnd;
    if (goneRows > 0) {
        beginRemoveRows({}, atStart, atStart + goneRows - 1);
        _count -= goneRows;
        endRemoveRows();
    }
    if (newRows > 0) {
        beginInsertRows({}, atStart, atStart + newRows - 1);
        _count += newRows;
        endInsertRows();
    }
    emitChanged(0, _count);
}

// ---- Title and toolbar

QString PaneModel::title() const
{
    return shownText(_pane->title());
}

QString PaneModel::path() const
{
    return shownText(_pane->path());
}

bool PaneModel::isLoading() const
{
    return _pane->isLoading();
}

QString PaneModel::status() const
{
    return shownText(_pane->status());
}

QString PaneModel::reason() const
{
    return shownText(_pane->lostReason());
}

bool PaneModel::canSave() const
{
    return _pane->canSave();
}

void PaneModel::titleDidChange()
{
    emit titleChanged();
}

void PaneModel::toolbarDidChange()
{
    emit toolbarChanged();
}

// ---- Input

/// A page that slides away is still there for a moment, but nothing on it can be pressed.
bool PaneModel::isTop() const
{
    const NavigationController* navigation = _pane->navigationController();
    return navigation && navigation->topViewController() == _pane;
}

void PaneModel::tap(int row)
{
    if (!isTop() || row < 0)
        return;
    _pane->tableView().selectRow(static_cast<std::size_t>(row));
    adoptSelection();
}

void PaneModel::goBack()
{
    if (isTop())
        _pane->navigationController()->popViewController(Animation::Animated);
}

void PaneModel::didScrollSideways(int row, double offset)
{
    SpectrelCell* cell = row < 0 ? nullptr : _pane->cellAtRow(static_cast<std::size_t>(row));
    if (cell && cell->view)
        cell->view->scrollBy(offset - cell->view->contentOffset);
}

bool PaneModel::scrollSideways(int row, double by)
{
    SpectrelCell* cell = row < 0 ? nullptr : _pane->cellAtRow(static_cast<std::size_t>(row));
    if (!cell || !cell->view || cell->accessory != CellAccessory::None || !cell->view->scrollBy(by))
        return false;
    emit dataChanged(index(row), index(row), {ContentOffsetRole});
    return true;
}

void PaneModel::pressSaveButton()
{
    if (isTop())
        _pane->pressSaveButton();
}

void PaneModel::didLeave()
{
    deleteLater();
}

} // namespace spectrel
