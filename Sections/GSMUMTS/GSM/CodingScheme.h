#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "Coding Scheme": keeps its place on the screen; no record fills it.
class CodingScheme final : public Base {
public:
    CodingScheme(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    /// Only logs its line.
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
