#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "GSM RR Info": the GSM radio-resource state (0x512C), the serving cell's level and quality (0x5137), and whether
/// discontinuous transmission (0x5072) and reception (0x51F6) are used.
class GSMRRInfo final : public Base {
public:
    GSMRRInfo(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
