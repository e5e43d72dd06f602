#include "Telephony/Encoders/CDMARecords.h"

#include "Telephony/Encoders/RecordWriter.h"

#include <algorithm>
#include <cmath>
#include <span>
#include <utility>
#include <vector>

namespace spectrel {

namespace {

using Activity = CDMAActivity;

using CDMACarriers::BandClass;

/// What stands in one subpacket, without its head.
struct Subpacket {
    std::uint8_t id;
    Bytes content;
};

void append16(Bytes& bytes, std::uint32_t value)
{
    bytes.push_back(static_cast<std::uint8_t>(value));
    bytes.push_back(static_cast<std::uint8_t>(value >> 8));
}

/// Version, number of subpackets, two bytes of no meaning here; each subpacket with id, version, and its size with
/// these four bytes.
Bytes recordWithSubpackets(std::uint32_t code, Moment time, std::span<const Subpacket> subpackets)
{
    RecordWriter record(code, time);
    record.u8(1).u8(static_cast<std::uint8_t>(subpackets.size())).u16(0);
    for (const Subpacket& subpacket : subpackets) {
        record.u8(subpacket.id).u8(1).u16(static_cast<std::uint32_t>(subpacket.content.size() + 4));
        record.bytes(subpacket.content);
    }
    return record.take();
}

std::uint8_t oneXDeviceState(const CDMAReport& report)
{
    constexpr std::uint8_t Paging = 6;
    constexpr std::uint8_t Sleep = 7;
    constexpr std::uint8_t Traffic = 8;
    constexpr std::uint8_t Acquisition = 3;
    if (!report.isInService)
        return Acquisition;
    if (report.activity == Activity::Voice)
        return Traffic;
    return report.isAwake ? Paging : Sleep;
}

/// The receiver's gain control: 0 is -63.248 dBm, a step is 0.334 dB.
std::uint8_t gainOf(double power)
{
    return static_cast<std::uint8_t>(std::clamp<long>(std::lround((power + 63.248) / 0.334), -128, 127));
}

Bytes rfContent(const CDMAReport& report)
{
    Bytes content {BandClass, BandClass};
    append16(content, CDMACarriers::OneX);
    append16(content, CDMACarriers::OneX);
    content.push_back(gainOf(report.received));
    content.push_back(gainOf(report.receivedBySecond));
    append16(content, static_cast<std::uint16_t>(std::lround(report.transmitted * 10)));
    return content;
}

/// Head: chips summed coherently (16 bits), non-coherent sums, scale, number of pilots, of paths, PN of the reference.
/// A pilot: PN, ten bytes, four bytes a path, two bytes of energy a path (the first is the combined one); all filled
/// to a multiple of four.
Bytes activeSetContent(const CDMAReport& report)
{
    constexpr std::uint16_t Chips = 512;
    constexpr std::uint8_t Sums = 2;
    constexpr std::uint8_t Scale = 5;
    constexpr std::size_t Paths = 2;
    constexpr double PilotShare = 0.2; // of a sector's power
    constexpr double EnergyOfOne = 9.0 * Chips * Chips * Sums / (1 << (2 * Scale - 3)); // of Ec/Io 0 dB, without noise
    const auto& pilots = report.activePilots;
    Bytes content;
    append16(content, Chips);
    for (const std::size_t value : {std::size_t(Sums), std::size_t(Scale), pilots.size(), Paths})
        content.push_back(static_cast<std::uint8_t>(value));
    append16(content, pilots.front().pn);
    for (const CDMAPilot& pilot : pilots) {
        const auto energy =
            static_cast<std::uint32_t>(std::lround(EnergyOfOne * (PilotShare * pilot.share + 1.0 / Chips)));
        append16(content, pilot.pn);
        content.insert(content.end(), 10 + 4 * Paths, 0);
        append16(content, energy);
        append16(content, energy * 3 / 4); // the second path's
    }
    return content;
}

constexpr std::uint16_t UnassignedPN = 0xFFFF;
constexpr std::size_t Fingers = 4;

using FingerList = std::vector<std::pair<std::uint16_t, double>>; // PN and C/I (linear)

FingerList freeFingers()
{
    return FingerList(Fingers, {UnassignedPN, 0});
}

/// Two fingers on the serving pilot, one on each further; the others are free.
FingerList fingers(const CDMAReport& report)
{
    FingerList assigned;
    const auto& pilots = report.activePilots;
    assigned.emplace_back(pilots.front().pn, 0.8 * report.servingSignal);
    assigned.emplace_back(pilots.front().pn, 0.2 * report.servingSignal);
    for (std::size_t pilot = 1; pilot < pilots.size(); ++pilot)
        assigned.emplace_back(pilots[pilot].pn, pilots[pilot].share / (1 - pilots[pilot].share));
    assigned.resize(Fingers, {UnassignedPN, 0});
    return assigned;
}

/// 512 is 0 dB.
std::uint16_t energyOf(double ratio)
{
    return static_cast<std::uint16_t>(std::clamp<long>(std::lround(ratio * 512), 1, 0xFFFF));
}

std::uint8_t evdoDeviceState(const CDMAReport& report)
{
    constexpr std::uint8_t Acquisition = 1;
    if (!report.isInService)
        return Acquisition;
    switch (report.activity) {
    case Activity::Voice:
        return 0; // inactive
    case Activity::Idle:
        return 3;
    case Activity::DataSetup:
        return 4; // access
    case Activity::Data:
        return 5; // connected
    }
    return 0;
}

bool hasEVDO(const CDMAReport& report)
{
    return report.activity != Activity::Voice && report.isInService;
}

std::uint8_t wholePower(double power)
{
    return static_cast<std::uint8_t>(std::lround(power));
}

} // namespace

Bytes cdmaSystemInformationRecord(const CDMAReport& report, Moment time)
{
    constexpr std::uint32_t OneXSystem = 2;
    const CDMASystem& sector = report.serving;
    return RecordWriter(0x134F, time)
        .u8(2) // version
        .zeros(28) // how the system was chosen
        .u32(sector.isHome ? 0 : 7) // roaming indicator: off, alliance partner
        .u32(OneXSystem)
        .u16(sector.systemId)
        .u16(sector.networkId)
        .zeros(77) // country, channel and time
        .u8(sector.packetZone)
        .u8(6) // minimum protocol revision
        .u8(6) // protocol revision in use: IS-2000 release 0
        .zeros(50) // services
        .u16(sector.baseId)
        .take();
}

Bytes cdmaSearcherRecord(const CDMAReport& report, Moment time)
{
    Bytes fingerContent {static_cast<std::uint8_t>(Fingers), 0, 0, 0};
    for (const auto& [pn, ratio] : fingers(report)) {
        append16(fingerContent, pn);
        append16(fingerContent, energyOf(ratio));
    }
    const Subpacket subpackets[] = {
        {1, {oneXDeviceState(report), 0, 0, 0}},
        {2, rfContent(report)},
        {3, activeSetContent(report)},
        {4, fingerContent},
    };
    return recordWithSubpackets(0x119C, time, subpackets);
}

Bytes cdmaFrameRecord(const CDMAReport& report, Moment time)
{
    if (report.activity != Activity::Voice)
        return {};
    constexpr std::size_t Frame = 20; // bytes about rates and power control before the frame's flag
    Bytes demodulation(Frame);
    demodulation.push_back(report.isFrameBad ? 1 : 0);
    demodulation.insert(demodulation.end(), 3, 0);
    const Subpacket subpackets[] = {{10, Bytes(12)}, {11, demodulation}}; // first the common channels'
    return recordWithSubpackets(0x119D, time, subpackets);
}

Bytes evdoAirLinkRecord(const CDMAReport& report, Moment time)
{
    constexpr std::uint8_t SessionOpen = 4;
    constexpr std::uint32_t UATI = 0x0A4C17; // low 24 bits of the terminal's address
    return RecordWriter(0x1183, time)
        .u16(BandClass << 11 | CDMACarriers::EVDO)
        .u8(wholePower(report.received))
        .u8(wholePower(report.receivedBySecond))
        .u8(wholePower(report.transmitted))
        .u16(hasEVDO(report) ? report.serving.pn : UnassignedPN)
        .zeros(16) // rates asked for and granted
        .u8(evdoDeviceState(report))
        .u8(SessionOpen)
        .u16(UATI)
        .u8(UATI >> 16)
        .u8(report.serving.isHome ? 21 : 22) // color code of the subnet
        .zeros(8) // hybrid operation
        .take();
}

Bytes evdoPilotsRecord(const CDMAReport& report, Moment time)
{
    const auto pilots = hasEVDO(report) ? report.activePilots : std::vector<CDMAPilot>();
    RecordWriter record(0x12B6, time);
    record.u8(2).u8(0).u8(static_cast<std::uint8_t>(pilots.size())).zeros(9); // search windows
    for (const CDMAPilot& pilot : pilots)
        record.u16(pilot.pn).u16(energyOf(pilot.share)).zeros(8); // channel, cover, delay
    return record.take();
}

Bytes evdoFingersRecord(const CDMAReport& report, Moment time)
{
    RecordWriter record(0x108A, time);
    record.zeros(9).u8(Fingers);
    for (const auto& [pn, ratio] : hasEVDO(report) ? fingers(report) : freeFingers())
        record.u16(pn).zeros(4).u16(energyOf(ratio)).zeros(6); // path and lock states
    return record.take();
}

Bytes evdoForwardCountersRecord(const CDMAReport& report, Moment time)
{
    if (!hasEVDO(report))
        return {};
    const EVDOCounts& counts = report.counts;
    RecordWriter record(0x1192, time);
    record.u32(report.second);
    for (std::size_t format = 0; format < ForwardFormats.size(); ++format) {
        const std::uint8_t drc = ForwardFormats[format].drc;
        record.u32(counts.forward[format]);
        if (format + 1 == ForwardFormats.size() || ForwardFormats[format + 1].drc != drc)
            record.u32(counts.forwardLost[drc]); // closes its rate
    }
    return record.take();
}

Bytes evdoReverseCountersRecord(const CDMAReport& report, Moment time)
{
    if (!hasEVDO(report))
        return {};
    const EVDOCounts& counts = report.counts;
    RecordWriter record(0x127E, time);
    record.u8(1).u32(report.second); // version first
    for (std::size_t interlace = 0; interlace < EVDOCounts::Interlaces; ++interlace) {
        for (std::size_t mode = 0; mode < EVDOCounts::Modes; ++mode) {
            for (std::size_t payload = 0; payload < ReversePayloads.size(); ++payload) {
                const ReversePackets& packets = counts.reverse[interlace][mode][payload];
                for (const std::uint32_t arrived : packets.arrived)
                    record.u32(arrived);
                record.u32(packets.lost).u32(0); // none was given up before its last subpacket
            }
        }
    }
    return record.u32(0).take();
}

} // namespace spectrel
