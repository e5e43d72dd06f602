#include "Telephony/Encoders/UTRANRecords.h"

#include "Records/TelephonyConstants.h"
#include "Telephony/Encoders/BitPacker.h"
#include "Telephony/Encoders/PropertyListRecords.h"
#include "Telephony/Encoders/RecordWriter.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <algorithm>

namespace spectrel {

namespace {

constexpr double BSICReadable = -95; // dBm: of weaker GSM cells the colours are not known

/// RSCP in the 92 levels of a report, 0 being below -115 dBm (3GPP TS 25.123, 9.1.1.1.3).
std::uint32_t rscpLevel(double dBm)
{
    return static_cast<std::uint32_t>(std::clamp(dBm + 116, 0.0, 91.0));
}

BitPacker neighbourFields(const UTRANNeighbour& cell)
{
    BitPacker fields;
    fields.field(14, cell.channel).field(7, cell.cellParameterId).field(8, rscpLevel(cell.rscp));
    fields.field(2, static_cast<std::uint32_t>(cell.set)).field(1, cell.isJointlyDetected ? 1 : 0);
    return fields;
}

DictionaryRef cellDictionary(const UTRANCell& cell, std::string_view type)
{
    auto dictionary = Dictionary::make();
    dictionary->set(kRKCellMonitorCellRadioAccessTechnology, kRKCellMonitorRadioAccessTechnologyUTRAN2);
    dictionary->set(kRKCellMonitorCellType, type);
    dictionary->set(kRKCellMonitorMCC, Value::integer(1));
    dictionary->set(kRKCellMonitorMNC, Value::integer(1));
    dictionary->set(kRKCellMonitorLAC, Value::integer(cell.locationArea));
    dictionary->set(kRKCellMonitorCellId, Value::integer(cell.identity));
    dictionary->set(kRKCellMonitorBandInfo, Value::integer(34)); // 2010 to 2025 MHz
    dictionary->set(kRKCellMonitorSCN, Value::integer(cell.cellParameterId));
    dictionary->set(kRKCellMonitorUARFCN, Value::integer(cell.channel));
    return dictionary;
}

} // namespace

Bytes utranRRCRecord(RRCMode mode, bool isInService, Moment time)
{
    return RecordWriter(0xD0E0, time).u8(isInService ? 1 : 0).u8(static_cast<std::uint32_t>(mode)).take();
}

Bytes utranServingCellRecord(const UTRANCell& cell, bool isInService, Moment time)
{
    return RecordWriter(0xD0E2, time)
        .u8(1) // version
        .u8(0) // nothing is barred or reserved
        .u8(cell.registrationArea)
        .zeros(1)
        .u16(cell.channel) // both ways on one channel, in time slots
        .u16(cell.channel)
        .u32(cell.identity)
        .u8(isInService ? 0 : 1)
        .take();
}

Bytes utranNeighbourRecord(std::span<const UTRANNeighbour> cells, Moment time)
{
    constexpr std::size_t MaxCount = 127;
    constexpr std::size_t EntrySize = 16;
    cells = cells.first(std::min(cells.size(), MaxCount));
    RecordWriter record(0xD00A, time);
    record.zeros(3).u8(static_cast<std::uint32_t>(cells.size() << 1)).zeros(151);
    for (const UTRANNeighbour& cell : cells) {
        const BitPacker fields = neighbourFields(cell);
        record.bytes(fields.bytes()).zeros(EntrySize - fields.bytes().size());
    }
    return record.take();
}

Bytes utranGSMNeighbourRecord(std::span<const GSMNeighbour> cells, Moment time)
{
    constexpr std::size_t MaxCount = 255;
    cells = cells.first(std::min(cells.size(), MaxCount));
    RecordWriter record(0xD00E, time);
    record.zeros(3).u8(static_cast<std::uint32_t>(cells.size()));
    for (const GSMNeighbour& cell : cells) {
        BitPacker fields;
        fields.field(14, cell.identity).field(1, cell.isPCSBand ? 1 : 0).field(1, cell.rssi >= BSICReadable ? 1 : 0);
        record.bytes(fields.bytes()).u8(cell.networkColour).u8(cell.stationColour).u16(cell.channel);
        record.u16(static_cast<std::uint32_t>(static_cast<std::int32_t>(cell.rssi)));
    }
    return record.take();
}

Bytes utranTransportChannelRecord(const TransportReport& report, Moment time)
{
    constexpr std::size_t MaxChannels = 63;
    constexpr std::size_t MaxComposites = 15;
    const std::size_t channels = std::min(report.channels.size(), MaxChannels);
    const std::size_t composites = std::min(report.composites.size(), MaxComposites);
    const BitPacker counts = BitPacker()
                                 .gap(6)
                                 .field(6, static_cast<std::uint32_t>(channels))
                                 .field(4, static_cast<std::uint32_t>(composites));
    RecordWriter record(0xD00C, time);
    record.u8(1).bytes(counts.bytes()).zeros(1); // version 1
    for (std::size_t index = 0; index < channels; ++index)
        record.u8(report.channels[index].number).u8(report.channels[index].blockErrors);
    record.zeros(289 + 34 * channels - (17 + 2 * channels));
    for (std::size_t index = 0; index < composites; ++index) {
        const CodedCompositeChannel& channel = report.composites[index];
        record.u8(channel.number).u8(channel.slots).bytes(channel.signalToInterference);
    }
    return record.take();
}

Bytes utranSIMFilesRecord(const UTRANCell& cell, Moment time)
{
    return simFilesRecord(time, {cell.locationArea, cell.locationArea, 1, "UTRAN preferred"});
}

Bytes utranCellInformationRecord(const UTRANCell& serving, std::span<const UTRANCell* const> others, Moment time)
{
    constexpr std::size_t MaxNeighbours = 4;
    auto cells = List::make({cellDictionary(serving, kRKCellMonitorCellTypeServing)});
    for (const UTRANCell* cell : others.first(std::min(others.size(), MaxNeighbours)))
        cells->append(cellDictionary(*cell, kRKCellMonitorCellTypeNeighbor));
    return propertyListRecord(0xFF0001, cells, time);
}

} // namespace spectrel
