#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "Active Set": the cells that the UMTS receiver combines (0x417A).
class ActiveSet final : public Base {
public:
    ActiveSet(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
