#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "Process CO": the mobility-management state (0x7131) and the registration state (0x7132).
class ProcessCO final : public Base {
public:
    ProcessCO(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
