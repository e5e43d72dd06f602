#include "LogGenerator/Template/ZPHLogGenerator.h"

#include "LogGenerator/Template/DLFVersionReport.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Fakes/LogRecorder.h"

#include <algorithm>
#include <gtest/gtest.h>

namespace spectrel {
namespace {

class Generator final : public ZPHLogGenerator {
public:
    explicit Generator(const Context& context)
        : ZPHLogGenerator(context)
    {
    }
    void updateState(Dictionary&, ByteView) override { }
    Value generateLogUsingState(Dictionary&) override
    {
        return {};
    }
    DictionaryRef getStartCommand() override
    {
        return Dictionary::make();
    }
    std::string_view className() const override
    {
        return "Generator";
    }
};

class DLFTest : public testing::Test {
protected:
    DLFTest()
    {
        state.set(StateKey::History, history);
    }
    void addEntry(Bytes raw)
    {
        history->append(Dictionary::make({{"DisplayState", DataRef(std::make_shared<Bytes>(std::move(raw)))}}));
    }
    std::string textAt(const Bytes& dlf, std::size_t offset, std::size_t width)
    {
        return {reinterpret_cast<const char*>(dlf.data()) + offset, width};
    }

    FakeRunLoop time;
    LogRecorder log;
    Dictionary state;
    ListRef history = List::make();
    Generator generator {{.clock = time, .log = log}};
};

TEST_F(DLFTest, EmptyHistoryYieldsTheVersionReportAlone)
{
    const auto contents = generator.getSaveContentsFromState(state);
    ASSERT_EQ(contents->count(), 1u);
    const Dictionary& entry = *(*contents)[0].dictionary();
    EXPECT_EQ(entry["Description"], Value("DLF binary (161 bytes)"));
    EXPECT_EQ(entry["DLF"].data()->size(), 161u);
}

TEST_F(DLFTest, StateWithoutHistoryYieldsTheVersionReportAlone)
{
    Dictionary empty;
    EXPECT_EQ(generator.generateDlfFromState(empty)->size(), 161u);
    EXPECT_EQ(generator.getSaveContentsFromState(empty)->count(), 1u);
}

TEST_F(DLFTest, SaveContentsAreTheHistoryThenTheDLF)
{
    addEntry({1, 2, 3});
    const auto contents = generator.getSaveContentsFromState(state);
    ASSERT_EQ(contents->count(), 2u);
    EXPECT_EQ((*contents)[0].dictionary(), (*history)[0].dictionary());
    EXPECT_EQ(history->count(), 1u) << "the history itself gains nothing";
}

TEST_F(DLFTest, EntryOfOneByteContributesNothing)
{
    addEntry({0x01});
    addEntry({});
    EXPECT_EQ(generator.generateDlfFromState(state)->size(), 161u);
}

TEST_F(DLFTest, EntryContributesAllButItsFirstByte)
{
    Bytes raw {0x01};
    for (std::uint8_t byte = 0; byte < 12; ++byte)
        raw.push_back(static_cast<std::uint8_t>(0xA0 + byte));
    addEntry(raw);
    const auto dlf = generator.generateDlfFromState(state);
    ASSERT_EQ(dlf->size(), 161u + 12u);
    EXPECT_TRUE(std::equal(raw.begin() + 1, raw.end(), dlf->begin() + 161));
}

TEST_F(DLFTest, TypeBytesOfLaterRecordsInAnEntryStay)
{
    addEntry({0x01, 0xAA, 0xFF, 0xBB});
    const auto dlf = generator.generateDlfFromState(state);
    EXPECT_EQ(textAt(*dlf, 161, 3), "\xAA\xFF\xBB");
}

TEST_F(DLFTest, EntryWithoutRawMaterialIsSkipped)
{
    history->append(Dictionary::make());
    addEntry({1, 2});
    EXPECT_EQ(generator.generateDlfFromState(state)->size(), 162u);
}

TEST_F(DLFTest, RawMaterialOfAnotherKindAbortsTheDLFButNotTheSnapshot)
{
    addEntry({1, 2});
    history->append(Dictionary::make({{"DisplayState", Dictionary::make()}}));
    EXPECT_EQ(generator.getSaveContentsFromState(state)->count(), 2u);
    EXPECT_EQ(log.takeLog(), "<16>Got wrong class writing history to DLF; aborting writing the DLF file\n");
}

TEST_F(DLFTest, VersionFieldHoldsTheStartOfTheProgramsName)
{
    const auto dlf = generator.generateDlfFromState(state);
    EXPECT_EQ(textAt(*dlf, 16, 7), std::string("Spectr\0", 7));
}

TEST_F(DLFTest, DateFieldHoldsSeventeenCharactersAndANUL)
{
    const auto dlf = generator.generateDlfFromState(state);
    EXPECT_EQ(textAt(*dlf, 63, 18), std::string("Dec  9 2019 21:26\0", 18));
}

TEST_F(DLFTest, VersionReportIsLaidOutByteForByte)
{
    time.setZone({-(3 * 3600 + 1830), true});
    const auto dlf = generator.generateDlfFromState(state);
    Bytes expected(161, 0);
    const auto put = [&expected](std::size_t offset, std::string_view bytes) {
        std::copy(bytes.begin(), bytes.end(), expected.begin() + static_cast<std::ptrdiff_t>(offset));
    };
    put(0, std::string_view("\xA1\x00\xFD\x1F", 4));
    put(12, std::string_view("\x01\x00\x01\x00", 4));
    put(16, "Spectr");
    put(23, "EXECUTABLE_NAME");
    put(63, "Dec  9 2019 21:26");
    put(81, "\x23\x27\xE7\x65"); // 1709647651
    put(85, "\x2E\xFF"); // -210 minutes: -12630 s rounded toward zero
    put(87, "\x01");
    EXPECT_EQ(*dlf, expected);
}

TEST(DLFAddVersionReportTest, BufferOneByteTooSmallIsLeftAlone)
{
    Bytes buffer(160, 0xEE);
    std::uint32_t bytesWritten = 7;
    EXPECT_EQ(DLFAddVersionReport(buffer, bytesWritten, 1, 1, "v", "e", "d", 0), DLFResult::BufferTooSmall);
    EXPECT_EQ(bytesWritten, 0u);
    EXPECT_EQ(buffer, Bytes(160, 0xEE));
}

TEST(DLFAddVersionReportTest, LargerBufferIsWrittenOnlyAtItsStart)
{
    Bytes buffer(200, 0xEE);
    std::uint32_t bytesWritten = 0;
    EXPECT_EQ(DLFAddVersionReport(buffer, bytesWritten, 0x0102, 0x0304, "version text", "a name of over fifteen", "d",
                  0x01'FFFF'89ABCDEFull),
        DLFResult::Written);
    EXPECT_EQ(bytesWritten, 161u);
    EXPECT_EQ(buffer[161], 0xEE);
    EXPECT_EQ(buffer[12], 0x02);
    EXPECT_EQ(buffer[15], 0x03);
    EXPECT_EQ(buffer[22], 0) << "the version text's NUL";
    EXPECT_EQ(buffer[38], 0) << "the executable name's NUL";
    EXPECT_EQ(buffer[37], ' ');
    EXPECT_EQ(buffer[84], 0x89);
    EXPECT_EQ(buffer[85], 0xFF);
    EXPECT_EQ(buffer[87], 0x01);
    EXPECT_EQ(buffer[160], 0);
}

} // namespace
} // namespace spectrel
