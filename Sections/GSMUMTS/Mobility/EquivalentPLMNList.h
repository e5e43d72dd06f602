#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "Equivalent PLMN List": the networks that count as equivalent to the serving one (0x7150).
class EquivalentPLMNList final : public Base {
public:
    EquivalentPLMNList(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
