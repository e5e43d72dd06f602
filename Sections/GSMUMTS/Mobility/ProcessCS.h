#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "Process CS": circuit-switched mobility management (0x7131) and the registration state (0x7132).
class ProcessCS final : public Base {
public:
    ProcessCS(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
