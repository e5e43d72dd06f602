#include "Tests/LogGenerator/CDMA/C2KFixture.h"

#include <algorithm>

namespace spectrel {
namespace {

constexpr std::uint8_t Paging = 6;
constexpr std::uint8_t Traffic = 8;

/// One pilot of the active set.
struct Pilot {
    std::uint16_t pn;
    std::uint16_t energy;
};

/// The active-set subpacket without its head of four bytes.
struct ActiveSet {
    std::uint16_t length = 1; // N
    std::uint8_t sums = 1; // g
    std::uint8_t exponent = 0; // e
    std::uint8_t paths = 1; // s
    std::uint16_t referencePN = 500;
    std::vector<Pilot> pilots;

    operator Bytes() const
    {
        const std::size_t stride = (6u * paths + 15) / 4 * 4;
        Bytes bytes(20 + 4u * paths + 2 + stride * pilots.size());
        const auto put = [&bytes](std::size_t place, std::uint16_t value) {
            bytes.at(place - 4) = static_cast<std::uint8_t>(value);
            bytes.at(place - 3) = static_cast<std::uint8_t>(value >> 8);
        };
        put(4, length);
        put(6, static_cast<std::uint16_t>(sums | exponent << 8));
        put(8, static_cast<std::uint16_t>(pilots.size() | static_cast<std::size_t>(paths) << 8));
        put(10, referencePN);
        for (std::size_t index = 0; index < pilots.size(); ++index) {
            put(stride * index + 12, pilots[index].pn);
            put(stride * index + 24 + 4u * paths, pilots[index].energy);
        }
        return bytes;
    }
};

class SearcherTest : public C2KFixture {
protected:
    SearcherTest()
        : C2KFixture({"k1xDeviceState", "k1xRx0BandClass", "k1xRx0ChanNum", "k1xRxAGC0", "k1xRx1BandClass",
            "k1xRx1ChanNum", "k1xRxAGC1", "k1xTxAGC", "k1xActiveSetInfo", "k1xTrafficFER"})
    {
    }
    /// RF: bands 1 and 0, channels 384 and 0x1234, gains -50 and 0, transmitter -12.5 dBm.
    static SubpacketRecord record(std::uint8_t deviceState, const ActiveSet& activeSet = {})
    {
        return SubpacketRecord(0x119C)
            .add(1, {deviceState, 0, 0, 0})
            .add(2, {1, 0, 0x80, 0x01, 0x34, 0x12, 0xCE, 0, 0x83, 0xFF})
            .add(3, activeSet)
            .add(4, {});
    }
    std::string pilotsOf(const ActiveSet& activeSet)
    {
        deliver(record(Traffic, activeSet));
        const std::string text = shown("k1xActiveSetInfo");
        constexpr std::string_view Mark = "{\"_sorted\": \"_sorted\", ";
        return text.substr(std::min(text.size(), Mark.size()));
    }
};

TEST_F(SearcherTest, TrafficShowsBothReceiversAndTheTransmitter)
{
    deliver(record(Traffic));
    EXPECT_EQ(display(),
        "{\"k1xDeviceState\": \"Traffic [8]\", \"k1xRx0BandClass\": \"1.8 to 2.0GHz PCS band [1]\", "
        "\"k1xRx0ChanNum\": \"384\", \"k1xRxAGC0\": \"-79.95 dBm\", \"k1xRx1BandClass\": "
        "\"800 MHz cellular band [0]\", \"k1xRx1ChanNum\": \"4660\", \"k1xRxAGC1\": \"-63.25 dBm\", \"k1xTxAGC\": "
        "\"-12.50 dBm\", \"k1xActiveSetInfo\": {\"_sorted\": \"_sorted\"}, \"k1xTrafficFER\": \"\"}");
    EXPECT_EQ(log.takeLog(), "");
}

TEST_F(SearcherTest, OtherStatesHaveNoSecondReceiverAndNoTransmitter)
{
    deliver(record(Paging));
    EXPECT_EQ(shown("k1xRxAGC0"), "\"-79.95 dBm\"");
    for (const char* variable : {"k1xRx1BandClass", "k1xRx1ChanNum", "k1xRxAGC1", "k1xTxAGC"})
        EXPECT_EQ(shown(variable), "\"N/A\"") << variable;
}

TEST_F(SearcherTest, GainsArePositiveAtTheTop)
{
    deliver(SubpacketRecord(0x119C)
                .add(1, {Traffic})
                .add(2, {0, 0, 0, 0, 0, 0, 0x7F, 0x80, 0xFF, 0x7F})
                .add(3, ActiveSet())
                .add(4, {}));
    EXPECT_EQ(shown("k1xRxAGC0"), "\"-20.83 dBm\"");
    EXPECT_EQ(shown("k1xRxAGC1"), "\"-106.00 dBm\"");
    EXPECT_EQ(shown("k1xTxAGC"), "\"+3276.70 dBm\"");
}

TEST_F(SearcherTest, DeviceStatesHaveTheirTexts)
{
    const char* const texts[] = {"Inactive [0]", "Deep sleep in start state [1]",
        "Initial state for CDMA operation [2]", "Acquisition [3]", "Sync [4]", "Slew [5]", "Paging [6]",
        "Slotted mode sleep state [7]", "Traffic [8]", "UnSlew [9]", "Operation in PCG state [10]",
        "Powerup state [11]", "[Bad Value 12]"};
    for (std::uint8_t value = 0; value < std::size(texts); ++value) {
        deliver(record(value));
        EXPECT_EQ(shown("k1xDeviceState"), '"' + std::string(texts[value]) + '"');
    }
}

TEST_F(SearcherTest, RecordMustReachTheSubpackets)
{
    deliver(RecordBuilder(0x119C, 16));
    EXPECT_EQ(log.takeLog(), "<3>Log code 0x119c is 16 bytes long but must be at least 17 bytes.\n");
    deliver(RecordBuilder(0x119C, 17));
    EXPECT_EQ(log.takeLog(), "<4>Log code 0x119c: missing subpacket (ss=0,rf=0,ai=0,fi=0).\n");
}

TEST_F(SearcherTest, EachMissingSubpacketIsToldAndNothingIsShown)
{
    const std::string before = display();
    for (std::uint8_t missing = 1; missing <= 4; ++missing) {
        SubpacketRecord some(0x119C);
        for (std::uint8_t id = 1; id <= 4; ++id)
            some.add(id == missing ? 99 : id, Bytes(16));
        deliver(some);
        std::string line = "<4>Log code 0x119c: missing subpacket (ss=1,rf=1,ai=1,fi=1).\n";
        line[42 + 5u * (missing - 1u)] = '0';
        EXPECT_EQ(log.takeLog(), line);
    }
    EXPECT_EQ(display(), before);
}

TEST_F(SearcherTest, BadSizeIsLoggedOnceForEachSubpacketSearched)
{
    deliver(SubpacketRecord(0x119C).add(1, {Traffic}).addWithSize(2, 500, Bytes(10)).add(3, {}).add(4, {}));
    constexpr const char* Line = "<3>Log code error in subpkt#1: bad size (500).\n";
    EXPECT_EQ(log.takeLog(),
        std::string(Line) + Line + Line + "<4>Log code 0x119c: missing subpacket (ss=1,rf=0,ai=0,fi=0).\n");
}

TEST_F(SearcherTest, EnergiesAreShownInDecibelsAndTheReferencePilotIsMarked)
{
    // N = 512, g = 2, e = 5: E = (ratio + 1/512) * 36864
    ActiveSet set {512, 2, 5, 1, 168, {{168, 3758}, {4, 441}, {168, 109}}};
    EXPECT_EQ(pilotsOf(set),
        "\"0;168\": \"(ref pilot) -10.00 dB\", \"1;4\": \"-20.00 dB\", \"2;168\": \"(ref pilot) -29.98 dB\"}");
}

TEST_F(SearcherTest, ScaleFollowsLengthSumsAndExponent)
{
    EXPECT_EQ(pilotsOf({1, 1, 0, 1, 500, {{7, 144}}}), "\"0;7\": \"+0.00 dB\"}"); // 144 / 8 / 9 - 1
    EXPECT_EQ(pilotsOf({1, 2, 0, 1, 500, {{7, 288}}}), "\"0;7\": \"+0.00 dB\"}");
    EXPECT_EQ(pilotsOf({1, 1, 1, 1, 500, {{7, 36}}}), "\"0;7\": \"+0.00 dB\"}");
    EXPECT_EQ(pilotsOf({2, 1, 0, 1, 500, {{7, 432}}}), "\"0;7\": \"+0.00 dB\"}"); // 432 / 8 / 36 - 1/2
}

TEST_F(SearcherTest, RatioHasAFloorWhichAlsoTakesWhatIsNoNumber)
{
    EXPECT_EQ(pilotsOf({1, 1, 0, 1, 500, {{7, 0}}}), "\"0;7\": \"-50.00 dB\"}");
    EXPECT_EQ(pilotsOf({0, 1, 0, 1, 500, {{7, 9}}}), "\"0;7\": \"-50.00 dB\"}") << "infinity less infinity";
    EXPECT_EQ(pilotsOf({0, 0, 0, 1, 500, {{7, 0}}}), "\"0;7\": \"-50.00 dB\"}");
    EXPECT_EQ(pilotsOf({1, 0, 0, 1, 500, {{7, 9}}}), "\"0;7\": \"+inf dB\"}");
    EXPECT_EQ(pilotsOf({1, 1, 255, 1, 500, {{7, 1}}}), "\"0;7\": \"+1516.68 dB\"}") << "2^507 / 9";
}

TEST_F(SearcherTest, BlocksLieAsFarApartAsTheirPathsNeed)
{
    for (const std::uint8_t paths : std::initializer_list<std::uint8_t> {1, 2, 3, 4, 7, 40})
        EXPECT_EQ(
            pilotsOf({1, 1, 0, paths, 500, {{7, 144}, {8, 792}}}), "\"0;7\": \"+0.00 dB\", \"1;8\": \"+10.00 dB\"}")
            << int(paths);
}

TEST_F(SearcherTest, BlocksWithoutPathsShareTheirEnergyWithTheNextPN)
{
    EXPECT_EQ(pilotsOf({1, 1, 0, 0, 500, {{7, 0}, {144, 144}}}), "\"0;7\": \"+0.00 dB\", \"1;144\": \"+0.00 dB\"}");
}

TEST_F(SearcherTest, MorePilotsThanTheRecordHasReadAsZero)
{
    ActiveSet set;
    Bytes bytes = set;
    bytes[4] = 255; // pilots
    deliver(SubpacketRecord(0x119C).add(1, {Traffic}).add(2, Bytes(10)).add(4, {}).add(3, bytes));
    const Value list = (*state[StateKey::Display].dictionary())["k1xActiveSetInfo"];
    EXPECT_EQ(list.dictionary()->count(), 256u);
    EXPECT_EQ(displayText((*list.dictionary())["254;0"]), "\"-50.00 dB\"");
}

} // namespace
} // namespace spectrel
