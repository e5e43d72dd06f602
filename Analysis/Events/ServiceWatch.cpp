#include "Analysis/Events/ServiceWatch.h"

namespace spectrel {

ServiceWatch::News ServiceWatch::messageCame(Moment time, Shown shown)
{
    const auto step = _latest ? time - *_latest : Moment::duration::zero();
    _latest = time;
    if (shown == Shown::Cell) {
        _silence = {};
        _lastShown = time;
        _wasThere = true;
        if (!_lostAt)
            return News::None;
        _away = time - *_lostAt;
        _lostAt.reset();
        return News::Back;
    }
    if (!_wasThere || _lostAt)
        return News::None;
    if (step <= LongestStep)
        _silence += step;
    if (shown == Shown::Nothing && _silence <= Patience)
        return News::None;
    // Silence counts from the last sign of the cell.
    _lostAt = shown == Shown::NoService ? time : *_lastShown;
    return News::Lost;
}

} // namespace spectrel
