#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "Serving Cell Info": the LTE serving cell, from two physical-layer records (0xB0C2, 0xB0C1) and from the
/// cell-information record (0xFF0001). Keys written by several of them show whichever came last.
class LTEServingCellInfo final : public Base {
public:
    LTEServingCellInfo(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;

private:
    void updateServingCell(RecordView record);
    void updateAntennas(RecordView record);
    void updateFromCellInformation(RecordView record);
};

} // namespace spectrel
