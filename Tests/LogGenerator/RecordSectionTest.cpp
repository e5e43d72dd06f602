#include "LogGenerator/Template/RecordSection.h"

#include "Records/TelephonyConstants.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Tests/Fakes/RecordBuilder.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

class Described final : public SectionOf<Described> {
    static constexpr std::array<Field, 1> First {{{13, Width::U8, "A", decimal}}};
    static constexpr std::array<Field, 1> Second {{{14, Width::U8, "B", decimal}}};
    static constexpr std::array<CellField, 2> CellNumbers {{
        {kRKCellMonitorTAC, "TAC", decimal, "no TAC"},
        {kRKCellMonitorPID, "PCI", decimal, CellField::Silent},
    }};
    void replaceFirst(RecordView)
    {
        removeKey("A");
        storeText("C", "hooked");
    }
    static constexpr std::array<RecordLayout, 3> Layouts {{
        {.code = 9, .minimumLength = 15, .fields = First, .hook = hook<&Described::replaceFirst>},
        {.code = 4, .fields = Second},
        {.code = CellInfoArrayReader::Code, .cells = {CellChoice::FirstServing, {"X", "Y"}, CellNumbers}},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "Name", .layouts = Layouts, .tracePriority = 5};
};

class RecordSectionTest : public testing::Test {
protected:
    RecordSectionTest()
    {
        section.updateSectionRef(node);
        recorder.takeLog();
    }
    void deliver(std::uint32_t code)
    {
        section.updateWithData(RecordView(RecordBuilder(code, 20).u8(13, 1).u8(14, 2)), code);
    }
    void deliverCell(std::string_view technology)
    {
        const Value cell(Dictionary::make({
            {std::string(kRKCellMonitorCellRadioAccessTechnology), technology},
            {std::string(kRKCellMonitorCellType), kRKCellMonitorCellTypeServing},
        }));
        const auto record = RecordBuilder::withPropertyList(CellInfoArrayReader::Code, List::make({cell}));
        section.updateWithData(RecordView(record), CellInfoArrayReader::Code);
    }

    LogRecorder recorder;
    SectionRegistry registry {recorder.context()};
    Described section {registry};
    const Value node {Dictionary::make()};
};

TEST_F(RecordSectionTest, CodesFollowTheLayoutsInTheirOrder)
{
    EXPECT_EQ(section.getLogCodeArray(), (std::vector<std::uint32_t> {9, 4, CellInfoArrayReader::Code}));
    EXPECT_EQ(registry.codeDictionary.allKeys(), (std::vector<std::string> {"9", "4", "16711681"}));
    EXPECT_EQ(registry.classDict.find("Name")->second, &section);
}

TEST_F(RecordSectionTest, EachCodeHasItsFieldsAndTheHookComesAfterThem)
{
    deliver(4);
    EXPECT_EQ(displayText(node), "{\"B\": \"2\"}");
    deliver(9);
    EXPECT_EQ(displayText(node), "{\"B\": \"2\", \"C\": \"hooked\"}");
}

TEST_F(RecordSectionTest, RecordBelowItsLeastLengthOnlyTraces)
{
    section.updateWithData(RecordView(RecordBuilder(9, 14)), 9);
    EXPECT_EQ(displayText(node), "{}");
    EXPECT_EQ(recorder.takeLog(), "<5>Name\n");
    section.updateWithData(RecordView(RecordBuilder(9, 15)), 9);
    EXPECT_EQ(displayText(node), "{\"C\": \"hooked\"}");
}

TEST_F(RecordSectionTest, NameIsTheTraceOfASectionWithoutOne)
{
    deliver(5);
    EXPECT_EQ(recorder.takeLog(), "<5>Name\n<3>Received an unknown log message: 5\n");
}

TEST_F(RecordSectionTest, NumbersThatACellLacksAreLoggedUnlessTheyAreSilent)
{
    deliverCell("Y");
    EXPECT_EQ(recorder.takeLog(), "<5>Name\n<3>no TAC\n");
    deliverCell("Z");
    deliverCell(""); // the two technologies are all there are
    EXPECT_EQ(recorder.takeLog(), "<5>Name\n<5>Name\n");
}

using Plain = PlainSection<"Plain", "Trace of it">;

TEST(PlainSectionTest, SectionWithoutLayoutsLogsItsLineAndNothingElse)
{
    LogRecorder recorder;
    SectionRegistry registry {recorder.context()};
    Plain plain(registry);
    EXPECT_EQ(plain.getSectionName(), "Plain");
    EXPECT_TRUE(plain.getLogCodeArray().empty());
    recorder.takeLog();
    plain.updateWithData(RecordView({}), 7);
    EXPECT_EQ(recorder.takeLog(), "<4>Trace of it\n");
}

} // namespace
} // namespace spectrel
