#pragma once

#include "Telephony/Simulator/Dice.h"
#include "Telephony/Simulator/Scene.h"

#include <chrono>

namespace spectrel {

/// Something that its user does now and then.
class Habit {
public:
    /// In seconds.
    struct Span {
        double min;
        double max;
    };

    /// `first`: until it begins for the first time.
    Habit(Span pauses, Span times, Span first, Dice& dice);

    void advance(std::chrono::milliseconds step, Dice& dice);
    bool isOn() const
    {
        return _isOn;
    }

private:
    Span _pauses;
    Span _times;
    bool _isOn = false;
    double _left; // seconds until it turns
};

/// How its user uses the phone: voice calls, data sessions, and transfers within them.
class Usage {
public:
    /// In the handover scene a call lasts all the time.
    Usage(Scene scene, Dice& dice);

    /// Only a phone that is attached is used.
    void advance(std::chrono::milliseconds step, bool isAttached, Dice& dice);

    bool wantsCall() const
    {
        return _isAlwaysCalling || _calls.isOn();
    }
    bool hasSession() const
    {
        return _sessions.isOn();
    }
    bool wantsTransfer() const
    {
        return hasSession() && _transfers.isOn();
    }

private:
    bool _isAlwaysCalling;
    Habit _calls;
    Habit _sessions;
    Habit _transfers;
};

} // namespace spectrel
