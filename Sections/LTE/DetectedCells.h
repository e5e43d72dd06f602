#pragma once

#include "LogGenerator/Template/RecordSection.h"

namespace spectrel {

/// "Detected Cells", code 0xB179: a list of the cells that connected mode has detected but does not measure. Every
/// record of the code rebuilds it.
class DetectedCells final : public RecordSection {
public:
    DetectedCells(ClassDictionary& dict, CodeDictionary& codeDict);

private:
    void decode(RecordView record) override;
};

} // namespace spectrel
