#include "Records/TelephonyConstants.h"
#include "Sections/LTE/LTELogGenerator.h"
#include "Tests/Sections/TemplateFixture.h"

namespace spectrel {
namespace {

class LTETemplateTest : public TemplateFixture { };

TEST_F(LTETemplateTest, EveryKeyOfEverySectionStandsInTheTemplateAndIsWritten)
{
    const auto generator = LTELogGenerator::generator(context);
    build(*generator);
    const std::string shipped = outline();
    for (const std::uint32_t code : {0xB0C2u, 0xB0C1u, 0xB17Fu, 0xB180u})
        generator->updateState(state, RecordBuilder(code, 60));
    generator->updateState(state, RecordBuilder(0xB179, 60).u8(27, 1).u8(28, 1));
    generator->updateState(state, RecordBuilder(0xB186, 60).u8(19, 1));
    generator->updateState(state, everySimFile());
    generator->updateState(state, oneContext());
    generator->updateState(state,
        RecordBuilder::withPropertyList(0xFF0001,
            List::make({Dictionary::make({
                {std::string(kRKCellMonitorCellRadioAccessTechnology), kRKCellMonitorRadioAccessTechnologyLTE},
                {std::string(kRKCellMonitorCellType), kRKCellMonitorCellTypeServing},
                {std::string(kRKCellMonitorUARFCN), Value::integer(1300)},
            })})));
    EXPECT_EQ(outline(), shipped);
    EXPECT_EQ(awaiting(), "");
}

} // namespace
} // namespace spectrel
