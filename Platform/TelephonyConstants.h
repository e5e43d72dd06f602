#pragma once

#include <string_view>

/// The telephony framework's string constants. Each one's value is its own name.
namespace spectrel {

#define SPECTREL_TELEPHONY_CONSTANT(name) inline constexpr std::string_view name = #name

SPECTREL_TELEPHONY_CONSTANT(kRKLogChannelTechnology_IFX);
SPECTREL_TELEPHONY_CONSTANT(kRKLogChannelTechnology_Zephyr_GSM);
SPECTREL_TELEPHONY_CONSTANT(kRKLogChannelTechnology_Zephyr_CDMA);
SPECTREL_TELEPHONY_CONSTANT(kRKLogChannelTechnology_Zephyr_LTE);
SPECTREL_TELEPHONY_CONSTANT(kRKLogChannelTechnology_Zephyr_UTRAN2);

// Cell-information records (code 0xFF0001): one dictionary a cell.
SPECTREL_TELEPHONY_CONSTANT(kRKCellMonitorCellRadioAccessTechnology);
SPECTREL_TELEPHONY_CONSTANT(kRKCellMonitorRadioAccessTechnologyLTE);
SPECTREL_TELEPHONY_CONSTANT(kRKCellMonitorCellType);
SPECTREL_TELEPHONY_CONSTANT(kRKCellMonitorCellTypeServing);
SPECTREL_TELEPHONY_CONSTANT(kRKCellMonitorCellTypeNeighbor);
SPECTREL_TELEPHONY_CONSTANT(kRKCellMonitorMCC);
SPECTREL_TELEPHONY_CONSTANT(kRKCellMonitorMNC);
SPECTREL_TELEPHONY_CONSTANT(kRKCellMonitorTAC);
SPECTREL_TELEPHONY_CONSTANT(kRKCellMonitorCellId);
SPECTREL_TELEPHONY_CONSTANT(kRKCellMonitorPID);
SPECTREL_TELEPHONY_CONSTANT(kRKCellMonitorBandInfo);
SPECTREL_TELEPHONY_CONSTANT(kRKCellMonitorUARFCN);

#undef SPECTREL_TELEPHONY_CONSTANT

} // namespace spectrel
