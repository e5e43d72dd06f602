#pragma once

#include "LogGenerator/Template/RecordSection.h"

namespace spectrel {

/// "Serving Cell Measurements", code 0xB17F: the serving cell as idle mode measures it and judges it for reselection.
class ServingCellMeasurement final : public RecordSection {
public:
    ServingCellMeasurement(ClassDictionary& dict, CodeDictionary& codeDict);

private:
    void decode(RecordView record) override;
};

} // namespace spectrel
