// The two sections of the transport-channel quality, code 0xD00C.

#include "Sections/UTRAN/TransportChannel.h"
#include "Tests/Sections/BitSweep.h"
#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

constexpr std::uint32_t Code = 0xD00C;
constexpr const char* TRCHTrace = "<5>TRCH BLER Measurement\n";
constexpr const char* CCTRCHTrace = "<4>CCTRCH SIR Measurement\n";

/// The counts stand in byte 14, bits 6 and 7, byte 15, bits 0 to 3; and in byte 15, bits 4 to 7.
RecordBuilder record(std::uint32_t transportChannels, std::uint32_t codedComposites, std::size_t size)
{
    return RecordBuilder(Code, size)
        .u8(14, transportChannels << 6)
        .u8(15, transportChannels >> 2 | codedComposites << 4);
}

/// One channel of each kind: at 17 and at 323.
RecordBuilder oneOfEach()
{
    return record(1, 1, 331).u8(17, 5).u8(18, 12).u8(323, 2).u8(324, 4).u32(325, 0x40302010).u16(329, 0x6050);
}

class TRCHBLERMeasurementTest : public SectionFixture<TRCHBLERMeasurement> {
protected:
    TRCHBLERMeasurementTest()
        : SectionFixture(List::make())
    {
    }
};

class CCTRCHSIRMeasurementTest : public SectionFixture<CCTRCHSIRMeasurement> {
protected:
    CCTRCHSIRMeasurementTest()
        : SectionFixture(List::make())
    {
    }
};

TEST_F(TRCHBLERMeasurementTest, EntryComesFromOffset17)
{
    deliver(Code, oneOfEach());
    EXPECT_EQ(display(), "[{\"TRCH ID\": \"5\", \"TRCH BLER Measurement\": \"12\"}]");
    EXPECT_EQ(log(), TRCHTrace);
}

TEST_F(TRCHBLERMeasurementTest, EveryBitOfTheSecondEntryShowsInItsOwnField)
{
    const BitSweep sweep(
        {{"TRCH ID", 19, 0, 8, plain}, {"TRCH BLER Measurement", 20, 0, 8, plain}}, [this](const Bytes& swept) {
            deliver(Code, swept);
            return shownEntry(1);
        });
    sweep.run(record(2, 0, 24).bytes(), 16, 24);
}

TEST_F(TRCHBLERMeasurementTest, EveryBitOfTheCountCountsAndNoOther)
{
    for (unsigned bit = 0; bit < 32; ++bit) {
        deliver(Code, RecordBuilder(Code, 17).u32(13, 1u << bit));
        EXPECT_EQ(shownCount(), bit >= 14 && bit < 20 ? 1u << (bit - 14) : 0u) << bit;
    }
    deliver(Code, RecordBuilder(Code, 17).u32(13, 0xFFFFFFFF));
    EXPECT_EQ(shownCount(), 63u);
    EXPECT_EQ(shownEntry(62), "{\"TRCH ID\": \"0\", \"TRCH BLER Measurement\": \"0\"}");
}

TEST_F(TRCHBLERMeasurementTest, RecordOf16BytesKeepsTheListAndOneOf17EmptiesIt)
{
    deliver(Code, oneOfEach());
    log();
    deliver(Code, record(0, 0, 17).shrink(16));
    EXPECT_EQ(shownCount(), 1u);
    deliver(Code, record(0, 0, 17));
    EXPECT_EQ(display(), "[]");
    EXPECT_EQ(log(), std::string(TRCHTrace) + TRCHTrace);
}

TEST_F(TRCHBLERMeasurementTest, OtherCodeIsIgnoredWithoutAMessage)
{
    deliver(0xD00A, oneOfEach());
    EXPECT_EQ(display(), "[]");
    EXPECT_EQ(log(), TRCHTrace);
}

TEST_F(CCTRCHSIRMeasurementTest, WithOneTransportChannelTheEntryComesFromOffset323)
{
    deliver(Code, oneOfEach());
    EXPECT_EQ(display(),
        "[{\"CCTRCH ID\": \"2\", \"TSNUM\": \"4\", \"SIR\": [\"16\", \"32\", \"48\", \"64\", \"80\", \"96\"]}]");
    EXPECT_EQ(log(), CCTRCHTrace);
}

TEST_F(CCTRCHSIRMeasurementTest, EveryByteOfTheSecondEntryShowsInItsOwnField)
{
    // No transport channel: entries at 289 and 297.
    for (unsigned byte = 297; byte < 305; ++byte) {
        for (unsigned value : {0u, 1u, 2u, 4u, 8u, 16u, 32u, 64u, 128u, 255u}) {
            deliver(Code, record(0, 2, 305).u8(byte, value));
            std::string expected = "{";
            for (unsigned each = 297; each < 305; ++each) {
                const char* const before[] {"\"CCTRCH ID\": \"", "\", \"TSNUM\": \"", "\", \"SIR\": [\""};
                expected += each < 300 ? before[each - 297] : "\", \"";
                expected += plain(each == byte ? value : 0);
            }
            EXPECT_EQ(shownEntry(1), expected + "\"]}") << byte;
        }
    }
}

TEST_F(CCTRCHSIRMeasurementTest, EveryBitOfTheCountCountsAndNoOther)
{
    for (unsigned bit = 0; bit < 32; ++bit) {
        deliver(Code, RecordBuilder(Code, 17).u32(13, 1u << bit));
        EXPECT_EQ(shownCount(), bit >= 20 && bit < 24 ? 1u << (bit - 20) : 0u) << bit;
    }
    deliver(Code, RecordBuilder(Code, 17).u32(13, 0xFFFFFFFF));
    EXPECT_EQ(shownCount(), 15u);
}

TEST_F(CCTRCHSIRMeasurementTest, EntriesMoveBy34BytesForEachTransportChannel)
{
    for (const std::uint32_t channels : {0u, 2u, 63u}) {
        const std::size_t start = 289 + 34 * channels;
        deliver(Code, record(channels, 2, start + 16).u8(start, 3).u8(start + 8, 4));
        EXPECT_EQ(shownEntry(0).find("{\"CCTRCH ID\": \"3\""), 0u) << shownEntry(0);
        EXPECT_EQ(shownEntry(1).find("{\"CCTRCH ID\": \"4\""), 0u) << shownEntry(1);
    }
}

TEST_F(CCTRCHSIRMeasurementTest, RecordOf16BytesKeepsTheListAndOneOf17EmptiesIt)
{
    deliver(Code, oneOfEach());
    log();
    deliver(Code, record(0, 0, 17).shrink(16));
    EXPECT_EQ(shownCount(), 1u);
    deliver(Code, record(0, 0, 17));
    EXPECT_EQ(display(), "[]");
    EXPECT_EQ(log(), std::string(CCTRCHTrace) + CCTRCHTrace);
}

TEST_F(CCTRCHSIRMeasurementTest, OtherCodeIsIgnoredWithoutAMessage)
{
    deliver(0xD00A, oneOfEach());
    EXPECT_EQ(display(), "[]");
    EXPECT_EQ(log(), CCTRCHTrace);
}

TEST(TransportChannelRecordTest, IndexNotBelowItsCountIsRaised)
{
    const RecordBuilder bytes = oneOfEach();
    const RepeatedGroup transport = TransportChannelRecord::transportChannels(ByteView(bytes));
    EXPECT_EQ(transport.entry(0), 17u);
    EXPECT_THROW(transport.entry(1), ArrayOutOfBoundsException);
    const RepeatedGroup composite = TransportChannelRecord::codedCompositeChannels(ByteView(bytes));
    EXPECT_EQ(composite.entry(0), 323u);
    EXPECT_THROW(composite.entry(1), ArrayOutOfBoundsException);
}

TEST(TransportChannelRecordTest, TimeSlotAboveFiveIsRaised)
{
    EXPECT_EQ(TransportChannelRecord::timeSlots(323).entry(5), 330u);
    EXPECT_THROW(TransportChannelRecord::timeSlots(323).entry(6), ArrayOutOfBoundsException);
}

} // namespace
} // namespace spectrel
