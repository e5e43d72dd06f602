#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "Process PS": packet-switched mobility management (GMM, 0x7130) and the registration state (0x7132).
class ProcessPS final : public Base {
public:
    ProcessPS(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
