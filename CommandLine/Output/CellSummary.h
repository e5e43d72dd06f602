#pragma once

#include "Analysis/CellReport.h"

#include <string>

namespace spectrel {

/// The report as one line for people, without a time: "LTE band 3, 1815.0 MHz, PCI 52, cell 4101-1, RSRP -104.5 dBm,
/// RSRQ -9.5 dB, 3 neighbours (best PCI 203, +2.5 dB), idle".
std::string summaryOf(const CellReport& report);

} // namespace spectrel
