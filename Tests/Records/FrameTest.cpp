#include "Records/Frame.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

const Bytes Record {0xFF, 14, 0, 0x02, 0x10, 1, 2, 3, 4, 5, 6, 7, 8, 0xAA, 0xBB};

Bytes wrapped(Bytes record)
{
    record.insert(record.begin(), {0x81, 0});
    return record;
}

TEST(FrameTest, MessageIsRoutedByTypeAndCodeWithOrWithoutAWrapper)
{
    EXPECT_EQ(routedCode(Record), 0xFF1002u);
    EXPECT_EQ(routedCode(wrapped(Record)), 0xFF1002u);
    Bytes ordinary = Record;
    ordinary[0] = 0x01;
    EXPECT_EQ(routedCode(ordinary), 0x1002u);
}

TEST(FrameTest, MessageOfAnUnknownTypeOrBelowThirteenBytesIsNotRouted)
{
    Bytes unknown = Record;
    unknown[0] = 0x10;
    EXPECT_FALSE(routedCode(unknown));
    EXPECT_FALSE(routedCode(wrapped(unknown)));
    EXPECT_FALSE(routedCode(Bytes(12, 1)));
    EXPECT_TRUE(routedCode(Bytes(13, 1)));
    EXPECT_FALSE(routedCode({}));
}

TEST(FrameTest, RecordOfAMessageThatEndsBeforeItIsEmpty)
{
    EXPECT_TRUE(recordInMessage({}).empty());
    EXPECT_TRUE(recordInMessage(Bytes {0x81}).empty());
    EXPECT_TRUE(recordInMessage(Bytes {0x81, 0}).empty());
    EXPECT_EQ(recordInMessage(Bytes {0x81, 0, 1}).size(), 1u);
    EXPECT_EQ(recordInMessage(Bytes {1}).size(), 1u);
}

TEST(FrameTest, ItemStandsBehindTheTypeByte)
{
    EXPECT_EQ(itemLength(ByteView(Record), RecordTypeSize), Record.size() - RecordTypeSize);
    EXPECT_EQ(itemCode(ByteView(Record), RecordTypeSize), 0x1002);
    EXPECT_EQ(recordPlace(ByteView(Record), 0), 0u);
    EXPECT_EQ(recordPlace(ByteView(wrapped(Record)), 0), 2u);
}

TEST(FrameTest, PayloadFollowsThirteenBytesOfHeader)
{
    const ByteView payload = recordPayload(ByteView(Record));
    EXPECT_EQ(Bytes(payload.begin(), payload.end()), (Bytes {0xAA, 0xBB}));
    EXPECT_TRUE(recordPayload(ByteView(Record).first(13)).empty());
    EXPECT_TRUE(recordPayload(ByteView(Record).first(4)).empty());
}

} // namespace
} // namespace spectrel
