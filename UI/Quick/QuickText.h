#pragma once

#include "UI/ScreenToolkit.h"

#include <QFont>
#include <QRectF>
#include <QString>
#include <string_view>

namespace spectrel {

/// A text as one line of the screen: bytes that are no UTF-8 and control characters are replaced, and what no screen
/// could show is cut off. Measured texts and drawn ones both come from here.
QString shownText(std::string_view text);

/// A point is a device-independent pixel; no family means the desktop's font.
QFont shownFont(const Font& font);

inline QRectF shownRect(const Rect& rect)
{
    return {rect.x, rect.y, rect.width, rect.height};
}

} // namespace spectrel
