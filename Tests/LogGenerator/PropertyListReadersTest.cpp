#include "LogGenerator/Template/PropertyListReaders.h"

#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Tests/Fakes/RecordBuilder.h"
#include "Values/Dictionary.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

RecordBuilder contexts(std::string_view name)
{
    return RecordBuilder::withPropertyList(
        ContextArrayReader::Code, Value(List::make({Value(Dictionary::make({{"APN", name}}))})));
}

class PropertyListReadersTest : public testing::Test {
protected:
    std::string shown(const RecordBuilder& record)
    {
        return displayText((*ContextArrayReader(RecordView(record), payloads).contexts())[0]);
    }

    PropertyListPayloads payloads;
    LogRecorder log;
};

TEST_F(PropertyListReadersTest, RecordsThatTellTheSameAreParsedOnce)
{
    const RecordBuilder first = contexts("a");
    const RecordBuilder same = contexts("a");
    const DictionaryRef node = (*ContextArrayReader(RecordView(first), payloads).contexts())[0].dictionary();
    EXPECT_EQ((*ContextArrayReader(RecordView(same), payloads).contexts())[0].dictionary(), node);
}

TEST_F(PropertyListReadersTest, RecordsOfOtherCodesInBetweenChangeNothingOfThat)
{
    const RecordBuilder record = contexts("a");
    const DictionaryRef node = (*ContextArrayReader(RecordView(record), payloads).contexts())[0].dictionary();
    const RecordBuilder cells = RecordBuilder::withPropertyList(CellInfoArrayReader::Code, Value(List::make()));
    EXPECT_TRUE(CellInfoArrayReader(RecordView(cells), payloads, log).holdsAnything());
    EXPECT_EQ((*ContextArrayReader(RecordView(record), payloads).contexts())[0].dictionary(), node);
}

TEST_F(PropertyListReadersTest, NodesThatSomebodyHoldsAreNotWrittenOver)
{
    const RecordBuilder record = contexts("a");
    const DictionaryRef node = (*ContextArrayReader(RecordView(record), payloads).contexts())[0].dictionary();
    EXPECT_EQ(shown(contexts("b")), "{\"APN\": \"b\"}");
    EXPECT_EQ(displayText(node), "{\"APN\": \"a\"}");
}

TEST_F(PropertyListReadersTest, AnEmptyPayloadDoesNotParse)
{
    const RecordBuilder record = RecordBuilder::withPayload(ContextArrayReader::Code, Bytes());
    EXPECT_FALSE(ContextArrayReader(RecordView(record), payloads).contexts());
}

TEST_F(PropertyListReadersTest, AnotherRecordIsParsedAnew)
{
    EXPECT_EQ(shown(contexts("a")), "{\"APN\": \"a\"}");
    EXPECT_EQ(shown(contexts("b")), "{\"APN\": \"b\"}");
    EXPECT_EQ(shown(contexts("a")), "{\"APN\": \"a\"}");
}

TEST_F(PropertyListReadersTest, EveryReaderTellsOfAPayloadThatDoesNotParse)
{
    const Bytes garbage {'<', 'x', '>'};
    const RecordBuilder record = RecordBuilder::withPayload(CellInfoArrayReader::Code, garbage);
    for (int reader = 0; reader < 2; ++reader) {
        EXPECT_FALSE(CellInfoArrayReader(RecordView(record), payloads, log).holdsAnything());
        EXPECT_EQ(log.takeLog(), "<3>Cell Info Array data could not be constructed\n");
    }
    EXPECT_THROW((LogCode_0xFF0000 {RecordView(record), payloads, log}), LogCode_0xFF0000::UnknownDataException);
    EXPECT_FALSE(ContextArrayReader(RecordView(record), payloads).contexts());
    EXPECT_EQ(shown(contexts("a")), "{\"APN\": \"a\"}");
}

} // namespace
} // namespace spectrel
