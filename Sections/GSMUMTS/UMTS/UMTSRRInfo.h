#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "UMTS RR Info": the RRC state (0x4125), transmit power (0x4031), serving cell (0x4127) and ciphering (0x4157) of a
/// UMTS connection, and what the cell-information record tells of the serving cell (0xFF0001). Keys written by several
/// of them show whichever came last.
class UMTSRRInfo final : public Base {
public:
    UMTSRRInfo(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;

private:
    void updateServingCell(RecordView record);
};

} // namespace spectrel
