#pragma once

#include "LogGenerator/Template/RecordSection.h"

namespace spectrel {

/// "GSM Neighbor Cell List", code 0xD00E: a list of the GSM cells around. Every record of the code rebuilds it.
class GSMNeighbhorMeasurements final : public RecordSection {
public:
    GSMNeighbhorMeasurements(ClassDictionary& dict, CodeDictionary& codeDict);

private:
    void decode(RecordView record) override;
};

} // namespace spectrel
