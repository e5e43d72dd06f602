#include "Telephony/Encoders/PropertyListRecords.h"

#include "Telephony/Reports/LTECell.h"
#include "Tests/Telephony/RecordBytes.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyList.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(PropertyListRecordsTest, CellInformationNamesTheServingCellFirst)
{
    LTECell served;
    served.physicalCellId = 311;
    LTECell neighbour;
    neighbour.physicalCellId = 17;
    const LTECell* const neighbours[] = {&neighbour, &neighbour};
    const Bytes record = lteCellInformationRecord(served, neighbours, Epoch1980);
    const auto cells = parsePropertyList(ByteView(record).subspan(13));
    ASSERT_TRUE(cells && cells->list());
    EXPECT_EQ(cells->list()->count(), 3u);
    const auto& serving = *(*cells->list())[0].dictionary();
    EXPECT_EQ(serving["kRKCellMonitorCellType"], Value("kRKCellMonitorCellTypeServing"));
    EXPECT_EQ(serving["kRKCellMonitorPID"].int32(), 311);
    EXPECT_EQ((*(*cells->list())[1].dictionary())["kRKCellMonitorPID"].int32(), 17);
}

} // namespace
} // namespace spectrel
