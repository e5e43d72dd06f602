#pragma once

#include "LogGenerator/Template/ClassIndex.h"
#include "Sections/GSMUMTS/GSM/CodingScheme.h"
#include "Sections/GSMUMTS/GSM/GPRSInformation.h"
#include "Sections/GSMUMTS/GSM/GSMRRInfo.h"
#include "Sections/GSMUMTS/GSM/GSMServingCell.h"
#include "Sections/GSMUMTS/GSM/GSMSet.h"
#include "Sections/GSMUMTS/GSM/MobileAllocation.h"
#include "Sections/GSMUMTS/GSM/NeighboringCells.h"
#include "Sections/GSMUMTS/GSM/NonRankedGSMSet.h"
#include "Sections/GSMUMTS/Mobility/CellChangeCounters.h"
#include "Sections/GSMUMTS/Mobility/EquivalentPLMNList.h"
#include "Sections/GSMUMTS/Mobility/ProcessCO.h"
#include "Sections/GSMUMTS/Mobility/ProcessCS.h"
#include "Sections/GSMUMTS/Mobility/ProcessPS.h"
#include "Sections/GSMUMTS/Mobility/ServingPLMN.h"
#include "Sections/GSMUMTS/UMTS/ActiveSet.h"
#include "Sections/GSMUMTS/UMTS/BLER.h"
#include "Sections/GSMUMTS/UMTS/DetectedSet.h"
#include "Sections/GSMUMTS/UMTS/HSDPAInformation.h"
#include "Sections/GSMUMTS/UMTS/MonitoredSet.h"
#include "Sections/GSMUMTS/UMTS/NonRankedUMTSSet.h"
#include "Sections/GSMUMTS/UMTS/UMTSRRInfo.h"
#include "Sections/GSMUMTS/UMTS/UMTSRRMeasurement.h"
#include "Sections/GSMUMTS/UMTS/UMTSSet.h"
#include "Sections/GSMUMTS/UMTS/VirtualActiveSet.h"
#include "Sections/Shared/PDPContextList.h"
#include "Sections/Shared/SimInfo.h"

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
