#include "Telephony/Encoders/GSMRecords.h"

#include "Telephony/Encoders/CountedList.h"
#include "Telephony/Encoders/RecordWriter.h"
#include "Telephony/Reports/GSMCell.h"

namespace spectrel {

namespace {

std::uint32_t bits(std::int32_t value)
{
    return static_cast<std::uint32_t>(value);
}

} // namespace

Bytes gsmServingCellRecord(const GSMCell& cell, Moment time)
{
    return RecordWriter(0x5134, time).u16(cell.arfcn).u16(cell.bsic).u16(cell.identity).zeros(7).take();
}

Bytes gsmMeasurementRecord(const GSMMeasurement& measurement, Moment time)
{
    const auto neighbours = counted(measurement.neighbours);
    RecordWriter record(0x5137, time);
    record.u16(measurement.arfcn)
        .u8(measurement.rxLevel)
        .u32(measurement.isDedicated ? measurement.fullQuality : bits(measurement.c1))
        .u32(measurement.isDedicated ? measurement.subQuality : bits(measurement.c2))
        .zeros(2)
        .u8(measurement.reselectHysteresis)
        .zeros(1)
        .u8(count(neighbours));
    for (const auto& neighbour : neighbours)
        record.u16(neighbour.arfcn).u8(neighbour.rxLevel).u32(bits(neighbour.c1)).u32(bits(neighbour.c2)).zeros(3);
    return record.take();
}

Bytes neighbourIdentitiesRecord(std::span<const IdentifiedGSMCell> cells, Moment time)
{
    cells = counted(cells);
    RecordWriter record(0x51FF, time);
    record.zeros(1).u8(count(cells));
    for (const IdentifiedGSMCell& cell : cells)
        record.u16(cell.arfcn).u8(cell.bsic).zeros(1);
    return record.take();
}

Bytes dedicatedChannelRecord(std::uint16_t arfcn, Moment time)
{
    return RecordWriter(0x5076, time).u16(arfcn).zeros(2).take();
}

Bytes rrStateRecord(const RRReport& report, Moment time)
{
    return RecordWriter(0x512C, time)
        .u8(static_cast<std::uint32_t>(report.state))
        .u8(report.subState)
        .u8(report.status)
        .u8(report.isData ? 1 : 0)
        .take();
}

Bytes dtxRecord(bool isUsed, Moment time)
{
    return RecordWriter(0x5072, time).zeros(6).u8(isUsed ? 1 : 0).take();
}

Bytes mobileAllocationRecord(const HoppingReport& report, Moment time)
{
    const auto arfcns = counted(report.arfcns);
    RecordWriter record(0x51F8, time);
    record.u8(report.sequenceNumber).u8(count(arfcns));
    for (const std::uint16_t arfcn : arfcns)
        record.u16(arfcn);
    return record.take();
}

} // namespace spectrel
