#pragma once

#include "LogGenerator/Template/ClassIndex.h"
#include "Sections/Shared/PDPContextList.h"
#include "Sections/Shared/SimInfo.h"
#include "Sections/UTRAN/CCTRCHSIRMeasurement.h"
#include "Sections/UTRAN/GSMNeighbhorMeasurements.h"
#include "Sections/UTRAN/RRC_State.h"
#include "Sections/UTRAN/TRCHBLERMeasurement.h"
#include "Sections/UTRAN/UTRANNeighbhorMeasurements.h"
#include "Sections/UTRAN/UTRANServingCellInfo.h"

namespace spectrel {

/// The sections of a UTRAN baseband, in the order of creation and so of delivery. Unlike the other indexes it prints no
/// line of its own when it goes.
class UTRANClassIndex final : public ClassIndex {
private:
    RRC_State rrc_state {classDict, codeDictionary};
    UTRANServingCellInfo servingCellInfo {classDict, codeDictionary};
    UTRANNeighbhorMeasurements tdMeasurements {classDict, codeDictionary};
    GSMNeighbhorMeasurements gsmMeasurements {classDict, codeDictionary};
    TRCHBLERMeasurement trchMeasurements {classDict, codeDictionary};
    CCTRCHSIRMeasurement cctrchMeasurements {classDict, codeDictionary};
    PDPContextList pdpList {classDict, codeDictionary};
    SimInfo simInfo {classDict, codeDictionary};
};

} // namespace spectrel
