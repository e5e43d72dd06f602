#include "UI/Terminal/PlaybackView.h"

#include <algorithm>
#include <string>

namespace spectrel {

namespace {

constexpr int SmallestBar = 8; // columns

} // namespace

void PlaybackView::draw(Grid& grid, int y, const PlaybackController& controller)
{
    const int width = grid.width();
    grid.fill(y, {0, width}, Style {});
    int x = grid.put(1, y, controller.isPlaying() ? "▶" : "‖", Style {.tint = Tint::Accent});
    x = grid.put(x + 1, y, controller.stateText(), Style {});
    for (const std::string& text : {controller.timeText(), controller.messagesText()}) {
        if (x + 2 + columnsOf(text) >= width)
            break;
        x = grid.put(x + 2, y, text, Style {});
    }
    _bar = {x + 2, width - 1};
    if (_bar.right - _bar.left < SmallestBar) {
        _bar = {};
        return;
    }
    const int length = _bar.right - _bar.left;
    const int done = std::clamp(static_cast<int>(controller.fraction() * length), 0, length);
    for (int column = 0; column < length; ++column)
        grid.put(_bar.left + column, y, column < done ? "━" : "─",
            column < done ? Style {.tint = Tint::Accent} : Style {.isFaint = true});
}

void PlaybackView::press(int x, PlaybackController& controller) const
{
    if (x < _bar.left || x >= _bar.right)
        return controller.togglePlaying();
    // The bar's last column is the end.
    controller.seekToFraction(static_cast<double>(x - _bar.left) / std::max(1, _bar.right - _bar.left - 1));
}

} // namespace spectrel
