#include "Sections/LTE/ConnectedModeMeasurementMisc.h"

#include "Sections/LTE/ConnectedModeRecord.h"
#include "Sections/LTE/LTEKind.h"

#include <array>

namespace spectrel {

namespace {

constexpr RecordKind OwnRecord = lteKind(
    "Connected mode LTE Intra-frequency Measurement", ConnectedModeRecord::Code, ConnectedModeRecord::MinimumLength);

constexpr std::array<Field, 5> Fields {{
    {17, Width::U16, "E-ARFCN", decimal},
    {19, Width::U16, "Serving Physical Cell ID", decimal},
    {21, Width::U16, "Subframe Number", decimal},
    {23, Width::U16, "Serving Filtered RSRP", ConnectedModeRecord::FilteredRSRP},
    {25, Width::U16, "Serving Filtered RSRQ", ConnectedModeRecord::FilteredRSRQ},
}};

} // namespace

ConnectedModeMeasurementMisc::ConnectedModeMeasurementMisc(ClassDictionary& dict, CodeDictionary& codeDict)
    : RecordSection(OwnRecord, dict, codeDict)
{
}

void ConnectedModeMeasurementMisc::decode(RecordView record)
{
    storeFields(record, Fields, sectionRef);
}

} // namespace spectrel
