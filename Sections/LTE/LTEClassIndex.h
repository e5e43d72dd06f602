#pragma once

#include "LogGenerator/Template/ClassIndex.h"
#include "Sections/GSMUMTS/PDPContextList.h"
#include "Sections/GSMUMTS/SimInfo.h"
#include "Sections/LTE/LTEServingCellInfo.h"

namespace spectrel {

/// The sections of an LTE baseband, in the order of creation and so of delivery.
class LTEClassIndex final : public ClassIndex {
public:
    ~LTEClassIndex() override;

private:
    LTEServingCellInfo objLTEServingCellInfo {classDict, codeDictionary};
    SimInfo objSimInfo {classDict, codeDictionary};
    PDPContextList objPDPContextList {classDict, codeDictionary};
};

} // namespace spectrel
