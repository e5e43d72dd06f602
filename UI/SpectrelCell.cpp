#include "UI/SpectrelCell.h"

#include <algorithm>
#include <utility>

namespace spectrel {

const Font SpectrelCell::KeyFont {15, FontWeight::Bold};
const Font SpectrelCell::ValueFont {15, FontWeight::Regular};

double ScrollView::scrollableWidth() const
{
    return std::max(0.0, contentSize.width - frame.width);
}

bool ScrollView::scrollBy(double points)
{
    const double moved = std::clamp(contentOffset + points, 0.0, scrollableWidth());
    return std::exchange(contentOffset, moved) != moved;
}

SpectrelCell::SpectrelCell(const ScreenToolkit& toolkit, CellStyle style, std::string reuseIdentifier)
    : TableCell(style, std::move(reuseIdentifier))
    , _toolkit(toolkit)
{
    key.font = KeyFont;
}

std::shared_ptr<SpectrelCell> SpectrelCell::initWithStyleKey(
    const ScreenToolkit& toolkit, CellStyle style, std::string reuseIdentifier)
{
    return std::shared_ptr<SpectrelCell>(new SpectrelCell(toolkit, style, std::move(reuseIdentifier)));
}

std::shared_ptr<SpectrelCell> SpectrelCell::initWithStyle(
    const ScreenToolkit& toolkit, CellStyle style, std::string reuseIdentifier)
{
    auto cell = initWithStyleKey(toolkit, style, std::move(reuseIdentifier));
    cell->value.emplace().font = ValueFont;
    cell->view.emplace();
    return cell;
}

double SpectrelCell::contentOffset() const
{
    return view ? view->contentOffset : 0;
}

void SpectrelCell::setContentOffset(double offset)
{
    if (view && accessory == CellAccessory::None) // the name of an inner node stays in sight
        view->scrollBy(offset - view->contentOffset);
}

/// Places the name label; its size.
Size SpectrelCell::placeKey()
{
    const Size size = _toolkit.sizeOfText(key.text, KeyFont);
    const Rect& content = contentBounds;
    key.frame = {content.x + KeyInset, (content.height - size.height) * 0.5, size.width, size.height};
    return size;
}

void SpectrelCell::setLayoutKey()
{
    layoutSubviews();
    placeKey();
    if (view)
        view->contentOffset = 0; // the name of an inner node stays in sight
}

void SpectrelCell::setLayout()
{
    layoutSubviews();
    const Size keySize = placeKey();
    if (!value || !view)
        return;
    const Rect& content = contentBounds;
    // Measured in the name's bold font although shown in the regular one: kept on purpose.
    const Size valueSize = _toolkit.sizeOfText(value->text, KeyFont);
    const double needed = keySize.width + KeyInset + MinimumGap + valueSize.width;
    const double x =
        needed < content.width ? content.width - valueSize.width : content.x + KeyInset + keySize.width + MinimumGap;
    value->frame = {x, (content.height - valueSize.height) * 0.5, valueSize.width, valueSize.height};
    const double contentWidth =
        needed > content.width ? content.width + keySize.width + valueSize.width : content.width;
    view->contentSize = {contentWidth, ScrollViewHeight};
    view->frame = {content.x, content.y, content.width, ScrollViewHeight};
    view->contentOffset = std::min(view->contentOffset, view->scrollableWidth());
}

} // namespace spectrel
