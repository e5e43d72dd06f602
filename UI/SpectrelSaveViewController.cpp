#include "UI/SpectrelSaveViewController.h"

#include "Monitor/Snapshot.h"
#include "Platform/SystemLog.h"
#include "Values/Dictionary.h"

#include <utility>

namespace spectrel {

const Font SpectrelSaveViewController::CellFont {13, FontWeight::Regular, "Helvetica"};

SpectrelSaveViewController::SpectrelSaveViewController(Services services, const ListRef& saveHistory)
    : _services(std::move(services))
    , _timeStamp(_services.clock.now())
    , _saveHistory(saveHistory ? saveHistory->copy() : nullptr)
    , _saveContentTable(std::make_shared<TableView>(_services.toolkit, *this))
    , _saveDescription(std::make_shared<TextField>())
{
    viewDidLoad();
}

void SpectrelSaveViewController::viewDidLoad()
{
    // The front ends make the table as high as its rows; here it only loads them.
    _saveContentTable->reloadData();
}

void SpectrelSaveViewController::viewWillAppear()
{
    const Size screen = _services.toolkit.mainScreenSize();
    _frame = {0, 0, screen.width, screen.height};
}

void SpectrelSaveViewController::savePressed()
{
    const DictionaryRef snapshot = makeSnapshot(_timeStamp, _saveHistory, _saveDescription->text);
    const std::string path = snapshotPath(_services.directory, _services.clock.now());
    std::string reason;
    if (!_services.writeSnapshot(snapshot, path, reason)) {
        SPECTREL_LOG(_services.log, Priority::Error, "Unable to write snapshot to %s", path.c_str());
        _services.toolkit.showAlert({"File Error", "Unable to write file to disk", "Close"});
    }
    _services.application.saveViewDidFinish();
}

void SpectrelSaveViewController::cancelPressed()
{
    _services.application.saveViewDidFinish();
}

bool SpectrelSaveViewController::textFieldShouldReturn(TextField& textField)
{
    textField.isFirstResponder = false;
    _services.toolkit.screenDidChange(ScreenPart::Text, Animation::None);
    return true;
}

void SpectrelSaveViewController::backgroundTouched()
{
    resignDescription();
}

void SpectrelSaveViewController::beginEditing()
{
    _saveDescription->isFirstResponder = true;
    _services.toolkit.screenDidChange(ScreenPart::Text, Animation::None);
}

void SpectrelSaveViewController::setDescriptionText(std::string text)
{
    _saveDescription->text = std::move(text);
    _services.toolkit.screenDidChange(ScreenPart::Text, Animation::None);
}

void SpectrelSaveViewController::resignDescription()
{
    _saveDescription->isFirstResponder = false;
    _services.toolkit.screenDidChange(ScreenPart::Text, Animation::None);
}

std::size_t SpectrelSaveViewController::numberOfRows() const
{
    return _saveHistory ? _saveHistory->count() : 0;
}

CellRef SpectrelSaveViewController::cellForRow(TableView& table, std::size_t row)
{
    CellRef cell = table.dequeueReusableCell(CellIdentifier);
    if (!cell)
        cell = std::make_shared<TableCell>(CellStyle::Default, std::string(CellIdentifier));
    const auto& entry = (*_saveHistory)[row].dictionary();
    const std::string* description = entry ? (*entry)["Description"].string() : nullptr;
    cell->textLabel.text = description ? *description : std::string();
    cell->textLabel.font = CellFont;
    cell->accessory = CellAccessory::Checkmark;
    cell->bounds = table.rowBounds();
    layOutCell(*cell, row);
    return cell;
}

void SpectrelSaveViewController::layOutCell(TableCell& cell, std::size_t)
{
    cell.layoutSubviews();
    cell.textLabel.frame = cell.contentBounds;
}

void SpectrelSaveViewController::didSelectRow(std::optional<std::size_t>)
{
    resignDescription();
}

} // namespace spectrel
