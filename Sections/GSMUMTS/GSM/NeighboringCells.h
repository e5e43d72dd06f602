#pragma once

#include "LogGenerator/Template/Base.h"

#include <map>

namespace spectrel {

/// "Neighboring Cells": the GSM neighbours as the phone measures them (0x5137), each with the BSIC that was last
/// reported for its channel (0x51FF), or the GSM neighbours of the cell-information record (0xFF0001), whichever came
/// last.
class NeighboringCells final : public Base {
public:
    NeighboringCells(ClassDictionary& dict, CodeDictionary& codeDict);

    std::string_view getSectionName() const override;
    std::vector<std::uint32_t> getLogCodeArray() const override;
    void updateWithData(RecordView record, std::uint32_t logCode) override;

private:
    void updateBSICs(RecordView record);
    void updateMeasured(RecordView record);

    std::map<std::uint16_t, std::uint8_t> arfcnToBsic; // as the last 0x51FF record told
};

} // namespace spectrel
