#include "Sections/GSMUMTS/UMTS/HSDPAInformation.h"

#include "LogGenerator/Template/RepeatedGroup.h"
#include "Platform/SystemLog.h"

#include <array>

namespace spectrel {

namespace {

constexpr std::uint32_t HSDPACode = 0x4221;
constexpr std::size_t HSDPAMinimumLength = 18; // bytes, 13-byte header included

constexpr std::array<std::string_view, 4> CarrierInfos {{"Single Carrier", "MIMO", "Dual Carrier", "Reserved"}};

/// Decoding statistics, code 0x4221, in writing order; the HARQ processes follow.
constexpr std::array<Field, 3> HSDPAFields {{
    {13, Width::U8, "Version", unsignedDecimal},
    {14, bits(0, 10), "Sub Frames", unsignedDecimal},
    {15, bits(2, 2), "Carrier Info", named<CarrierInfos>},
}};

/// A HARQ process of code 0x4221, in writing order; offsets from the entry's first byte.
constexpr std::array<Field, 4> ProcessFields {{
    {0, Width::U8, "Process ID", unsignedDecimal},
    {1, Width::U32, "No Rx Bits", unsignedDecimal},
    {5, Width::U16, "New Tx", unsignedDecimal},
    {7, Width::U16, "Block Errors", unsignedDecimal},
}};

constexpr std::size_t ProcessSize = 9;
constexpr std::size_t PrimaryProcesses = 18;
/// The secondary carrier's processes stand this far behind for each of the primary's, not directly after them: kept on
/// purpose.
constexpr std::size_t SecondaryDistance = 162;

} // namespace

HSDPAInformation::HSDPAInformation(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view HSDPAInformation::getSectionName() const
{
    return "HSDPA Info";
}

std::vector<std::uint32_t> HSDPAInformation::getLogCodeArray() const
{
    return {HSDPACode};
}

void HSDPAInformation::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "HSDPA Info");
    if (logCode != HSDPACode || record.size() < HSDPAMinimumLength)
        return;
    storeFields(record, HSDPAFields, sectionRef);
    const RepeatedGroup primary {PrimaryProcesses, ProcessSize, record.u8(16)};
    if (primary.count > 0)
        store("Primary HARQ Process", entriesWithFields(record, primary, ProcessFields));
    const RepeatedGroup secondary {PrimaryProcesses + SecondaryDistance * primary.count, ProcessSize, record.u8(17)};
    if (secondary.count > 0)
        store("Secondary HARQ Process", entriesWithFields(record, secondary, ProcessFields));
}

} // namespace spectrel
