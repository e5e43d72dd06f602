#pragma once

#include "Telephony/Reports/GSMCell.h"
#include "Telephony/Reports/GSMUMTSReports.h"
#include "Telephony/Reports/UMTSCell.h"

#include <vector>

namespace spectrel {

/// The cells that a GSM/UMTS phone knows of. The cells outlive it.
struct GSMUMTSCellInformation {
    const UMTSCell* servingUMTS = nullptr; // null: it is not on UMTS
    const GSMCell* servingGSM = nullptr;
    std::vector<RankedUMTSCell> umtsNeighbours;
    std::vector<const GSMCell*> gsmNeighbours;
    bool measuresGSM = false; // whether the levels of the GSM neighbours are known
};

} // namespace spectrel
