#include "Telephony/Encoders/LTERecords.h"

#include "Telephony/Encoders/BitPacker.h"
#include "Telephony/Encoders/RecordWriter.h"
#include "Telephony/Reports/LTECell.h"
#include "Telephony/Reports/LTEReports.h"

#include <algorithm>

namespace spectrel {

namespace {

constexpr double LowestPower = -140; // dBm, of RSRP and RSSI
constexpr double LowestRSRQ = -30; // dB, in idle mode
constexpr double LowestFilteredRSRQ = -20; // dB, in connected mode
constexpr std::uint32_t PowerNotPresent = 64;
constexpr std::uint32_t SearchNotPresent = 32;
constexpr std::size_t MaxCount = 255;

std::uint32_t filteredRSRP(const LTELevels& levels)
{
    return levelSteps(levels.rsrp, LowestPower, 4, 16);
}

std::uint32_t filteredRSRQ(const LTELevels& levels)
{
    return levelSteps(levels.rsrq, LowestFilteredRSRQ, 8, 16);
}

std::uint32_t qRxLevMinSteps(int dBm)
{
    return levelSteps(dBm, LowestPower, 0.5, 6);
}

std::uint32_t srxlevSteps(int decibels)
{
    return levelSteps(decibels, -30, 1, 7);
}

std::uint32_t powerSteps(int dBm, unsigned count)
{
    return levelSteps(dBm, -30, 1, count);
}

std::uint32_t searchSteps(const std::optional<int>& decibels)
{
    return decibels ? levelSteps(*decibels, 0, 0.5, 5) : SearchNotPresent;
}

BitPacker servingFields(const LTEServingReport& report)
{
    BitPacker fields;
    fields.field(9, report.physicalCellId).field(4, report.priority).gap(3);
    fields.field(9, levelSteps(report.measured.rsrp, LowestPower, 4, 9));
    fields.field(9, levelSteps(report.average.rsrp, LowestPower, 4, 9));
    fields.field(7, levelSteps(report.measured.rsrq, LowestRSRQ, 4, 7));
    fields.field(7, levelSteps(report.average.rsrq, LowestRSRQ, 4, 7));
    fields.field(9, levelSteps(report.measured.rssi, LowestPower, 2, 9));
    fields.field(6, qRxLevMinSteps(report.qRxLevMin));
    fields.field(7, report.pMax ? powerSteps(*report.pMax, 7) : PowerNotPresent);
    fields.field(6, powerSteps(report.maxUETransmitPower, 6)).gap(4);
    fields.field(7, srxlevSteps(report.srxlev));
    fields.field(6, report.cyclesBelowZero);
    fields.field(6, searchSteps(report.sIntraSearch)).field(6, searchSteps(report.sNonIntraSearch));
    fields.field(1, report.areRulesUpdated ? 1 : 0).field(4, report.rules).gap(2);
    return fields;
}

BitPacker neighbourFields(const LTEIdleNeighbour& neighbour)
{
    BitPacker fields;
    fields.field(9, neighbour.physicalCellId);
    fields.field(8, levelSteps(neighbour.measured.rssi, LowestPower, 2, 8));
    fields.field(9, levelSteps(neighbour.measured.rsrp, LowestPower, 2, 9)).gap(6);
    fields.field(9, levelSteps(neighbour.average.rsrp, LowestPower, 2, 9));
    fields.field(7, levelSteps(neighbour.measured.rsrq, LowestRSRQ, 4, 7));
    fields.field(7, levelSteps(neighbour.average.rsrq, LowestRSRQ, 4, 7));
    fields.field(7, srxlevSteps(neighbour.srxlev)).gap(2);
    fields.field(16, neighbour.frequencyOffset).gap(16);
    for (const LTEFrameTiming& antenna : neighbour.antennas)
        fields.field(11, antenna.frames).field(19, antenna.samples).gap(2);
    return fields;
}

/// A candidate's 12 bytes.
Bytes candidateBytes(const ReselectionCandidate& candidate)
{
    BitPacker fields;
    fields.field(16, candidate.priority).field(16, static_cast<std::uint32_t>(candidate.technology));
    switch (candidate.technology) {
    case ReselectionTechnology::LTE:
        fields.field(16, candidate.channel).gap(7).field(9, candidate.code);
        break;
    case ReselectionTechnology::UTRAN:
        fields.field(16, candidate.channel).field(16, candidate.code);
        break;
    case ReselectionTechnology::GERAN:
        fields.field(16, candidate.channel).field(8, candidate.band).field(8, candidate.code);
        break;
    case ReselectionTechnology::CDMA1xRTT:
    case ReselectionTechnology::CDMAHRPD:
        fields.field(8, candidate.band).gap(24).field(16, candidate.channel).field(16, candidate.code);
        break;
    }
    Bytes bytes = fields.bytes();
    bytes.resize(12);
    return bytes;
}

} // namespace

Bytes lteServingCellRecord(const LTECell& cell, Moment time)
{
    return RecordWriter(0xB0C2, time)
        .u8(2) // version
        .u16(cell.physicalCellId)
        .u16(cell.downlinkChannel)
        .u16(cell.uplinkChannel)
        .u8(cell.resourceBlocks)
        .u8(cell.resourceBlocks) // uplink
        .u32(cell.identity)
        .u16(cell.trackingArea)
        .u32(cell.band)
        .zeros(6) // allowed access, country and network codes: not shown
        .take();
}

Bytes lteAntennasRecord(const LTECell& cell, Moment time)
{
    return RecordWriter(0xB0C1, time)
        .u8(2) // version
        .u16(cell.downlinkChannel)
        .u16(cell.physicalCellId)
        .u16(0) // system frame number
        .u8(cell.antennas)
        .u8(cell.resourceBlocks)
        .take();
}

Bytes lteConnectedModeRecord(const LTEConnectedReport& report, Moment time)
{
    const std::size_t measured = std::min(report.measured.size(), MaxCount);
    const std::size_t detected = std::min(report.detected.size(), MaxCount);
    RecordWriter record(0xB179, time);
    record.u8(3).zeros(3); // version
    record.u16(report.channel).u16(report.physicalCellId).u16(report.subframe);
    record.u16(filteredRSRP(report.filtered)).u16(filteredRSRQ(report.filtered));
    record.u8(static_cast<std::uint32_t>(measured)).u8(static_cast<std::uint32_t>(detected));
    for (std::size_t index = 0; index < measured; ++index) {
        const LTEConnectedNeighbour& neighbour = report.measured[index];
        record.u16(neighbour.physicalCellId)
            .u16(filteredRSRP(neighbour.filtered))
            .u16(filteredRSRQ(neighbour.filtered));
    }
    for (std::size_t index = 0; index < detected; ++index)
        record.u16(report.detected[index]);
    return record.take();
}

Bytes lteServingMeasurementRecord(const LTEServingReport& report, Moment time)
{
    return RecordWriter(0xB17F, time)
        .u8(1) // version
        .zeros(3)
        .u16(report.channel)
        .bytes(servingFields(report).bytes())
        .take();
}

Bytes lteNeighbourMeasurementRecord(const LTENeighbourReport& report, Moment time)
{
    constexpr std::size_t MaxNeighbours = 32;
    const std::size_t count = std::min(report.neighbours.size(), MaxNeighbours);
    if (count == 0)
        return {};
    RecordWriter record(0xB180, time);
    record.u8(1).zeros(3).u16(report.channel); // version 1
    const BitPacker head = BitPacker()
                               .field(6, qRxLevMinSteps(report.qRxLevMin))
                               .field(5, static_cast<std::uint32_t>(count - 1)) // the last one's index
                               .gap(5);
    record.bytes(head.bytes());
    for (std::size_t index = 0; index < count; ++index)
        record.bytes(neighbourFields(report.neighbours[index]).bytes());
    return record.take();
}

Bytes lteReselectionRecord(const ReselectionReport& report, Moment time)
{
    constexpr std::size_t Stride = 4;
    const std::size_t count = std::min(report.candidates.size(), MaxCount);
    Bytes candidates;
    for (std::size_t index = 0; index < count; ++index) {
        const Bytes bytes = candidateBytes(report.candidates[index]);
        candidates.resize(Stride * index + bytes.size());
        std::ranges::copy(bytes, candidates.begin() + static_cast<std::ptrdiff_t>(Stride * index));
    }
    return RecordWriter(0xB186, time)
        .u8(1) // version
        .zeros(1)
        .u16(report.servingChannel)
        .u16(report.servingCellId)
        .u16(static_cast<std::uint32_t>(count))
        .bytes(candidates)
        .take();
}

} // namespace spectrel
