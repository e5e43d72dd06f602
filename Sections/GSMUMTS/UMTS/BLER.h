#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "BLER": how many blocks of each transport channel came, and how many of them damaged (0x4116).
class BLER final : public Base {
public:
    BLER(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
