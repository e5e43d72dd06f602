#include "CommandLine/Commands/Report.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(RecordingOfFileTest, NumbersAtTheEndGoOnFromEachOther)
{
    EXPECT_EQ(recordingOfFile("drives/a.pcap"), "drives/a");
    EXPECT_EQ(recordingOfFile("drives/a-2.pcap"), "drives/a");
    EXPECT_EQ(recordingOfFile("drives/a-12.pcap"), "drives/a");
    EXPECT_EQ(recordingOfFile("probe/spectrel-000001-lte.pcap"), "probe/spectrel");
    EXPECT_EQ(recordingOfFile("probe/spectrel-000002-gsm.pcap"), "probe/spectrel");
}

TEST(RecordingOfFileTest, OtherNamesStandForThemselves)
{
    EXPECT_EQ(recordingOfFile("a2.pcap"), "a2");
    EXPECT_EQ(recordingOfFile("before-lte.pcap"), "before-lte");
    EXPECT_EQ(recordingOfFile("-2.pcap"), "-2");
    EXPECT_EQ(recordingOfFile("2024.pcap"), "2024");
    EXPECT_EQ(recordingOfFile("-"), "-");
    EXPECT_EQ(recordingOfFile("x/a-2.pcap"), "x/a") << "of another folder than a.pcap";
}

} // namespace
} // namespace spectrel
