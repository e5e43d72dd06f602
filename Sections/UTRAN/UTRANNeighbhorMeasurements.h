#pragma once

#include "LogGenerator/Template/RecordSection.h"

namespace spectrel {

/// "Neighbor Cell List", code 0xD00A: a list of the UTRAN cells around, with the set that each is in. Every record of
/// the code rebuilds it.
class UTRANNeighbhorMeasurements final : public RecordSection {
public:
    UTRANNeighbhorMeasurements(ClassDictionary& dict, CodeDictionary& codeDict);

private:
    void decode(RecordView record) override;
};

} // namespace spectrel
