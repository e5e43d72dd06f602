#include "Sections/GSMUMTS/UMTS/UMTSRRMeasurement.h"

#include "Platform/SystemLog.h"

namespace spectrel {

UMTSRRMeasurement::UMTSRRMeasurement(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view UMTSRRMeasurement::getSectionName() const
{
    return "UMTS RR Measurement";
}

std::vector<std::uint32_t> UMTSRRMeasurement::getLogCodeArray() const
{
    return {};
}

void UMTSRRMeasurement::updateWithData(RecordView, std::uint32_t)
{
    SPECTREL_LOG(Priority::Warning, "UMTSRRMeasurement");
}

} // namespace spectrel
