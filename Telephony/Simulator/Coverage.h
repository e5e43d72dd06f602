#pragma once

#include "Telephony/Simulator/Move.h"

namespace spectrel {

/// What a phone knows of a technology's best cell, whether that serves it or not.
struct Coverage {
    CellName cell;
    double level = -140; // dBm
    double margin = -140; // dB above what cell selection asks for
    bool isPreferable = false; // strong enough to be moved to from a technology of lower priority
};

} // namespace spectrel
