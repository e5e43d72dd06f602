#include "UI/Quick/FindModel.h"

#include "UI/FindController.h"
#include "UI/Quick/QuickText.h"
#include "UI/SpectrelApp.h"

namespace spectrel {

FindModel::FindModel(const ScreenToolkit& toolkit)
    : _toolkit(toolkit)
{
}

FindController* FindModel::controller() const
{
    const SpectrelApp* app = _toolkit.application();
    return app ? app->find() : nullptr;
}

int FindModel::rowCount(const QModelIndex& parent) const
{
    return parent.isValid() ? 0 : _count;
}

QHash<int, QByteArray> FindModel::roleNames() const
{
    return {{NameRole, "name"}, {ValueRole, "value"}, {IsInnerRole, "isInner"}, {PanePathRole, "panePath"}};
}

QVariant FindModel::data(const QModelIndex& index, int role) const
{
    const FindController* find = controller();
    const auto row = static_cast<std::size_t>(index.row());
    if (!index.isValid() || !find || row >= find->finds().size())
        return {};
    const Find& found = find->finds()[row];
    switch (role) {
    case NameRole:
        return shownText(found.name);
    case ValueRole:
        return shownText(found.value);
    case IsInnerRole:
        return !found.isLeaf;
    case PanePathRole:
        return shownText(found.panePath);
    default:
        return {};
    }
}

bool FindModel::isOpen() const
{
    return controller() && controller()->isOpen();
}

QString FindModel::countText() const
{
    return controller() ? shownText(controller()->countText()) : QString();
}

int FindModel::selected() const
{
    const auto selected = controller() ? controller()->selected() : std::nullopt;
    return selected ? static_cast<int>(*selected) : -1;
}

void FindModel::open()
{
    if (controller())
        controller()->open();
}

void FindModel::close()
{
    if (controller())
        controller()->close();
}

void FindModel::edit(const QString& text)
{
    if (controller())
        controller()->setText(text.toStdString());
}

void FindModel::moveSelection(int by)
{
    if (controller())
        controller()->moveSelection(by);
}

void FindModel::choose()
{
    if (controller())
        controller()->choose();
}

void FindModel::tap(int index)
{
    if (!controller())
        return;
    controller()->select(static_cast<std::size_t>(index));
    controller()->choose();
}

void FindModel::chooseNext()
{
    if (controller())
        controller()->chooseNext();
}

void FindModel::choosePrevious()
{
    if (controller())
        controller()->choosePrevious();
}

/// Rows change in place; only their number grows or shrinks at the end.
void FindModel::findsDidChange()
{
    const int count = controller() ? static_cast<int>(controller()->finds().size()) : 0;
    if (count > _count) {
        beginInsertRows({}, _count, count - 1);
        _count = count;
        endInsertRows();
    } else if (count < _count) {
        beginRemoveRows({}, count, _count - 1);
        _count = count;
        endRemoveRows();
    }
    if (_count > 0)
        emit dataChanged(index(0), index(_count - 1));
    emit changed();
}

} // namespace spectrel
