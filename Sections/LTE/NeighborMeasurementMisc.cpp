#include "Sections/LTE/NeighborMeasurementMisc.h"

#include "Sections/LTE/IdleNeighbourRecord.h"
#include "Sections/LTE/LTEKind.h"
#include "Sections/LTE/Levels.h"

#include <array>

namespace spectrel {

namespace {

constexpr RecordKind OwnRecord =
    lteKind("Neighbor Measurements", IdleNeighbourRecord::Code, IdleNeighbourRecord::MinimumLength);

constexpr std::array<Field, 3> Fields {{
    {13, Width::U8, "Version", decimal},
    {17, Width::U16, "E-ARFCN", decimal},
    {19, bits(0, 6), "Qrxlevmin", Qrxlevmin},
}};

} // namespace

NeighborMeasurementMisc::NeighborMeasurementMisc(ClassDictionary& dict, CodeDictionary& codeDict)
    : RecordSection(OwnRecord, dict, codeDict)
{
}

void NeighborMeasurementMisc::decode(RecordView record)
{
    storeFields(record, Fields, sectionRef);
}

} // namespace spectrel
