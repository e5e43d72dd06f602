#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "GPRS Information": the packet parameters of the serving GSM cell, from seven records of which each carries a few.
class GPRSInformation final : public Base {
public:
    GPRSInformation(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
