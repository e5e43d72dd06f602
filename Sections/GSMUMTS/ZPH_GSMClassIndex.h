#pragma once

#include "LogGenerator/Template/ClassIndex.h"
#include "Sections/GSMUMTS/PDPContextList.h"
#include "Sections/GSMUMTS/SimInfo.h"

namespace spectrel {

/// The sections of a GSM/UMTS baseband, in the order of creation and so of delivery.
class ZPH_GSMClassIndex final : public ClassIndex {
public:
    ~ZPH_GSMClassIndex() override;

private:
    PDPContextList objPDPContextList {classDict, codeDictionary};
    SimInfo objSimInfo {classDict, codeDictionary};
};

} // namespace spectrel
