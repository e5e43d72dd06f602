#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "GSM Set": the GSM cells that were ranked for reselection (0x4005).
class GSMSet final : public Base {
public:
    GSMSet(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
