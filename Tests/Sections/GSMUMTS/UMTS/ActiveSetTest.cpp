#include "Sections/GSMUMTS/UMTS/UMTSCellSets.h"

#include "Tests/Sections/GSMUMTS/UMTS/UMTSCellSetsRecord.h"
#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

class ActiveSetTest : public SectionFixture<ActiveSet> {
protected:
    ActiveSetTest()
        : SectionFixture(List::make({"old"}))
    {
    }
};

constexpr const char* Trace = "<4>ActiveSet\n";
constexpr std::uint32_t SevenBelow = 120000; // an energy of -7 dB

TEST_F(ActiveSetTest, SubscribesToItsCode)
{
    EXPECT_EQ(section.getSectionName(), "Active Set");
    EXPECT_EQ(section.getLogCodeArray(), (std::vector<std::uint32_t> {0x417A}));
}

TEST_F(ActiveSetTest, OnlyCellsOfSetTypeZeroAreListed)
{
    deliver(0x417A, umtsCellSets(-500, {{500, 0, {SevenBelow, 0, 0}}, {501, 1, {SevenBelow, 0, 0}}}));
    EXPECT_EQ(display(), // (-500 + 512) / 10 - 106 - 7
        "[{\"Scrambling Code\": \"500\", \"RSCP\": \"-112 dB\", \"Energy Per Chip\": \"-7 dB\"}]");
    EXPECT_EQ(log(), Trace);
}

TEST_F(ActiveSetTest, EverySetTypeButZeroIsSkipped)
{
    for (std::uint32_t type = 1; type < 8; ++type) {
        deliver(0x417A, umtsCellSets(0, {{0x1FFF, type, {1, 1, 1}}}));
        EXPECT_EQ(display(), "[]") << type;
    }
}

TEST_F(ActiveSetTest, LevelIsDividedTowardsZero)
{
    deliver(0x417A, umtsCellSets(-1000, {{9, 0, {SevenBelow, 0, 0}}}));
    EXPECT_EQ(display(), "[{\"Scrambling Code\": \"9\", \"RSCP\": \"-161 dB\", \"Energy Per Chip\": \"-7 dB\"}]");
    const std::pair<std::int16_t, const char*> around[] = {
        {-522, "-107 dB"}, {-521, "-106 dB"}, {-503, "-106 dB"}, {-502, "-105 dB"}};
    for (const auto& [level, power] : around) {
        deliver(0x417A, umtsCellSets(level, {{9, 0, {0, 0, 0}}}));
        EXPECT_NE(display().find(power), std::string::npos) << level << " shows " << display();
    }
}

TEST_F(ActiveSetTest, LevelsAtBothEndsOfTheirRange)
{
    deliver(0x417A, umtsCellSets(-32768, {{1, 0, {524288, 0, 0}}}));
    EXPECT_EQ(display(), "[{\"Scrambling Code\": \"1\", \"RSCP\": \"-3331 dB\", \"Energy Per Chip\": \"0 dB\"}]");
    deliver(0x417A, umtsCellSets(32767, {{1, 0, {706, 0, 0}}}));
    EXPECT_EQ(display(), "[{\"Scrambling Code\": \"1\", \"RSCP\": \"3190 dB\", \"Energy Per Chip\": \"-31 dB\"}]");
}

TEST_F(ActiveSetTest, FirstEnergyThatIsNotZeroCounts)
{
    deliver(0x417A,
        umtsCellSets(-512,
            {{1, 0, {417648, 331809, 263625}}, {2, 0, {0, 331809, 263625}}, {3, 0, {0, 0, 263625}},
                {4, 0, {0, 0, 0}}}));
    EXPECT_EQ(display(),
        "[{\"Scrambling Code\": \"1\", \"RSCP\": \"-107 dB\", \"Energy Per Chip\": \"-1 dB\"}, "
        "{\"Scrambling Code\": \"2\", \"RSCP\": \"-108 dB\", \"Energy Per Chip\": \"-2 dB\"}, "
        "{\"Scrambling Code\": \"3\", \"RSCP\": \"-109 dB\", \"Energy Per Chip\": \"-3 dB\"}, "
        "{\"Scrambling Code\": \"4\", \"RSCP\": \"-106 dB\", \"Energy Per Chip\": \"0 dB\"}]");
}

TEST_F(ActiveSetTest, ScramblingCodeHas13Bits)
{
    deliver(0x417A, umtsCellSets(-512, {{0x1FFF, 0, {0, 0, 0}}}));
    EXPECT_EQ(display(), "[{\"Scrambling Code\": \"8191\", \"RSCP\": \"-106 dB\", \"Energy Per Chip\": \"0 dB\"}]");
}

TEST_F(ActiveSetTest, NoCellsEmptyTheList)
{
    deliver(0x417A, umtsCellSets(-500, {}));
    EXPECT_EQ(display(), "[]");
}

TEST_F(ActiveSetTest, RecordOneByteTooShortLeavesTheList)
{
    deliver(0x417A, RecordBuilder(0x417A, 15));
    EXPECT_EQ(display(), "[\"old\"]");
    EXPECT_EQ(log(), Trace);
}

TEST_F(ActiveSetTest, CellsPastTheEndOfTheRecordReadAsZeros)
{
    deliver(0x417A, umtsCellSets(-512, {{7, 0, {SevenBelow, 0, 0}}}).u8(15, 255));
    EXPECT_EQ(
        countOf("{\"Scrambling Code\": \"7\", \"RSCP\": \"-106 dB\", \"Energy Per Chip\": \"0 dB\"}", display()), 1u);
    EXPECT_EQ(
        countOf("{\"Scrambling Code\": \"0\", \"RSCP\": \"-106 dB\", \"Energy Per Chip\": \"0 dB\"}", display()), 254u);
}

TEST_F(ActiveSetTest, ReadingACellPastTheCountRaises)
{
    const RecordBuilder record = umtsCellSets(-512, {{7, 0, {SevenBelow, 0, 0}}});
    const UMTSCellSets sets {RecordView(record)};
    EXPECT_EQ(sets.scramblingCode(0), 7u);
    EXPECT_THROW(sets.setType(1), ArrayOutOfBoundsException);
    EXPECT_THROW(sets.scramblingCode(1), ArrayOutOfBoundsException);
    EXPECT_EQ(sets.energy(0), SevenBelow);
    EXPECT_THROW(sets.energy(1), ArrayOutOfBoundsException);
}

TEST_F(ActiveSetTest, OtherCodeIsLoggedAsUnknownAndLeavesTheList)
{
    deliver(0x417B, RecordBuilder(0x417B, 80));
    EXPECT_EQ(display(), "[\"old\"]");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: 16763\n");
}

} // namespace
} // namespace spectrel
