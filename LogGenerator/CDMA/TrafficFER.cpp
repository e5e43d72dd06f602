#include "LogGenerator/CDMA/TrafficFER.h"

#include "LogGenerator/CDMA/Lookup.h"
#include "Values/TextBuffer.h"

#include <optional>
#include <string_view>

namespace spectrel {

namespace {

constexpr std::string_view StateEntry = "TrafficFER";
constexpr std::string_view Variable = "k1xTrafficFER";
constexpr float Weight = 1.0F / 64; // of the newest frame

void show(double rate, std::string_view unit, const Value& lookup)
{
    TextBuffer buffer;
    setLookupText(Variable, buffer.fixed2(rate * 100).text(unit).view(), lookup);
}

} // namespace

void updateTrafficFER(bool isFrameBad, Dictionary& state, const Value& lookup)
{
    float rate = isFrameBad ? Weight : 0; // in single precision throughout
    if (const auto average = state[StateEntry].real())
        rate += (1 - Weight) * static_cast<float>(*average);
    state.set(StateEntry, Value::real(rate));
    show(rate, "%", lookup);
}

void retireTrafficFER(Dictionary& state, const Value& lookup)
{
    const auto average = state[StateEntry].real();
    if (!average)
        return;
    show(*average, "% (old)", lookup);
    state.remove(StateEntry);
}

} // namespace spectrel
