#include "CommandLine/Commands/Arguments.h"

#include "CommandLine/Options/OptionTypes.h"

#include <gtest/gtest.h>
#include <limits>
#include <string>
#include <utility>
#include <vector>

namespace spectrel {
namespace {

TEST(ParseDurationTest, UnitsAreMillisecondsSecondsMinutesAndHours)
{
    using namespace std::chrono_literals;
    EXPECT_EQ(parseDuration("30"), 30s);
    EXPECT_EQ(parseDuration("30s"), 30s);
    EXPECT_EQ(parseDuration("1.5m"), 90s);
    EXPECT_EQ(parseDuration("2h"), 2h);
    EXPECT_EQ(parseDuration("500ms"), 500ms);
}

TEST(ParseDurationTest, AnythingElseIsNone)
{
    for (const char* text : {"", "s", "-1", "1 s", "1d", "1.2.3s", "0", "1e3", "99999999999999999999h"})
        EXPECT_FALSE(parseDuration(text)) << text;
}

TEST(ParseOffsetTest, NoTimeAtAllIsAnOffsetButNoDuration)
{
    EXPECT_EQ(parseOffset("0"), std::chrono::milliseconds(0));
    EXPECT_EQ(parseOffset("0s"), std::chrono::milliseconds(0));
    EXPECT_EQ(parseOffset("1.5m"), std::chrono::seconds(90));
    EXPECT_EQ(parseDuration("0.2ms"), std::nullopt);
    EXPECT_EQ(parseOffset("-1s"), std::nullopt);
}

TEST(ParseWholeNumberTest, DigitsAloneWithinTheBounds)
{
    constexpr auto Largest = std::numeric_limits<std::uint64_t>::max();
    EXPECT_EQ(parseWholeNumber("1", 1, Largest), 1u);
    EXPECT_EQ(parseWholeNumber("18446744073709551615", 1, Largest), Largest);
    EXPECT_EQ(parseWholeNumber("0", 0, 9), 0u);
    for (const char* text : {"0", "-1", "+1", "1.5", "1 ", " 1", "x", "0x10", "", "18446744073709551616"})
        EXPECT_EQ(parseWholeNumber(text, 1, Largest), std::nullopt) << text;
    EXPECT_EQ(parseWholeNumber("10", 0, 9), std::nullopt);
}

TEST(ParseNumberTest, FiniteNumbersWithinTheBounds)
{
    EXPECT_EQ(parseNumber("0.5", 0, 10), 0.5);
    EXPECT_EQ(parseNumber("1e1", 0, 10), 10.0);
    for (const char* text : {"nan", "inf", "-inf", "-0.1", "10.1", "1e999", "1x", "", "two"})
        EXPECT_EQ(parseNumber(text, 0, 10), std::nullopt) << text;
}

std::optional<int> read(std::vector<const char*> words, Arguments& arguments)
{
    words.insert(words.begin(), "spectrel");
    return readArguments(static_cast<int>(words.size()), const_cast<char**>(words.data()), arguments);
}

TEST(ReadArgumentsTest, WithoutACommandItIsTheApplication)
{
    Arguments arguments;
    EXPECT_EQ(read({}, arguments), std::nullopt);
    EXPECT_EQ(arguments.job, Job::Application);
    EXPECT_EQ(arguments.screens, ScreenChoice::Automatic);
}

TEST(ReadArgumentsTest, DecodeTakesItsOptions)
{
    Arguments arguments;
    EXPECT_EQ(read({"decode", "--format", "json", "--each", "--keep-going", "--technology", "utran", "--snapshot",
                       "out", "a.pcap", "b.dlf"},
                  arguments),
        std::nullopt);
    EXPECT_EQ(arguments.job, Job::Decode);
    EXPECT_EQ(arguments.decode.files, (std::vector<std::string> {"a.pcap", "b.dlf"}));
    EXPECT_EQ(arguments.decode.output.format, OutputFormat::Json);
    EXPECT_TRUE(arguments.decode.each);
    EXPECT_TRUE(arguments.decode.keepGoing);
    EXPECT_EQ(arguments.decode.technology, Technology::UTRAN);
    EXPECT_EQ(arguments.decode.snapshotDirectory, "out");
}

TEST(ReadArgumentsTest, WatchEndsAfterACountOrATime)
{
    Arguments arguments;
    EXPECT_EQ(read({"watch", "--format", "changes", "--count", "3", "--duration", "2m"}, arguments), std::nullopt);
    EXPECT_EQ(arguments.job, Job::Watch);
    EXPECT_EQ(arguments.watch.output.format, OutputFormat::Changes);
    EXPECT_EQ(arguments.watch.count, 3u);
    EXPECT_EQ(arguments.watch.duration, std::chrono::minutes(2));
}

TEST(ReadArgumentsTest, ViewTakesAFileItsTechnologyAndTheScreens)
{
    Arguments arguments;
    EXPECT_EQ(read({"view", "--terminal", "--technology", "lte", "a.dlf"}, arguments), std::nullopt);
    EXPECT_EQ(arguments.job, Job::View);
    EXPECT_EQ(arguments.screens, ScreenChoice::Terminal);
    EXPECT_EQ(arguments.view.file, "a.dlf");
    EXPECT_EQ(arguments.view.technology, Technology::LTE);
}

TEST(ReadArgumentsTest, ChannelTakesANumberOrAFrequency)
{
    Arguments arguments;
    EXPECT_EQ(read({"channel", "gsm", "600", "--band", "PCS 1900", "--format", "json"}, arguments), std::nullopt);
    EXPECT_EQ(arguments.job, Job::Channel);
    EXPECT_EQ(arguments.channel.technology, ChannelTechnology::GSM);
    EXPECT_EQ(arguments.channel.number, 600u);
    EXPECT_EQ(arguments.channel.band, "PCS 1900");
    EXPECT_EQ(arguments.channel.format, ChannelFormat::Json);
    Arguments frequency;
    EXPECT_EQ(read({"channel", "cdma", "--mhz", "881.52"}, frequency), std::nullopt);
    EXPECT_EQ(frequency.channel.mhz, 881.52);
    EXPECT_EQ(frequency.channel.number, std::nullopt);
}

/// What is told on standard error about the words, which are wrong usage.
std::string complaintAbout(const std::vector<const char*>& words)
{
    Arguments arguments;
    testing::internal::CaptureStderr();
    EXPECT_EQ(read(words, arguments), ExitStatus::WrongUsage);
    return testing::internal::GetCapturedStderr();
}

TEST(ReadArgumentsTest, NumberOutOfItsBoundsIsToldWithThem)
{
    for (const char* text : {"0", "-1", "x", "1.5", "18446744073709551616"}) {
        EXPECT_EQ(complaintAbout({"watch", "--count", text}),
            "spectrel: --count: '" + std::string(text) + "' is no whole number from 1 up (see spectrel --help)\n");
    }
    EXPECT_EQ(complaintAbout({"record", "--keep", "0", "a"}),
        "spectrel: --keep: '0' is no whole number from 1 up (see spectrel --help)\n");
    EXPECT_EQ(complaintAbout({"record", "--rollover", "999", "a"}),
        "spectrel: --rollover: '999' is no size such as 500k, 100M or 2G; the least is 1k (see spectrel --help)\n");
}

TEST(ReadArgumentsTest, EmptyNameOfAFileOrFolderIsWrongUsage)
{
    EXPECT_EQ(complaintAbout({"decode", "--snapshot", "", "a"}),
        "spectrel: --snapshot: '' names no folder (see spectrel --help)\n");
    EXPECT_EQ(complaintAbout({"record", ""}), "spectrel: FILE: '' names no file (see spectrel --help)\n");
    EXPECT_EQ(complaintAbout({"view", ""}), "spectrel: FILE: '' names no file (see spectrel --help)\n");
    EXPECT_EQ(complaintAbout({"--log", ""}), "spectrel: --log: '' names no file (see spectrel --help)\n");
    EXPECT_EQ(complaintAbout({"--resources", ""}), "spectrel: --resources: '' names no folder (see spectrel --help)\n");
}

TEST(ReadArgumentsTest, PathsAndColumnsSayWhatIsPrinted)
{
    Arguments arguments;
    EXPECT_EQ(read({"watch", "--path", "/A/*", "--path", "**/B", "--format", "csv"}, arguments), std::nullopt);
    EXPECT_EQ(arguments.watch.output.paths, (std::vector<std::string> {"/A/*", "**/B"}));
    EXPECT_EQ(read({"decode", "--path", "/A", "a.pcap"}, arguments), std::nullopt);
    EXPECT_EQ(arguments.decode.output.paths, (std::vector<std::string> {"/A"}));
    EXPECT_EQ(arguments.decode.files, (std::vector<std::string> {"a.pcap"}));
    Arguments table;
    EXPECT_EQ(read({"decode", "--format", "table", "--columns", "/A/B=b,/C", "a.pcap"}, table), std::nullopt);
    ASSERT_EQ(table.decode.output.columns.size(), 2u);
    EXPECT_EQ(table.decode.output.columns[0].path, "/A/B");
    EXPECT_EQ(table.decode.output.columns[0].name, "b");
}

TEST(ReadArgumentsTest, TableAndItsColumnsComeTogether)
{
    EXPECT_EQ(complaintAbout({"watch", "--format", "table"}),
        "spectrel: --format: table needs --columns (see spectrel --help)\n");
    EXPECT_EQ(complaintAbout({"watch", "--columns", "/A"}),
        "spectrel: --columns: goes with --format table only (see spectrel --help)\n");
    EXPECT_EQ(complaintAbout({"watch", "--format", "table", "--columns", "/A", "--path", "/A"}),
        "spectrel: --path: a table has its --columns (see spectrel --help)\n");
    EXPECT_EQ(complaintAbout({"watch", "--format", "table", "--columns", "/A,"}),
        "spectrel: --columns: '/A,' is no list of columns PATH[=NAME],... (see spectrel --help)\n");
    EXPECT_EQ(complaintAbout({"watch", "--path", ""}), "spectrel: --path: '' is no path (see spectrel --help)\n");
}

TEST(ReadArgumentsTest, MarkTakesATextAndPerhapsARecording)
{
    Arguments arguments;
    EXPECT_EQ(read({"mark", "tunnel, south end", "--recording", "drive.pcap"}, arguments), std::nullopt);
    EXPECT_EQ(arguments.job, Job::Mark);
    EXPECT_EQ(arguments.mark.note, "tunnel, south end");
    EXPECT_EQ(arguments.mark.recording, "drive.pcap");
    EXPECT_EQ(complaintAbout({"mark"}), "spectrel: TEXT is required (see spectrel --help)\n");
    EXPECT_EQ(complaintAbout({"mark", ""}), "spectrel: TEXT: '' is no note of 1 to 4096 bytes (see spectrel --help)\n");
}

TEST(ReadArgumentsTest, StandardOutputTakesNoOptionOfSeveralFiles)
{
    for (const auto& [option, value] : std::vector<std::pair<const char*, const char*>> {
             {"--rollover", "1M"}, {"--rollover-time", "1h"}, {"--keep", "2"}}) {
        EXPECT_EQ(complaintAbout({"record", "-", option, value}),
            "spectrel: " + std::string(option)
                + ": standard output is one stream, not several files (see spectrel --help)\n");
    }
}

TEST(ReadArgumentsTest, EveryCommandTellsHelpAndVersion)
{
    for (const char* command : {"watch", "decode", "view", "record", "channel", "mark", "report"}) {
        for (const char* option : {"--help", "--version"}) {
            Arguments arguments;
            testing::internal::CaptureStdout();
            EXPECT_EQ(read({command, option}, arguments), ExitStatus::Done) << command << ' ' << option;
            EXPECT_NE(testing::internal::GetCapturedStdout(), "") << command << ' ' << option;
        }
    }
}

TEST(ReadArgumentsTest, WrongUsageIsStatus2)
{
    for (const std::vector<const char*>& words : std::vector<std::vector<const char*>> {{"--gui", "--terminal"},
             {"play"}, {"watch", "--count", "0"}, {"watch", "--duration", "soon"}, {"record"}, {"decode"}, {"view"},
             {"view", "a", "b"}, {"report", "a"}, {"report", "-o", "a"}, {"channel"}, {"channel", "lte"},
             {"channel", "lte", "-1"}, {"view", "--gui", "--terminal", "a"}, {"view", "--technology", "5g", "a"}}) {
        Arguments arguments;
        EXPECT_EQ(read(words, arguments), ExitStatus::WrongUsage) << words.front();
    }
}

} // namespace
} // namespace spectrel
