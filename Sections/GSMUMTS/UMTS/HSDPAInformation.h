#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "HSDPA Info": high-speed downlink decoding statistics (0x4221), with one list of HARQ processes for each carrier. A
/// list stays until a record with processes for that carrier replaces it.
class HSDPAInformation final : public Base {
public:
    HSDPAInformation(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
