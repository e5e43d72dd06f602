#pragma once

#include "LogGenerator/Template/ClassIndex.h"
#include "Sections/LTE/ConnectedModeMeasurement.h"
#include "Sections/LTE/IdleNeighbour.h"
#include "Sections/LTE/LTEServingCellInfo.h"
#include "Sections/LTE/ReselectionCandidates.h"
#include "Sections/LTE/ServingCellMeasurement.h"
#include "Sections/Shared/PDPContextList.h"
#include "Sections/Shared/SimInfo.h"

namespace spectrel {

/// The sections of an LTE baseband, in the order of creation and so of delivery.
class LTEClassIndex final : public ClassIndex {
public:
    using ClassIndex::ClassIndex;
    ~LTEClassIndex() override;

private:
    LTEServingCellInfo objLTEServingCellInfo {*this};
    ConnectedModeMeasurementMisc objConnectedModeMeasurementMisc {*this};
    MeasuredNeighborCells objMeasuredNeighborCells {*this};
    DetectedCells objDetectedCells {*this};
    ServingCellMeasurement objServingCellMeasurement {*this};
    NeighborMeasurementMisc objNeighborMeasurementMisc {*this};
    NeighborCellsList objNeighborCellsList {*this};
    ReselectionCandidatesMisc objReselectionCandidatesMisc {*this};
    ReselectionCandidatesList objReselectionCandidatesList {*this};
    SimInfo objSimInfo {*this};
    PDPContextList objPDPContextList {*this};
};

} // namespace spectrel
