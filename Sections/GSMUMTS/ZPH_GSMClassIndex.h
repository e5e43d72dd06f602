#pragma once

#include "LogGenerator/Template/ClassIndex.h"
#include "Sections/GSMUMTS/GSM/GPRSInformation.h"
#include "Sections/GSMUMTS/GSM/GSMRRInfo.h"
#include "Sections/GSMUMTS/GSM/GSMServingCell.h"
#include "Sections/GSMUMTS/GSM/GSMSet.h"
#include "Sections/GSMUMTS/GSM/MobileAllocation.h"
#include "Sections/GSMUMTS/GSM/NeighboringCells.h"
#include "Sections/GSMUMTS/Mobility/EquivalentPLMNList.h"
#include "Sections/GSMUMTS/Mobility/MobilityManagement.h"
#include "Sections/GSMUMTS/Mobility/ServingPLMN.h"
#include "Sections/GSMUMTS/NameOnlySections.h"
#include "Sections/GSMUMTS/UMTS/BLER.h"
#include "Sections/GSMUMTS/UMTS/HSDPAInformation.h"
#include "Sections/GSMUMTS/UMTS/UMTSCellSets.h"
#include "Sections/GSMUMTS/UMTS/UMTSRRInfo.h"
#include "Sections/GSMUMTS/UMTS/UMTSSet.h"
#include "Sections/Shared/PDPContextList.h"
#include "Sections/Shared/SimInfo.h"

namespace spectrel {

/// The sections of a GSM/UMTS baseband, in the order of creation and so of delivery.
class ZPH_GSMClassIndex final : public ClassIndex {
public:
    using ClassIndex::ClassIndex;
    ~ZPH_GSMClassIndex() override;

private:
    ActiveSet objActiveSet {*this};
    CodingScheme objCodingScheme {*this};
    GPRSInformation objGPRSInformation {*this};
    GSMServingCell objGSMServingCell {*this};
    MobileAllocation objMobileAllocation {*this};
    NeighboringCells objNeighboringCells {*this};
    PDPContextList objPDPContextList {*this};
    ProcessPS objProcessPS {*this};
    UMTSRRMeasurement objUMTSRRMeasurement {*this};
    CellChangeCounters objCellChangeCounter {*this};
    DetectedSet objDetectedSet {*this};
    GSMSet objGSMSet {*this};
    NonRankedGSMSet objNonRankedGSMSet {*this};
    ProcessCO objProcessCO {*this};
    ServingPLMN objServingPLMN {*this};
    UMTSSet objUMTSSet {*this};
    EquivalentPLMNList objEquivalentPLMNList {*this};
    GSMRRInfo objGSMRRInfo {*this};
    MonitoredSet objMonitoredSet {*this};
    NonRankedUMTSSet objNonRankedUMTSSet {*this};
    ProcessCS objProcessCS {*this};
    UMTSRRInfo objUMTSRRInfo {*this};
    BLER objBLER {*this};
    VirtualActiveSet objVirtualActiveSet {*this};
    SimInfo objSimInfo {*this};
    HSDPAInformation objHSDPAInformation {*this};
};

} // namespace spectrel
