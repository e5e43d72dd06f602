#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "RRC Info", code 0xD0E0: the mode of the radio resource control (3GPP TS 25.331, 7.1).
///
/// A short record is told in the log and decoded all the same, unlike any other section's. Each record's outcome goes
/// to the diagnostic log.
class RRC_State final : public Base {
public:
    RRC_State(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
