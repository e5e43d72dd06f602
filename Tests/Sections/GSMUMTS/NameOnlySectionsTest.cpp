// The sections that only keep their place on the screen.

#include "Sections/GSMUMTS/NameOnlySections.h"
#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

template <typename Section> void expectOnly(const char* name, const char* trace)
{
    LogRecorder recorder;
    SectionRegistry registry(recorder.context());
    Section section(registry);
    EXPECT_EQ(section.getSectionName(), name);
    EXPECT_EQ(registry.classDict.find(name)->second, &section);
    EXPECT_TRUE(section.getLogCodeArray().empty());
    EXPECT_TRUE(registry.codeDictionary.allKeys().empty());
    const Value node(Dictionary::make({{"key", "old"}}));
    section.updateSectionRef(node);
    recorder.takeLog();
    section.updateWithData(RecordView(RecordBuilder(0x5137, 60)), 0x5137);
    EXPECT_EQ(recorder.takeLog(), trace);
    EXPECT_EQ(displayText(node), "{\"key\": \"old\"}");
}

TEST(NameOnlySectionsTest, CellChangeCountersOnlyLogsItsLine)
{
    expectOnly<CellChangeCounters>("Cell Change Counters", "<4>CellChangeCounters\n");
}

TEST(NameOnlySectionsTest, CodingSchemeLogsTheLineOfTheCounters)
{
    expectOnly<CodingScheme>("Coding Scheme", "<4>CellChangeCounters\n");
}

TEST(NameOnlySectionsTest, NonRankedGSMSetOnlyLogsItsLine)
{
    expectOnly<NonRankedGSMSet>("Non-Ranked GSM Set", "<4>NonRankedGSMSet\n");
}

TEST(NameOnlySectionsTest, NonRankedUMTSSetOnlyLogsItsLine)
{
    expectOnly<NonRankedUMTSSet>("Non-Ranked UMTS Set", "<4>NonRankedUMTSSet\n");
}

TEST(NameOnlySectionsTest, UMTSRRMeasurementOnlyLogsItsLine)
{
    expectOnly<UMTSRRMeasurement>("UMTS RR Measurement", "<4>UMTSRRMeasurement\n");
}

} // namespace
} // namespace spectrel
