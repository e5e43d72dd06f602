#include "UI/Quick/SaveModel.h"

#include "UI/Quick/QuickText.h"
#include "UI/SpectrelSaveViewController.h"

namespace spectrel {

SaveModel::SaveModel(SpectrelSaveViewController& controller, QObject* parent)
    : QAbstractListModel(parent)
    , _controller(&controller)
{
    // The table is as high as its rows: all of them are in sight.
    TableView& table = *controller.saveContentTable();
    const std::size_t rows = controller.numberOfRows();
    table.setVisibleRows(0, rows, {0, 0, controller.frame().width, SpectrelSaveViewController::RowHeight});
    for (std::size_t row = 0; row < rows; ++row) {
        const CellRef cell = table.cellAtRow(row);
        _rows.push_back({shownText(cell->textLabel.text), cell->accessory == CellAccessory::Checkmark});
    }
}

int SaveModel::rowCount(const QModelIndex& parent) const
{
    return parent.isValid() ? 0 : static_cast<int>(_rows.size());
}

QVariant SaveModel::data(const QModelIndex& index, int role) const
{
    if (!index.isValid())
        return {};
    const Row& row = _rows[static_cast<std::size_t>(index.row())];
    return role == TextRole ? QVariant(row.text) : QVariant(row.isChecked);
}

QHash<int, QByteArray> SaveModel::roleNames() const
{
    return {{TextRole, "entryText"}, {IsCheckedRole, "isChecked"}};
}

void SaveModel::save()
{
    if (_controller)
        _controller->savePressed();
}

void SaveModel::cancel()
{
    if (_controller)
        _controller->cancelPressed();
}

void SaveModel::touchBackground()
{
    if (_controller)
        _controller->backgroundTouched();
}

void SaveModel::tap(int row)
{
    if (_controller)
        _controller->saveContentTable()->selectRow(static_cast<std::size_t>(row));
}

void SaveModel::pressReturn()
{
    if (_controller)
        _controller->textFieldShouldReturn(*_controller->saveDescription());
}

void SaveModel::beginEditing()
{
    if (_controller && !_controller->saveDescription()->isFirstResponder)
        _controller->beginEditing();
}

void SaveModel::edit(const QString& text)
{
    if (_controller)
        _controller->setDescriptionText(text.toStdString());
}

void SaveModel::textDidChange()
{
    if (!_controller)
        return;
    _description = QString::fromStdString(_controller->saveDescription()->text.value_or(""));
    _isEditing = _controller->saveDescription()->isFirstResponder;
    emit textChanged();
}

void SaveModel::didLeave()
{
    deleteLater();
}

} // namespace spectrel
