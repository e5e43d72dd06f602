#pragma once

#include "Platform/Clock.h"
#include "Platform/SystemLog.h"
#include "UI/Application.h"
#include "UI/ScreenToolkit.h"
#include "UI/TableView.h"
#include "Values/List.h"

#include <cstddef>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// A single-line text field.
struct TextField {
    std::optional<std::string> text = std::string(); // as far as it was typed, confirmed or not
    bool isFirstResponder = false; // has the input focus
};

/// The modal screen that lists what will be saved, takes a description and writes one snapshot file.
class SpectrelSaveViewController final : public TableSource {
public:
    static constexpr std::string_view CellIdentifier = "SaveHistoryContentCell";
    static const Font CellFont;
    static constexpr double RowHeight = 46; // pt, in a window

    /// Writes the snapshot to the path; false, with `reason`, when it could not.
    using SnapshotWriter =
        std::function<bool(const DictionaryRef& snapshot, const std::string& path, std::string& reason)>;
    /// What the screen needs; all outlive it.
    struct Services {
        Application& application;
        ScreenToolkit& toolkit;
        const Clock& clock;
        SystemLog& log;
        SnapshotWriter writeSnapshot;
        std::string directory; // the crash-log directory
    };

    /// Keeps a copy of the list; null: there is nothing to save.
    SpectrelSaveViewController(Services services, const ListRef& saveHistory);
    ~SpectrelSaveViewController() override = default;
    SpectrelSaveViewController(const SpectrelSaveViewController&) = delete;
    SpectrelSaveViewController& operator=(const SpectrelSaveViewController&) = delete;

    void viewDidLoad();
    void viewWillAppear();
    void savePressed();
    void cancelPressed();
    /// Return was pressed in the field: true.
    bool textFieldShouldReturn(TextField& textField);
    void backgroundTouched();
    /// The description field takes the input focus, or its text was edited.
    void beginEditing();
    void setDescriptionText(std::string text);

    const std::shared_ptr<TableView>& saveContentTable() const
    {
        return _saveContentTable;
    }
    void setSaveContentTable(std::shared_ptr<TableView> table)
    {
        _saveContentTable = std::move(table);
    }
    const std::shared_ptr<TextField>& saveDescription() const
    {
        return _saveDescription;
    }
    void setSaveDescription(std::shared_ptr<TextField> field)
    {
        _saveDescription = std::move(field);
    }

    std::size_t numberOfRows() const override;
    Moment timeStamp() const
    {
        return _timeStamp;
    }
    /// The view's frame on the main screen.
    const Rect& frame() const
    {
        return _frame;
    }

private:
    CellRef cellForRow(TableView& table, std::size_t row) override;
    void layOutCell(TableCell& cell, std::size_t row) override;
    void didSelectRow(std::optional<std::size_t> row) override;
    void resignDescription();

    Services _services;
    Moment _timeStamp;
    ListRef _saveHistory;
    std::shared_ptr<TableView> _saveContentTable;
    std::shared_ptr<TextField> _saveDescription;
    Rect _frame;
};

} // namespace spectrel
