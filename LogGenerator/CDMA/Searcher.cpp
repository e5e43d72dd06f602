#include "LogGenerator/CDMA/Decoders.h"
#include "LogGenerator/CDMA/DisplayTexts.h"
#include "LogGenerator/CDMA/Lookup.h"
#include "LogGenerator/CDMA/PilotLists.h"
#include "LogGenerator/CDMA/Subpackets.h"
#include "LogGenerator/CDMA/TrafficFER.h"
#include "Platform/SystemLog.h"

#include <array>
#include <cmath>

namespace spectrel {

namespace {

namespace Subpacket {
constexpr std::uint8_t SearcherState = 1;
constexpr std::uint8_t RF = 2;
constexpr std::uint8_t ActiveSetInfo = 3;
constexpr std::uint8_t FingerInfo = 4;
} // namespace Subpacket

constexpr std::uint8_t Traffic = 8; // device state

/// Receiver gain control, in steps of 0.334 dB from -63.248 dBm.
std::string_view receivedPower(std::uint32_t value, TextBuffer& buffer)
{
    return appendSigned(buffer, static_cast<std::int32_t>(value) * 334 / 1000.0 - 63.248).text(" dBm").view();
}

/// Tenths of a dBm.
std::string_view transmittedPower(std::uint32_t value, TextBuffer& buffer)
{
    return appendSigned(buffer, static_cast<std::int32_t>(value) / 10.0).text(" dBm").view();
}

// Offsets from here on count from a subpacket's start.

constexpr std::array<Field, 1> StateFields {{
    {4, Width::U8, "k1xDeviceState", oneXDeviceState},
}};

constexpr std::array<Field, 3> RFFields {{
    {4, Width::U8, "k1xRx0BandClass", bandClass},
    {6, Width::U16, "k1xRx0ChanNum", decimal},
    {10, Width::S8, "k1xRxAGC0", receivedPower},
}};

constexpr std::array<Field, 4> TrafficRFFields {{
    {5, Width::U8, "k1xRx1BandClass", bandClass},
    {8, Width::U16, "k1xRx1ChanNum", decimal},
    {11, Width::S8, "k1xRxAGC1", receivedPower},
    {12, Width::S16, "k1xTxAGC", transmittedPower},
}};

/// How the pilots of the active set were measured, and where their blocks stand.
struct PilotMeasurement {
    explicit PilotMeasurement(RecordView record, std::size_t start);
    double ratio(std::uint16_t energy) const;

    double length; // N: chips summed coherently
    double sums; // g: non-coherent sums
    int exponent; // e: energies are scaled down by 2^(2e - 3)
    std::size_t count;
    std::size_t stride; // from one pilot's block to the next
    std::size_t energy; // in a pilot's block
    std::uint16_t referencePN;
};

PilotMeasurement::PilotMeasurement(RecordView record, std::size_t start)
    : length(record.u16(start + 4))
    , sums(record.u8(start + 6))
    , exponent(record.u8(start + 7))
    , count(record.u8(start + 8))
    , referencePN(record.u16(start + 10))
{
    const std::size_t paths = record.u8(start + 9); // each adds 4 bytes before the energies, and one energy
    stride = (6 * paths + 15) & 0xFFC;
    energy = 24 + 4 * paths;
}

/// Ec/Io, linear; not below -50 dB, which also stands for a measurement over no chips.
double PilotMeasurement::ratio(std::uint16_t energyValue) const
{
    constexpr double Floor = 0.00001;
    const double measured = std::ldexp(energyValue, 2 * exponent - 3) / (9 * length * length * sums) - 1 / length;
    return measured > Floor ? measured : Floor;
}

Value activeSetPilots(RecordView record, std::size_t start)
{
    const PilotMeasurement measurement(record, start);
    PilotList list;
    for (std::size_t index = 0; index < measurement.count; ++index) {
        const std::size_t block = start + index * measurement.stride; // the blocks' own head overlaps the subpacket's
        const std::uint16_t pn = record.u16(block + 12);
        TextBuffer buffer;
        if (pn == measurement.referencePN)
            buffer.text("(ref pilot) ");
        list.add(index, pn, decibels(measurement.ratio(record.u16(block + measurement.energy)), buffer));
    }
    return list.pilots();
}

} // namespace

void decodeSearcher(SystemLog& log, RecordView record, Dictionary& state, const Value& lookup)
{
    if (record.size() < SubpacketsStart) {
        SPECTREL_LOG(log, Priority::Error, "Log code 0x119c is %u bytes long but must be at least %lu bytes.",
            static_cast<unsigned>(record.size()), static_cast<unsigned long>(SubpacketsStart));
        return;
    }
    const auto searcher = findSubpacket(log, record, Subpacket::SearcherState);
    const auto rf = findSubpacket(log, record, Subpacket::RF);
    const auto activeSet = findSubpacket(log, record, Subpacket::ActiveSetInfo);
    const auto fingers = findSubpacket(log, record, Subpacket::FingerInfo);
    if (!searcher || !rf || !activeSet || !fingers) {
        SPECTREL_LOG(log, Priority::Warning, "Log code 0x119c: missing subpacket (ss=%d,rf=%d,ai=%d,fi=%d).",
            searcher.has_value(), rf.has_value(), activeSet.has_value(), fingers.has_value());
        return;
    }
    const bool isInTraffic = fieldValue(record, StateFields.front(), *searcher) == Traffic;
    publishFields(record, StateFields, lookup, *searcher);
    publishFields(record, RFFields, lookup, *rf);
    if (isInTraffic) {
        publishFields(record, TrafficRFFields, lookup, *rf);
    } else {
        for (const Field& field : TrafficRFFields)
            setLookupText(field.key, "N/A", lookup);
    }
    setLookupValue("k1xActiveSetInfo", activeSetPilots(record, *activeSet), lookup);
    if (!isInTraffic)
        retireTrafficFER(state, lookup);
}

} // namespace spectrel
