#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "Virtual Active Set": a list of its own, which every cell-set record (0x417A) empties; no record ever fills it.
class VirtualActiveSet final : public Base {
public:
    VirtualActiveSet(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
