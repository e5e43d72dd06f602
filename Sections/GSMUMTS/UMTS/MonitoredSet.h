#pragma once

#include "LogGenerator/Template/Base.h"

namespace spectrel {

/// "Monitored Set": a list of its own, which every cell-set record (0x417A) empties; no record ever fills it.
class MonitoredSet final : public Base {
public:
    MonitoredSet(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;
};

} // namespace spectrel
