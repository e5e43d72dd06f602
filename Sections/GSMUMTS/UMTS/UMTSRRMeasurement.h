#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "UMTS RR Measurement": keeps its place on the screen; no record fills it.
class UMTSRRMeasurement final : public Base {
public:
    UMTSRRMeasurement(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    /// Only logs its line.
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
