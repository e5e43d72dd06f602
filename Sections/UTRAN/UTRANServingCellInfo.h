#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "Serving Cell Info": the UTRAN serving cell, from its own record (0xD0E2) and from the cell-information record
/// (0xFF0001). Keys written by both show whichever came last.
class UTRANServingCellInfo final : public Base {
public:
    UTRANServingCellInfo(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;

private:
    void updateServingCell(RecordView record);
    void updateFromCellInformation(RecordView record);
    void showOneChannelBothWays(const Dictionary& cell);
};

} // namespace spectrel
