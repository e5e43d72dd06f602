#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "Mobile Allocation": the hopping sequence number and the frequencies hopped over (0x51F8).
class MobileAllocation final : public Base {
public:
    MobileAllocation(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
