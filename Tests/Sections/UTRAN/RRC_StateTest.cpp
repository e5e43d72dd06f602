#include "Sections/UTRAN/RRC_State.h"

#include "Platform/DiagnosticLog.h"
#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

constexpr std::uint32_t Code = 0xD0E0;
constexpr const char* Trace = "<4>RRC Info\n";

class RRC_StateTest : public SectionFixture<RRC_State>, private DiagnosticLog {
protected:
    RRC_StateTest()
        : SectionFixture(Dictionary::make(), this)
    {
    }
    static RecordBuilder record(std::uint32_t flag, std::uint32_t mode)
    {
        return RecordBuilder(Code, 15).u8(13, flag).u8(14, mode);
    }
    std::string shownState(std::uint32_t flag, std::uint32_t mode)
    {
        deliver(Code, record(flag, mode));
        return shown("State");
    }

    std::string diagnostics;

private:
    void write(std::string_view line) override
    {
        diagnostics += std::string(line) + "\n";
    }
};

TEST_F(RRC_StateTest, ValidModeIsNamed)
{
    const char* const names[] {"Disconnected", "Connecting", "Cell Fach", "Cell DCH", "Cell PCH", "Cell URA PCH"};
    for (std::uint32_t mode = 0; mode < 6; ++mode)
        EXPECT_EQ(shownState(1, mode), "\"" + std::string(names[mode]) + "\"");
    for (const std::uint32_t mode : {6u, 7u, 8u, 16u, 32u, 64u, 128u, 254u, 255u})
        EXPECT_EQ(shownState(1, mode), "\"Unknown RRC Mode\"") << mode;
}

TEST_F(RRC_StateTest, FlagOtherThanOneMakesEveryModeUnknown)
{
    for (const std::uint32_t flag : {0u, 2u, 3u, 129u, 255u}) {
        for (std::uint32_t mode = 0; mode < 8; ++mode)
            EXPECT_EQ(shownState(flag, mode), "\"Unknown RRC Mode\"") << flag << " " << mode;
    }
}

TEST_F(RRC_StateTest, RecordOf15BytesLogsItsTraceOnly)
{
    deliver(Code, record(1, 3));
    EXPECT_EQ(display(), "{\"State\": \"Cell DCH\"}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(RRC_StateTest, ShortRecordIsLoggedAndStillDecoded)
{
    deliver(Code, record(1, 3).shrink(14));
    EXPECT_EQ(display(), "{\"State\": \"Disconnected\"}") << "the missing byte reads as 0";
    EXPECT_EQ(log(), std::string(Trace) + "<4>LogCode_0xD0E0 is length is 14 expected size 15\n");
    deliver(Code, record(1, 3).shrink(13));
    EXPECT_EQ(display(), "{\"State\": \"Unknown RRC Mode\"}");
    EXPECT_EQ(log(), std::string(Trace) + "<4>LogCode_0xD0E0 is length is 13 expected size 15\n");
}

TEST_F(RRC_StateTest, OtherCodeIsIgnoredWithoutAMessage)
{
    deliver(0xD0E2, record(1, 3));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
    EXPECT_EQ(diagnostics, "");
}

TEST_F(RRC_StateTest, DiagnosticLogTellsTheSectionTheModeAndItsName)
{
    deliver(Code, record(1, 2));
    deliver(Code, record(0, 2));
    EXPECT_EQ(diagnostics,
        "Display Dict = {\"State\": \"Cell Fach\"}, rrc mode = 2 Cell Fach\n"
        "Display Dict = {\"State\": \"Unknown RRC Mode\"}, rrc mode = 255 Unknown RRC Mode\n");
}

class UnheardRRC_StateTest : public SectionFixture<RRC_State> {
protected:
    UnheardRRC_StateTest()
        : SectionFixture(Dictionary::make())
    {
    }
};

TEST_F(UnheardRRC_StateTest, WithoutADiagnosticLogItGoesOn)
{
    deliver(Code, RecordBuilder(Code, 15).u8(13, 1).u8(14, 1));
    EXPECT_EQ(shown("State"), "\"Connecting\"");
}

} // namespace
} // namespace spectrel
