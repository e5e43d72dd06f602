#include "LogGenerator/CDMA/Decoders.h"
#include "LogGenerator/CDMA/Lookup.h"
#include "LogGenerator/LogGenerator.h"
#include "Platform/SystemLog.h"
#include "Values/TextBuffer.h"

#include <array>
#include <optional>

namespace spectrel {

namespace {

/// Where one direction of the link keeps and shows its values.
struct Direction {
    std::string_view sequence; // in the state: of the record before
    std::string_view bits;
    std::string_view currentSequence; // in "ExtraInfo"
    std::string_view currentBits;
    std::string_view previousSequence;
    std::string_view previousBits;
    std::string_view rate; // variable
};

constexpr Direction ForwardLink {
    "FLDataSeqNum", "FLDataSent", "FLDataSeqNum1", "FLDataSent1", "FLDataSeqNum2", "FLDataSent2", "kFLDataRate"};
constexpr Direction ReverseLink {
    "RLDataSeqNum", "RLDataSent", "RLDataSeqNum1", "RLDataSent1", "RLDataSeqNum2", "RLDataSent2", "kRLDataRate"};

constexpr unsigned long ForwardLength = 241; // bytes, at least
constexpr unsigned long ReverseLength = 1750;

/// Bits a packet of each forward-link counter has. Those of 0 count packets that did not arrive whole.
constexpr std::array<std::uint16_t, 56> ForwardPacketBits {128, 256, 512, 1024, 0, 128, 256, 512, 1024, 0, 128, 256,
    512, 1024, 0, 128, 256, 512, 1024, 0, 128, 256, 512, 1024, 0, 512, 1024, 2048, 0, 128, 256, 512, 1024, 0, 512, 1024,
    2048, 0, 1024, 3072, 0, 512, 1024, 2048, 0, 4096, 0, 1024, 3072, 0, 4096, 0, 5120, 0, 5120, 0};

/// Bits a packet of each reverse-link rate has.
constexpr std::array<std::uint16_t, 12> ReversePacketBits {
    128, 256, 512, 768, 1024, 1536, 2048, 3072, 4096, 6144, 8192, 12288};

/// A record's sequence number, one a second, and the bits sent up to it.
struct DataCount {
    std::int32_t sequence;
    std::int64_t bits;
};

std::int64_t forwardBits(RecordView record)
{
    std::int64_t sum = 0;
    for (std::size_t counter = 0; counter < ForwardPacketBits.size(); ++counter)
        sum += std::int64_t(record.u32(17 + 4 * counter)) * ForwardPacketBits[counter];
    return sum;
}

std::int64_t reverseBits(RecordView record)
{
    constexpr std::array<std::size_t, 8> Counters {18, 22, 26, 30, 306, 310, 314, 318};
    std::int64_t sum = 0;
    for (std::size_t rate = 0; rate < ReversePacketBits.size(); ++rate) {
        std::int64_t packets = 0;
        for (std::size_t block = 0; block < 3; ++block) {
            for (const std::size_t counter : Counters)
                packets += record.u32(24 * rate + 576 * block + counter);
        }
        sum += packets * ReversePacketBits[rate];
    }
    return sum;
}

std::optional<std::int64_t> wholeNumber(const Value& value)
{
    const auto number = value.integer();
    return number ? std::optional(static_cast<std::int64_t>(number->bits())) : std::nullopt;
}

std::optional<DataCount> countBefore(const Dictionary& state, const Direction& direction)
{
    const auto sequence = wholeNumber(state[direction.sequence]);
    const auto bits = wholeNumber(state[direction.bits]);
    if (!sequence || !bits)
        return std::nullopt;
    return DataCount {static_cast<std::int32_t>(*sequence), *bits};
}

void store(Dictionary& into, std::string_view sequenceKey, std::string_view bitsKey, DataCount count)
{
    into.set(sequenceKey, Value::integer(count.sequence));
    into.set(bitsKey, Value::integer(count.bits));
}

/// Unchanged when the sequence number did not grow; it may pass from the largest number to the smallest.
void showRate(DataCount before, DataCount now, const Direction& direction, const Value& lookup)
{
    const auto passed = static_cast<std::int32_t>(
        static_cast<std::uint32_t>(now.sequence) - static_cast<std::uint32_t>(before.sequence));
    if (passed < 1)
        return;
    TextBuffer buffer;
    buffer.fixed2(static_cast<double>(now.bits - before.bits) / (passed * 1024.0)).text(" kbps");
    setLookupText(direction.rate, buffer.view(), lookup);
}

void takeCount(DataCount now, const Direction& direction, Dictionary& state, const Value& lookup)
{
    const auto& extraInfo = state[StateKey::ExtraInfo].dictionary();
    if (const auto before = countBefore(state, direction)) {
        showRate(*before, now, direction, lookup);
        if (extraInfo)
            store(*extraInfo, direction.previousSequence, direction.previousBits, *before);
    } else {
        setLookupText(direction.rate, "", lookup);
    }
    if (extraInfo)
        store(*extraInfo, direction.currentSequence, direction.currentBits, now);
    store(state, direction.sequence, direction.bits, now);
}

} // namespace

void decodeForwardLinkData(SystemLog& log, RecordView record, Dictionary& state, const Value& lookup)
{
    if (record.size() < ForwardLength) {
        SPECTREL_LOG(log, Priority::Error, "Log code 0x1192 is %d bytes long but must be at least %ld bytes.",
            static_cast<int>(record.size()), static_cast<long>(ForwardLength));
        return;
    }
    takeCount({static_cast<std::int32_t>(record.u32(13)), forwardBits(record)}, ForwardLink, state, lookup);
}

void decodeReverseLinkData(SystemLog& log, RecordView record, Dictionary& state, const Value& lookup)
{
    if (record.size() < ReverseLength) {
        SPECTREL_LOG(log, Priority::Error, "Log code 0x127e is %d bytes long but must be at least %ld bytes.",
            static_cast<int>(record.size()), static_cast<long>(ReverseLength));
        return;
    }
    takeCount({static_cast<std::int32_t>(record.u32(14)), reverseBits(record)}, ReverseLink, state, lookup);
}

} // namespace spectrel
