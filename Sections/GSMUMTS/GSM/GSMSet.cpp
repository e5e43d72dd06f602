#include "Sections/GSMUMTS/GSM/GSMSet.h"

#include "LogGenerator/Template/RepeatedGroup.h"
#include "Platform/SystemLog.h"

#include <array>

namespace spectrel {

namespace {

constexpr std::uint32_t RankedNeighborsCode = 0x4005;
constexpr std::size_t RankedNeighborsMinimumLength = 15; // bytes, 13-byte header included

/// A ranked GSM cell of code 0x4005, in writing order; offsets from the entry's first byte.
constexpr std::array<Field, 4> GSMCellFields {{
    {0, Width::U16, "ARFCN", decimal},
    {2, Width::U16, "BSIC", decimal},
    {4, Width::S8, "RSSI", decimalDBm},
    {5, Width::S16, "Ranking Value", decimal},
}};

} // namespace

GSMSet::GSMSet(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view GSMSet::getSectionName() const
{
    return "GSM Set";
}

std::vector<std::uint32_t> GSMSet::getLogCodeArray() const
{
    return {RankedNeighborsCode};
}

void GSMSet::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "GSMSet");
    if (logCode != RankedNeighborsCode)
        return logUnknownMessage(logCode);
    if (record.size() < RankedNeighborsMinimumLength || !sectionRef.list())
        return;
    // The entries are read from the start of the UMTS ones, which are not skipped: kept on purpose.
    const RepeatedGroup cells {15, 7, record.u8(14)};
    replaceArray(*sectionRef.list(), *entriesWithFields(record, cells, GSMCellFields));
}

} // namespace spectrel
