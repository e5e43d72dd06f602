#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "PDP Context Info": the packet data contexts, code 0xFF0002, exactly as the telephony service sent them. Shared by
/// every technology.
class PDPContextList final : public Base {
public:
    PDPContextList(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    /// Replaces the list; a payload that is no list changes nothing.
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
