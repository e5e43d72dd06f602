#include "Telephony/Encoders/UMTSRecords.h"

#include "Telephony/Encoders/CountedList.h"
#include "Telephony/Encoders/RecordWriter.h"
#include "Telephony/Reports/UMTSCell.h"

#include <cmath>
#include <span>

namespace spectrel {

namespace {

constexpr double FullScaleEnergy = 524288; // 0 dB
constexpr std::size_t HARQEntrySize = 9;
constexpr std::size_t HARQEntriesReserved = 18; // for each primary process

std::uint32_t rounded(double value)
{
    return static_cast<std::uint32_t>(std::lround(value));
}

/// Eleven words, of which the long and the short average and the last value are written.
void writeEnergy(RecordWriter& record, const UMTSSetCell& cell)
{
    const std::uint32_t energy = rounded(std::pow(10, cell.ecno / 10) * FullScaleEnergy);
    record.zeros(32)
        .u32(cell.averages == EnergyAverages::Long ? energy : 0)
        .u32(cell.averages == EnergyAverages::None ? 0 : energy)
        .u32(energy);
}

/// Power in tenths of a dB above -70 dBm, less 512; 0 stands for "no sample" and becomes its neighbour.
std::uint32_t rawPower(double power)
{
    const std::uint32_t raw = rounded((power + 70) * 10 - 512);
    return raw == 0 ? 1 : raw;
}

void writeProcesses(RecordWriter& record, std::span<const HARQProcess> processes)
{
    for (const HARQProcess& process : processes)
        record.u8(process.identity).u32(process.bits).u16(process.newTransmissions).u16(process.blockErrors);
}

} // namespace

Bytes cellSetsRecord(const CellSetsReport& report, Moment time)
{
    const auto cells = counted(report.cells);
    RecordWriter record(0x417A, time);
    record.u16(rounded((report.rssi + 106) * 10 - 512)).u8(count(cells));
    for (const UMTSSetCell& cell : cells) {
        const auto set = static_cast<std::uint32_t>(cell.set);
        record.zeros(7).u8(cell.scramblingCode).u8((cell.scramblingCode >> 8 & 0x1F) | set << 5).zeros(6);
    }
    for (const UMTSSetCell& cell : cells)
        writeEnergy(record, cell);
    return record.take();
}

Bytes rankingRecord(const RankingReport& report, Moment time)
{
    const auto umts = counted(report.umts);
    const auto gsm = counted(report.gsm);
    RecordWriter record(0x4005, time);
    record.u8(count(umts)).u8(count(gsm));
    for (const RankedUMTSCell& cell : umts) {
        record.u16(cell.downlinkChannel)
            .u16(cell.scramblingCode)
            .u8(rounded(cell.rscp + 21))
            .u16(rounded(cell.rankedRscp))
            .u8(rounded(cell.ecno * 2))
            .u16(rounded(cell.rank));
    }
    for (const RankedGSMCell& cell : gsm)
        record.u16(cell.arfcn).u16(cell.bsic).u8(rounded(cell.rssi)).u16(rounded(cell.rank));
    return record.take();
}

Bytes rrcStateRecord(RRCState state, Moment time)
{
    return RecordWriter(0x4125, time).u8(static_cast<std::uint32_t>(state)).take();
}

Bytes transmitPowerRecord(const TransmitPowers& powers, Moment time)
{
    const auto samples = counted(powers);
    RecordWriter record(0x4031, time);
    record.zeros(1).u8(count(samples)).zeros(1);
    for (const auto& power : samples)
        record.zeros(4).u16(power ? rawPower(*power) : 0).zeros(8);
    return record.take();
}

Bytes umtsServingCellRecord(const UMTSCell& cell, Moment time)
{
    return RecordWriter(0x4127, time)
        .u32(cell.uplinkChannel)
        .u32(cell.downlinkChannel)
        .u32(cell.identity)
        .u16(cell.registrationArea)
        .zeros(2)
        .take();
}

Bytes cipheringRecord(bool isOn, Moment time)
{
    return RecordWriter(0x4157, time).u8(isOn ? 1 : 0).zeros(5).take();
}

Bytes blockErrorRecord(const BlockErrorReport& report, Moment time)
{
    const auto channels = counted(report.channels);
    RecordWriter record(0x4116, time);
    record.u8(count(channels)).u16(report.window);
    for (const TransportChannelBlocks& channel : channels)
        record.u8(channel.identity).u32(channel.received).u32(channel.wrong);
    return record.take();
}

Bytes hsdpaRecord(const HSDPAReport& report, Moment time)
{
    const auto primary = counted(report.primary);
    const auto secondary = counted(report.secondary);
    RecordWriter record(0x4221, time);
    record
        .u8(1) // version
        .u8(report.subFrames)
        .u8((report.subFrames >> 8 & 3) | static_cast<std::uint32_t>(report.carriers) << 2)
        .u8(count(primary))
        .u8(count(secondary));
    writeProcesses(record, primary);
    if (!secondary.empty())
        record.zeros((HARQEntriesReserved - 1) * HARQEntrySize * primary.size());
    writeProcesses(record, secondary);
    return record.take();
}

} // namespace spectrel
