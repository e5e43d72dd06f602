#pragma once

#include "Analysis/Cell.h"
#include "Analysis/Events/Event.h"

#include <string>
#include <string_view>

namespace spectrel {

/// A cell in a few words: "LTE PCI 52 on 1300 (band 3)".
std::string cellText(const Cell& cell);

/// The cell's strength: "RSRP -104.5 dBm"; empty where none is known.
std::string strengthText(const Cell& cell);

/// A number without needless zeros: "3", "-104.5", "0.25".
std::string numberText(double number);

/// The sentence of a `cell` event.
std::string moveText(const Event& event);

} // namespace spectrel
