#pragma once

#include "LogGenerator/Template/RecordSection.h"

namespace spectrel {

/// "CCTRCH SIR", code 0xD00C: a list of the coded composite transport channels, with the signal-to-interference ratio
/// in each of six time slots. Every record of the code rebuilds it.
class CCTRCHSIRMeasurement final : public RecordSection {
public:
    CCTRCHSIRMeasurement(ClassDictionary& dict, CodeDictionary& codeDict);

private:
    void decode(RecordView record) override;
};

} // namespace spectrel
