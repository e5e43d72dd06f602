#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "UMTS Set": the UMTS cells that were ranked for reselection (0x4005), or the UMTS neighbours of the cell-information
/// record (0xFF0001), whichever came last.
class UMTSSet final : public Base {
public:
    UMTSSet(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;

private:
    void updateRanked(RecordView record);
};

} // namespace spectrel
