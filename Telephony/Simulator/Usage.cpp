#include "Telephony/Simulator/Usage.h"

namespace spectrel {

Habit::Habit(Span pauses, Span times, Span first, Dice& dice)
    : _pauses(pauses)
    , _times(times)
    , _left(dice.between(first.min, first.max))
{
}

void Habit::advance(std::chrono::milliseconds step, Dice& dice)
{
    _left -= std::chrono::duration<double>(step).count();
    if (_left > 0)
        return;
    _isOn = !_isOn;
    const Span& span = _isOn ? _times : _pauses;
    _left = dice.between(span.min, span.max);
}

Usage::Usage(Scene scene, Dice& dice)
    : _isAlwaysCalling(scene == Scene::Handover)
    , _calls({30, 70}, {14, 30}, {15, 50}, dice)
    , _sessions({8, 14}, {90, 150}, {2, 4}, dice)
    , _transfers({5, 35}, {8, 25}, {3, 5}, dice)
{
}

void Usage::advance(std::chrono::milliseconds step, bool isAttached, Dice& dice)
{
    if (!isAttached)
        return;
    _calls.advance(step, dice);
    _sessions.advance(step, dice);
    _transfers.advance(step, dice);
}

} // namespace spectrel
