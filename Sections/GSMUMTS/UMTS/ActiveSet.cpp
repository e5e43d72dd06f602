#include "Sections/GSMUMTS/UMTS/ActiveSet.h"

#include "Platform/SystemLog.h"
#include "Sections/GSMUMTS/UMTS/UMTSCellSets.h"
#include "Values/Dictionary.h"
#include "Values/TextBuffer.h"

namespace spectrel {

namespace {

/// Received signal code power in dBm: the carrier's level, and of it the cell's share `ecno` in decibels.
int signalCodePower(std::int16_t receivedLevel, int ecno)
{
    return (receivedLevel + 512) / 10 - 106 + ecno;
}

DictionaryRef activeCell(const UMTSCellSets& sets, std::size_t index)
{
    const int ecno = Base::lookUpECNO(sets.energy(index));
    TextBuffer code;
    TextBuffer power;
    TextBuffer energy;
    return Dictionary::make({
        {"Scrambling Code", code.decimal(sets.scramblingCode(index)).view()},
        {"RSCP", power.decimal(signalCodePower(sets.receivedLevel(), ecno)).text(" dB").view()},
        {"Energy Per Chip", energy.decimal(ecno).text(" dB").view()},
    });
}

} // namespace

ActiveSet::ActiveSet(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view ActiveSet::getSectionName() const
{
    return "Active Set";
}

std::vector<std::uint32_t> ActiveSet::getLogCodeArray() const
{
    return {UMTSCellSetsCode};
}

void ActiveSet::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "ActiveSet");
    if (logCode != UMTSCellSetsCode)
        return logUnknownMessage(logCode);
    const auto& list = sectionRef.list();
    if (record.size() < UMTSCellSetsMinimumLength || !list)
        return;
    const UMTSCellSets sets(record);
    List cells;
    for (std::size_t index = 0; index < sets.count(); ++index) {
        if (sets.setType(index) == UMTSCellSets::ActiveSetType)
            cells.append(activeCell(sets, index));
    }
    replaceArray(*list, cells);
}

} // namespace spectrel
