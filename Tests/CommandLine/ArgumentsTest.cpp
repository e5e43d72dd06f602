#include "CommandLine/Arguments.h"

#include "CommandLine/OptionTypes.h"

#include <gtest/gtest.h>

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
    EXPECT_EQ(arguments.decode.format, OutputFormat::Json);
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
    EXPECT_EQ(arguments.watch.format, OutputFormat::Changes);
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

TEST(ReadArgumentsTest, WrongUsageIsStatus2)
{
    for (const std::vector<const char*>& words : std::vector<std::vector<const char*>> {{"--gui", "--terminal"},
             {"play"}, {"watch", "--count", "0"}, {"watch", "--duration", "soon"}, {"record"}, {"decode"}, {"view"},
             {"view", "a", "b"}, {"view", "--gui", "--terminal", "a"}, {"view", "--technology", "5g", "a"}}) {
        Arguments arguments;
        EXPECT_EQ(read(words, arguments), ExitStatus::WrongUsage) << words.front();
    }
}

} // namespace
} // namespace spectrel
