#include "Records/TelephonyConstants.h"
#include "Sections/UTRAN/UTRANLogGenerator.h"
#include "Tests/Sections/TemplateFixture.h"

namespace spectrel {
namespace {

class UTRANTemplateTest : public TemplateFixture { };

TEST_F(UTRANTemplateTest, EveryKeyOfEverySectionStandsInTheTemplateAndIsWritten)
{
    const auto generator = UTRANLogGenerator::generator(context);
    build(*generator);
    const std::string shipped = outline();
    generator->updateState(state,
        RecordBuilder::withPropertyList(0xFF0001,
            List::make({Dictionary::make({
                {std::string(kRKCellMonitorCellRadioAccessTechnology), kRKCellMonitorRadioAccessTechnologyUTRAN2},
                {std::string(kRKCellMonitorCellType), kRKCellMonitorCellTypeServing},
                {std::string(kRKCellMonitorLAC), Value::integer(1)},
                {std::string(kRKCellMonitorBandInfo), Value::integer(1)},
                {std::string(kRKCellMonitorSCN), Value::integer(1)},
            })})));
    generator->updateState(state, RecordBuilder(0xD0E0, 15));
    generator->updateState(state, RecordBuilder(0xD0E2, 26));
    generator->updateState(state, RecordBuilder(0xD00A, 200).u8(16, 2));
    generator->updateState(state, RecordBuilder(0xD00E, 30).u8(16, 1));
    generator->updateState(state, RecordBuilder(0xD00C, 400).u8(14, 1 << 6).u8(15, 1 << 4));
    generator->updateState(state, oneContext());
    generator->updateState(state, everySimFile());
    EXPECT_EQ(outline(), shipped);
    EXPECT_EQ(awaiting(), "");
}

TEST_F(UTRANTemplateTest, StartCommandAsksForEveryCode)
{
    const auto generator = UTRANLogGenerator::generator(context);
    const DictionaryRef command = generator->getStartCommand();
    EXPECT_EQ((*command)["SetZephyrLogCodes"].list()->count(), 5u);
    EXPECT_EQ((*command)["SetRkExtraCodes"].list()->count(), 3u);
}

} // namespace
} // namespace spectrel
