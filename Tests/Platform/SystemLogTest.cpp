#include "Platform/SystemLog.h"

#include "Tests/Fakes/LogRecorder.h"

#include <gtest/gtest.h>

namespace spectrel {

TEST(SystemLogTest, LinesAreFormattedAsPrintfDoes)
{
    LogRecorder log;
    SPECTREL_LOG(log, Priority::Error, "got error=%d from %s", -3, "port");
    EXPECT_EQ(log.takeLog(), "<3>got error=-3 from port\n");
}

TEST(SystemLogTest, LongLinesAreWrittenInFull)
{
    LogRecorder log;
    for (const std::size_t length : {1022u, 1023u, 1024u, 1025u, 5000u}) {
        const std::string text(length, 'x');
        SPECTREL_LOG(log, Priority::Warning, "%s", text.c_str());
        EXPECT_EQ(log.takeLog(), "<4>" + text + "\n");
    }
}

TEST(SystemLogTest, UnwantedLinesAreNotEvenFormatted)
{
    LogRecorder log(Priority::Error);
    int evaluated = 0;
    SPECTREL_LOG(log, Priority::Warning, "%d", ++evaluated);
    EXPECT_EQ(evaluated, 0);
    EXPECT_EQ(log.takeLog(), "");
    SPECTREL_LOG(log, Priority::Error, "%d", ++evaluated);
    EXPECT_EQ(log.takeLog(), "<3>1\n");
}

TEST(SystemLogTest, SeverityIsTheLowThreeBitsOfThePriority)
{
    LogRecorder log(0);
    SPECTREL_LOG(log, Priority::SnapshotWriter, "raw %d", 16);
    EXPECT_EQ(log.takeLog(), "<16>raw 16\n");
}

TEST(SystemLogTest, NothingIsWantedWithoutALog)
{
    EXPECT_FALSE(SystemLog::none().wants(0));
    int evaluated = 0;
    SPECTREL_LOG(SystemLog::none(), 0, "%d", ++evaluated);
    EXPECT_EQ(evaluated, 0);
}

TEST(SystemLogTest, AssertionFailureTellsTextFileAndLine)
{
    LogRecorder log;
    reportAssertionFailure(log, "LogGenerator/GSM/GSMLogGenerator", 90, "Could not deserialize the object");
    EXPECT_EQ(log.takeLog(), "<3>Could not deserialize the object (LogGenerator/GSM/GSMLogGenerator:90)\n");
}

} // namespace spectrel
