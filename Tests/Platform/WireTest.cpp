#include "Platform/Sockets/Wire.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <vector>

namespace spectrel::wire {
namespace {

using testing::ElementsAre;

TEST(WireTest, HeaderIsTwelveBytesLittleEndian)
{
    std::array<std::uint8_t, HeaderLength> bytes;
    encode({Kind::Request, -2, 0x01020304}, bytes);
    EXPECT_THAT(bytes, ElementsAre(0x53, 2, 0, 0, 0xFE, 0xFF, 0xFF, 0xFF, 4, 3, 2, 1));
}

TEST(WireTest, PacketIsReadBack)
{
    const Bytes bytes {0x53, 1, 0, 0, 0xFE, 0xFF, 0xFF, 0xFF, 4, 3, 2, 1, 'o', 'k'};
    const auto packet = decode(bytes);
    ASSERT_TRUE(packet);
    EXPECT_EQ(packet->header.kind, Kind::OneWay);
    EXPECT_EQ(packet->header.id, -2);
    EXPECT_EQ(packet->header.sequence, 0x01020304U);
    EXPECT_THAT(packet->body, ElementsAre('o', 'k'));
}

TEST(WireTest, OnlyAReplyMayBeEmpty)
{
    EXPECT_FALSE(decode(Bytes {0x53, 1, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}));
    EXPECT_FALSE(decode(Bytes {0x53, 2, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}));
    EXPECT_TRUE(decode(Bytes {0x53, 3, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}));
}

TEST(WireTest, ReservedBytesMustBeZero)
{
    EXPECT_FALSE(decode(Bytes {0x53, 1, 1, 0, 0, 0, 0, 0, 0, 0, 0, 0, 'x'}));
    EXPECT_FALSE(decode(Bytes {0x53, 1, 0, 1, 0, 0, 0, 0, 0, 0, 0, 0, 'x'}));
}

} // namespace
} // namespace spectrel::wire
