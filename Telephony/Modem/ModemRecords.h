#pragma once

#include "Platform/Clock.h"
#include "Telephony/Modem/ModemFacts.h"
#include "Values/Bytes.h"

#include <optional>
#include <vector>

namespace spectrel {

/// A record holds no more cells, or contexts, than this; fewer when they would not fit into its 16-bit length.
inline constexpr std::size_t MaxModemElements = 48;

/// 0xFF0000: the SIM's files, those of them that modems report. Each is in every record, a dash for what is not known,
/// so that nothing of a SIM that was taken out stays on the screen.
Bytes modemSimRecord(const std::optional<SimFacts>& sim, Moment time);

/// 0xFF0001: the cells, in their order, one dictionary each; the serving one with what the modem measures of it.
///
/// Whole numbers: powers in dBm (a GSM cell's kRKCellMonitorRSSI in steps of 2 dBm, which its readers double), ratios
/// in dB. kRKCellMonitorPLMN is the network as text ("001-01"), which keeps the zeros that the numbers lose.
Bytes modemCellsRecord(const std::vector<CellFacts>& cells, const SignalFacts& signal, Moment time);

/// 0xFF0002: the packet data contexts, as they are shown: what is not known is left out.
Bytes modemContextsRecord(const std::vector<BearerFacts>& bearers, Moment time);

} // namespace spectrel
