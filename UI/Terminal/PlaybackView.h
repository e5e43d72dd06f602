#pragma once

#include "UI/PlaybackController.h"
#include "UI/Terminal/Grid.h"

namespace spectrel {

/// The line of a recording that is played: its state, the time, the messages, and the time line as a bar.
class PlaybackView {
public:
    void draw(Grid& grid, int y, const PlaybackController& controller);
    /// A press on the bar seeks, one beside it plays or pauses.
    void press(int x, PlaybackController& controller) const;

private:
    Span _bar; // where it is shown; empty when it is not
};

} // namespace spectrel
