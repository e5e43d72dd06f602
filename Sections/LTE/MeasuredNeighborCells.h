#pragma once

#include "LogGenerator/Template/RecordSection.h"

namespace spectrel {

/// "Measured Neighbor Cells", code 0xB179: a list of the intra-frequency neighbours that connected mode measures. Every
/// record of the code rebuilds it.
class MeasuredNeighborCells final : public RecordSection {
public:
    MeasuredNeighborCells(ClassDictionary& dict, CodeDictionary& codeDict);

private:
    void decode(RecordView record) override;
};

} // namespace spectrel
