#pragma once

#include "LogGenerator/Template/RecordSection.h"

namespace spectrel {

/// "Neighbor Measurements", code 0xB180: what the idle-mode neighbour measurement holds beside its list of cells.
class NeighborMeasurementMisc final : public RecordSection {
public:
    NeighborMeasurementMisc(ClassDictionary& dict, CodeDictionary& codeDict);

private:
    void decode(RecordView record) override;
};

} // namespace spectrel
