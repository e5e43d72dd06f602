#pragma once

#include "UI/TableView.h"

#include <memory>
#include <optional>
#include <string>

namespace spectrel {

/// A horizontally scrollable area of a row.
struct ScrollView {
    Rect frame;
    Size contentSize;
    double contentOffset = 0; // pt that the content is moved to the left

    /// How far the content can be moved.
    double scrollableWidth() const;
    /// Moves the content as far as it goes; false when it stayed where it was.
    bool scrollBy(double points);
};

/// A row of a pane: the name of an inner node, or the name and the value of a leaf.
///
/// The two kinds share one reuse identifier. A row made for an inner node has neither value label nor scrollable area
/// and gets none when it comes back for a leaf, whose value then stays blank.
class SpectrelCell final : public TableCell {
public:
    static const Font KeyFont;
    static const Font ValueFont;
    static constexpr double KeyInset = 10; // pt from the content's left edge to the name
    static constexpr double MinimumGap = 50; // pt between name and value
    static constexpr double ScrollViewHeight = 50; // pt

    /// A row for an inner node: the name label alone, placed directly in the row's content.
    static std::shared_ptr<SpectrelCell> initWithStyleKey(
        const ScreenToolkit& toolkit, CellStyle style, std::string reuseIdentifier);
    /// A row for a leaf: name and value labels inside the scrollable area, which fills the row's content.
    static std::shared_ptr<SpectrelCell> initWithStyle(
        const ScreenToolkit& toolkit, CellStyle style, std::string reuseIdentifier);

    /// Layout of an inner node's row.
    void setLayoutKey();
    /// Layout of a leaf's row.
    void setLayout();
    double contentOffset() const override;
    void setContentOffset(double offset) override;

    Label key;
    std::optional<Label> value;
    std::optional<ScrollView> view;

private:
    SpectrelCell(const ScreenToolkit& toolkit, CellStyle style, std::string reuseIdentifier);
    Size placeKey();

    const ScreenToolkit& _toolkit;
};

} // namespace spectrel
