#pragma once

#include "LogGenerator/Template/ClassIndex.h"
#include "Sections/GSMUMTS/ActiveSet.h"
#include "Sections/GSMUMTS/BLER.h"
#include "Sections/GSMUMTS/CellChangeCounters.h"
#include "Sections/GSMUMTS/CodingScheme.h"
#include "Sections/GSMUMTS/DetectedSet.h"
#include "Sections/GSMUMTS/EquivalentPLMNList.h"
#include "Sections/GSMUMTS/GPRSInformation.h"
#include "Sections/GSMUMTS/GSMRRInfo.h"
#include "Sections/GSMUMTS/GSMServingCell.h"
#include "Sections/GSMUMTS/GSMSet.h"
#include "Sections/GSMUMTS/HSDPAInformation.h"
#include "Sections/GSMUMTS/MobileAllocation.h"
#include "Sections/GSMUMTS/MonitoredSet.h"
#include "Sections/GSMUMTS/NeighboringCells.h"
#include "Sections/GSMUMTS/NonRankedGSMSet.h"
#include "Sections/GSMUMTS/NonRankedUMTSSet.h"
#include "Sections/GSMUMTS/PDPContextList.h"
#include "Sections/GSMUMTS/ProcessCO.h"
#include "Sections/GSMUMTS/ProcessCS.h"
#include "Sections/GSMUMTS/ProcessPS.h"
#include "Sections/GSMUMTS/ServingPLMN.h"
#include "Sections/GSMUMTS/SimInfo.h"
#include "Sections/GSMUMTS/UMTSRRInfo.h"
#include "Sections/GSMUMTS/UMTSRRMeasurement.h"
#include "Sections/GSMUMTS/UMTSSet.h"
#include "Sections/GSMUMTS/VirtualActiveSet.h"

namespace spectrel {

/// The sections of a GSM/UMTS baseband, in the order of creation and so of delivery.
class ZPH_GSMClassIndex final : public ClassIndex {
public:
    ~ZPH_GSMClassIndex() override;

private:
    ActiveSet objActiveSet {classDict, codeDictionary};
    CodingScheme objCodingScheme {classDict, codeDictionary};
    GPRSInformation objGPRSInformation {classDict, codeDictionary};
    GSMServingCell objGSMServingCell {classDict, codeDictionary};
    MobileAllocation objMobileAllocation {classDict, codeDictionary};
    NeighboringCells objNeighboringCells {classDict, codeDictionary};
    PDPContextList objPDPContextList {classDict, codeDictionary};
    ProcessPS objProcessPS {classDict, codeDictionary};
    UMTSRRMeasurement objUMTSRRMeasurement {classDict, codeDictionary};
    CellChangeCounters objCellChangeCounter {classDict, codeDictionary};
    DetectedSet objDetectedSet {classDict, codeDictionary};
    GSMSet objGSMSet {classDict, codeDictionary};
    NonRankedGSMSet objNonRankedGSMSet {classDict, codeDictionary};
    ProcessCO objProcessCO {classDict, codeDictionary};
    ServingPLMN objServingPLMN {classDict, codeDictionary};
    UMTSSet objUMTSSet {classDict, codeDictionary};
    EquivalentPLMNList objEquivalentPLMNList {classDict, codeDictionary};
    GSMRRInfo objGSMRRInfo {classDict, codeDictionary};
    MonitoredSet objMonitoredSet {classDict, codeDictionary};
    NonRankedUMTSSet objNonRankedUMTSSet {classDict, codeDictionary};
    ProcessCS objProcessCS {classDict, codeDictionary};
    UMTSRRInfo objUMTSRRInfo {classDict, codeDictionary};
    BLER objBLER {classDict, codeDictionary};
    VirtualActiveSet objVirtualActiveSet {classDict, codeDictionary};
    SimInfo objSimInfo {classDict, codeDictionary};
    HSDPAInformation objHSDPAInformation {classDict, codeDictionary};
};

} // namespace spectrel
