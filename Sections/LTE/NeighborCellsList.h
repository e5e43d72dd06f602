#pragma once

#include "LogGenerator/Template/RecordSection.h"

namespace spectrel {

/// "Neighbor Cells List", code 0xB180: a list of 1 to 32 neighbours as idle mode measures them. Every record of the
/// code rebuilds it.
class NeighborCellsList final : public RecordSection {
public:
    NeighborCellsList(ClassDictionary& dict, CodeDictionary& codeDict);

private:
    void decode(RecordView record) override;
};

} // namespace spectrel
