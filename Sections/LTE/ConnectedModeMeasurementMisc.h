#pragma once

#include "LogGenerator/Template/RecordSection.h"

namespace spectrel {

/// "Connected mode LTE Intra-frequency Measurement", code 0xB179: the serving cell as measured in connected mode.
class ConnectedModeMeasurementMisc final : public RecordSection {
public:
    ConnectedModeMeasurementMisc(ClassDictionary& dict, CodeDictionary& codeDict);

private:
    void decode(RecordView record) override;
};

} // namespace spectrel
