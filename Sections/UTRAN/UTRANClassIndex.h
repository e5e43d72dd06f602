#pragma once

#include "LogGenerator/Template/ClassIndex.h"
#include "Sections/Shared/PDPContextList.h"
#include "Sections/Shared/SimInfo.h"
#include "Sections/UTRAN/NeighbhorMeasurements.h"
#include "Sections/UTRAN/RRC_State.h"
#include "Sections/UTRAN/TransportChannel.h"
#include "Sections/UTRAN/UTRANServingCellInfo.h"

namespace spectrel {

/// The sections of a UTRAN baseband, in the order of creation and so of delivery. Unlike the other indexes it prints no
/// line of its own when it goes.
class UTRANClassIndex final : public ClassIndex {
public:
    using ClassIndex::ClassIndex;

private:
    RRC_State rrc_state {*this};
    UTRANServingCellInfo servingCellInfo {*this};
    UTRANNeighbhorMeasurements tdMeasurements {*this};
    GSMNeighbhorMeasurements gsmMeasurements {*this};
    TRCHBLERMeasurement trchMeasurements {*this};
    CCTRCHSIRMeasurement cctrchMeasurements {*this};
    PDPContextList pdpList {*this};
    SimInfo simInfo {*this};
};

} // namespace spectrel
