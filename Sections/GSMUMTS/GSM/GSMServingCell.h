#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "GSM Serving Cell": the GSM serving cell's identity (0x5134), level and path-loss criteria (0x5137), dedicated
/// channel (0x5076), and what the cell-information record tells of it (0xFF0001). Keys written by several of them show
/// whichever came last.
class GSMServingCell final : public Base {
public:
    GSMServingCell(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
