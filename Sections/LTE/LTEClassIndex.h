#pragma once

#include "LogGenerator/Template/ClassIndex.h"
#include "Sections/LTE/ConnectedModeMeasurementMisc.h"
#include "Sections/LTE/DetectedCells.h"
#include "Sections/LTE/LTEServingCellInfo.h"
#include "Sections/LTE/MeasuredNeighborCells.h"
#include "Sections/LTE/NeighborCellsList.h"
#include "Sections/LTE/NeighborMeasurementMisc.h"
#include "Sections/LTE/ReselectionCandidatesList.h"
#include "Sections/LTE/ReselectionCandidatesMisc.h"
#include "Sections/LTE/ServingCellMeasurement.h"
#include "Sections/Shared/PDPContextList.h"
#include "Sections/Shared/SimInfo.h"

namespace spectrel {

/// The sections of an LTE baseband, in the order of creation and so of delivery.
class LTEClassIndex final : public ClassIndex {
public:
    ~LTEClassIndex() override;

private:
    LTEServingCellInfo objLTEServingCellInfo {classDict, codeDictionary};
    ConnectedModeMeasurementMisc objConnectedModeMeasurementMisc {classDict, codeDictionary};
    MeasuredNeighborCells objMeasuredNeighborCells {classDict, codeDictionary};
    DetectedCells objDetectedCells {classDict, codeDictionary};
    ServingCellMeasurement objServingCellMeasurement {classDict, codeDictionary};
    NeighborMeasurementMisc objNeighborMeasurementMisc {classDict, codeDictionary};
    NeighborCellsList objNeighborCellsList {classDict, codeDictionary};
    ReselectionCandidatesMisc objReselectionCandidatesMisc {classDict, codeDictionary};
    ReselectionCandidatesList objReselectionCandidatesList {classDict, codeDictionary};
    SimInfo objSimInfo {classDict, codeDictionary};
    PDPContextList objPDPContextList {classDict, codeDictionary};
};

} // namespace spectrel
