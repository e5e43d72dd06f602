#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "SIM Info": the SIM elementary files that the telephony service reports, code 0xFF0000. Shared by every technology.
class SimInfo final : public Base {
public:
    SimInfo(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    /// Stores the files that the payload holds as they are; those it lacks keep their values. A payload that does not
    /// parse raises `LogCode_0xFF0000::UnknownDataException`.
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
