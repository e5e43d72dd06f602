#pragma once

#include "LogGenerator/Template/RecordSection.h"

namespace spectrel {

/// "TRCH BLER", code 0xD00C: a list of the transport channels with their block error rates. Every record of the code
/// rebuilds it.
class TRCHBLERMeasurement final : public RecordSection {
public:
    TRCHBLERMeasurement(ClassDictionary& dict, CodeDictionary& codeDict);

private:
    void decode(RecordView record) override;
};

} // namespace spectrel
