#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "Serving PLMN": the network that serves the phone, from the serving-network record (0x7135), the registration state
/// (0x7132) and the cell-information record (0xFF0001). Keys written by several of them show whichever came last;
/// country and network codes are digits in the first and plain numbers in the last, which have no leading zeros.
class ServingPLMN final : public Base {
public:
    ServingPLMN(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
