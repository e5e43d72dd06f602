#include "Analysis/Report/ReportPage.h"

#include "Tests/Analysis/Report/ReportSamples.h"

#include <cstdlib>
#include <fstream>
#include <gmock/gmock.h>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {
namespace {

using testing::HasSubstr;
using testing::Not;

std::size_t countOf(const std::string& text, std::string_view part)
{
    std::size_t count = 0;
    for (std::size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + part.size()))
        ++count;
    return count;
}

TEST(ReportPageTest, NothingIsFetchedAndNothingRuns)
{
    const std::string page = reportPage({sampleRecording("drive", 600, 3)});
    EXPECT_TRUE(page.starts_with(ReportBeginning));
    for (const char* part : {"<script", "http:", "https:", "src=", "href=", "url(", "@import", "javascript"})
        EXPECT_THAT(page, Not(HasSubstr(part)));
    EXPECT_THAT(page, HasSubstr("default-src 'none'"));
}

TEST(ReportPageTest, FindingsComeFirst)
{
    ReportedRecording recording = sampleRecording("drive", 600, 3);
    recording.findings.push_back({ReportStart, "ping-pong", "To PCI 51 and back within 4 s.", {}, {}, 4.0,
        {{"/Serving Cell Info/Physical Cell ID", "51"}}, ReportedEvent::Mark::None});
    const std::string page = reportPage({recording});
    EXPECT_LT(page.find("To PCI 51 and back within 4 s. (0:04)"), page.find("What was recorded"));
    EXPECT_LT(page.find("What was recorded"), page.find("<svg"));
    EXPECT_THAT(page, HasSubstr("<code>/Serving Cell Info/Physical Cell ID</code> 51"));
}

TEST(ReportPageTest, CellsHaveTheirTimeBandAndLevels)
{
    const std::string page = reportPage({sampleRecording("drive", 90, 2)});
    EXPECT_THAT(page, HasSubstr("<td>4101-0</td><td>PCI 50</td><td>3</td><td>1815.0</td><td>1300</td><td>1:00 "));
    EXPECT_THAT(page, HasSubstr("<td>4101-1</td><td>PCI 51</td><td>3</td><td>1815.0</td><td>1300</td><td>0:30 "));
    EXPECT_THAT(page, HasSubstr("RSRP -"));
}

TEST(ReportPageTest, EachChartHasANameAndATable)
{
    const std::string page = reportPage({sampleRecording("drive", 600, 3)});
    EXPECT_EQ(countOf(page, "<svg"), 4u) << "RSRP and RSRQ over time, and their distributions";
    EXPECT_EQ(countOf(page, "role=\"img\" aria-labelledby="), 4u);
    EXPECT_EQ(countOf(page, "<figure>"), 4u);
    EXPECT_EQ(countOf(page, "<summary>As a table</summary>"), 2u);
    EXPECT_EQ(countOf(page, "id=\"l0r0t\""), 1u);
}

TEST(ReportPageTest, SeveralRecordingsShareTheirScales)
{
    const std::string page = reportPage({sampleRecording("before", 600, 3), sampleRecording("after", 600, 3, 20)});
    EXPECT_THAT(page, HasSubstr("<title>Radio report: before, after</title>"));
    EXPECT_EQ(countOf(page, ">-110</text>"), 3u) << "two charts and one distribution";
    EXPECT_EQ(countOf(page, ">-60</text>"), 3u);
    EXPECT_EQ(countOf(page, "id=\"l0r1t\""), 1u);
}

TEST(ReportPageTest, TextsOfTheRecordingAreNoMarkup)
{
    ReportedRecording recording = sampleRecording("<b>&drive", 60, 1);
    recording.events.push_back({ReportStart, "bookmark", "say \"<script>\"\x01\xff", {}, {}, {}, {}, {}});
    recording.cells[0].cell.operatorName = "A&B";
    const std::string page = reportPage({recording});
    EXPECT_THAT(page, Not(HasSubstr("<script")));
    EXPECT_THAT(page, HasSubstr("say &quot;&lt;script&gt;&quot;\xEF\xBF\xBD\xEF\xBF\xBD"));
    EXPECT_THAT(page, HasSubstr("&lt;b&gt;&amp;drive"));
    EXPECT_THAT(page, HasSubstr("A&amp;B (001-01)"));
}

TEST(ReportPageTest, ServiceLostIsShownUntilItIsBack)
{
    ReportedRecording recording = sampleRecording("tunnel", 600, 1);
    recording.events.clear();
    recording.events.push_back({ReportStart + std::chrono::seconds(60), "service-lost", "lost", {}, {}, {}, {},
        ReportedEvent::Mark::ServiceLost});
    recording.events.push_back({ReportStart + std::chrono::seconds(90), "service-back", "back", {}, {}, {}, {},
        ReportedEvent::Mark::ServiceBack});
    EXPECT_THAT(reportPage({recording}), HasSubstr("<title>without service from 14:08:31 to 14:09:01</title>"));
}

TEST(ReportPageTest, AnEmptyRecordingIsAPage)
{
    ReportedRecording recording;
    recording.title = "empty";
    const std::string page = reportPage({recording});
    EXPECT_THAT(page, HasSubstr("Nothing remarkable in empty."));
    EXPECT_THAT(page, Not(HasSubstr("<svg")));
    EXPECT_TRUE(page.ends_with("</html>\n"));
}

TEST(ReportPageTest, ADayIsSmall)
{
    const std::string page = reportPage({sampleRecording("day", 86400, 40)});
    EXPECT_LT(page.size(), 2u * 1024 * 1024);
}

} // namespace
} // namespace spectrel
