#include "Sections/GSMUMTS/GSM/MobileAllocation.h"

#include "LogGenerator/Template/RepeatedGroup.h"
#include "Platform/SystemLog.h"

#include <array>

namespace spectrel {

namespace {

constexpr std::uint32_t MobileAllocationCode = 0x51F8;
constexpr std::size_t MobileAllocationMinimumLength = 15; // bytes, 13-byte header included

/// Mobile allocation, code 0x51F8; the frequencies follow.
constexpr std::array<Field, 1> MobileAllocationFields {{
    {13, Width::U8, "HSN", decimal},
}};

} // namespace

MobileAllocation::MobileAllocation(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view MobileAllocation::getSectionName() const
{
    return "Mobile Allocation";
}

std::vector<std::uint32_t> MobileAllocation::getLogCodeArray() const
{
    return {MobileAllocationCode};
}

void MobileAllocation::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "MobileAllocation");
    if (logCode != MobileAllocationCode)
        return logUnknownMessage(logCode);
    if (record.size() < MobileAllocationMinimumLength)
        return;
    storeFields(record, MobileAllocationFields, sectionRef);
    const RepeatedGroup frequencies {15, 2, record.u8(14)};
    auto channels = List::make();
    for (std::size_t index = 0; index < frequencies.count; ++index)
        channels->append(TextBuffer().decimal(record.u16(frequencies.entry(index))).view());
    store("ARFCNs", channels);
}

} // namespace spectrel
