#include "Telephony/Simulator/Dice.h"

namespace spectrel {

double Dice::between(double from, double to)
{
    return from + (to - from) * static_cast<double>(number()) / static_cast<double>(std::mt19937::max());
}

} // namespace spectrel
