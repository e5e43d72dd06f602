#include "Telephony/Modem/ModemRecords.h"

#include "Records/TelephonyConstants.h"
#include "Telephony/Encoders/PropertyListRecords.h"
#include "Telephony/Modem/FrequencyBands.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <algorithm>
#include <cmath>
#include <string>
#include <utility>

namespace spectrel {

namespace {

constexpr std::string_view NotKnown = "-";
constexpr std::int32_t NotMeasured = 32767; // how a cell monitor marks a power or ratio that it has not measured
constexpr double WeakestLevel = -111; // dBm, the lower end of RXLEV 0; each level is 1 dB (3GPP TS 45.008, 8.1.4)
constexpr std::size_t MaxRecordSize = 65536; // type byte and the 65535 bytes that an item length can count
constexpr double MaxMeasurement = 1000; // beyond it there is no dBm or dB

std::string joined(const std::vector<std::string>& parts)
{
    std::string text;
    for (const std::string& part : parts)
        text += (text.empty() ? "" : ", ") + part;
    return text;
}

Value orDash(std::string text)
{
    return text.empty() ? Value(NotKnown) : Value(std::move(text));
}

void setNumber(Dictionary& cell, std::string_view key, const std::optional<std::uint32_t>& number)
{
    if (number)
        cell.set(key, Value::integer(*number));
}

std::optional<std::int32_t> rounded(const std::optional<double>& measured)
{
    if (!measured || !(std::abs(*measured) < MaxMeasurement))
        return std::nullopt;
    return static_cast<std::int32_t>(std::lround(*measured));
}

void setMeasured(Dictionary& cell, std::string_view key, const std::optional<double>& measured)
{
    if (const auto whole = rounded(measured))
        cell.set(key, Value::integer(*whole));
}

/// For the keys that readers want in every cell.
void setMeasuredOrNot(Dictionary& cell, std::string_view key, const std::optional<double>& measured)
{
    cell.set(key, Value::integer(rounded(measured).value_or(NotMeasured)));
}

std::optional<double> firstOf(const std::optional<double>& first, const std::optional<double>& second)
{
    return first ? first : second;
}

void setNetwork(Dictionary& dictionary, const std::string& operatorId)
{
    if (!isOperatorId(operatorId))
        return;
    dictionary.set(kRKCellMonitorMCC, Value::integer(std::stoi(operatorId.substr(0, 3))));
    dictionary.set(kRKCellMonitorMNC, Value::integer(std::stoi(operatorId.substr(3))));
    dictionary.set(kRKCellMonitorPLMN, networkName(operatorId));
}

void setGSM(Dictionary& dictionary, const CellFacts& cell, const SignalFacts& signal)
{
    setNumber(dictionary, kRKCellMonitorLAC, cell.areaCode);
    setNumber(dictionary, kRKCellMonitorARFCN, cell.channel);
    std::optional<double> power = signal.rssi;
    if (!power && cell.rxLevel && *cell.rxLevel <= 63)
        power = WeakestLevel + *cell.rxLevel;
    setMeasuredOrNot(dictionary, kRKCellMonitorRSSI, power ? std::optional(*power / 2) : std::nullopt);
}

void setUMTS(Dictionary& dictionary, const CellFacts& cell, const SignalFacts& signal)
{
    setNumber(dictionary, kRKCellMonitorLAC, cell.areaCode);
    setNumber(dictionary, kRKCellMonitorUARFCN, cell.channel);
    setNumber(dictionary, kRKCellMonitorSCN, cell.psc);
    setMeasuredOrNot(dictionary, kRKCellMonitorRSCP, firstOf(signal.rscp, cell.power));
    setMeasuredOrNot(dictionary, kRKCellMonitorECN0, firstOf(signal.ecio, cell.quality));
    setMeasured(dictionary, kRKCellMonitorRSSI, signal.rssi);
}

void setLTE(Dictionary& dictionary, const CellFacts& cell, const SignalFacts& signal)
{
    setNumber(dictionary, kRKCellMonitorTAC, cell.areaCode);
    setNumber(dictionary, kRKCellMonitorPID, cell.physicalCellId);
    setNumber(dictionary, kRKCellMonitorBandInfo, cell.channel ? lteBand(*cell.channel) : std::nullopt);
    setNumber(dictionary, kRKCellMonitorUARFCN, cell.channel);
    setMeasured(dictionary, kRKCellMonitorRSRP, firstOf(signal.rsrp, cell.power));
    setMeasured(dictionary, kRKCellMonitorRSRQ, firstOf(signal.rsrq, cell.quality));
    setMeasured(dictionary, kRKCellMonitorRSSI, signal.rssi);
    setMeasured(dictionary, kRKCellMonitorSNR, signal.snr);
}

struct KindOfCell {
    std::string_view constant;
    void (*set)(Dictionary& dictionary, const CellFacts& cell, const SignalFacts& signal);
};

KindOfCell kindOfCell(CellKind kind)
{
    switch (kind) {
    case CellKind::GSM:
        return {kRKCellMonitorRadioAccessTechnologyGSM, setGSM};
    case CellKind::UMTS:
        return {kRKCellMonitorRadioAccessTechnologyUMTS, setUMTS};
    case CellKind::LTE:
        break;
    }
    return {kRKCellMonitorRadioAccessTechnologyLTE, setLTE};
}

DictionaryRef cellDictionary(const CellFacts& cell, const SignalFacts& signal)
{
    const KindOfCell kind = kindOfCell(cell.kind);
    auto dictionary = Dictionary::make({
        {std::string(kRKCellMonitorCellRadioAccessTechnology), kind.constant},
        {std::string(kRKCellMonitorCellType),
            cell.isServing ? kRKCellMonitorCellTypeServing : kRKCellMonitorCellTypeNeighbor},
    });
    setNetwork(*dictionary, cell.operatorId);
    setNumber(*dictionary, kRKCellMonitorCellId, cell.cellId);
    kind.set(*dictionary, cell, cell.isServing ? signal : SignalFacts());
    return dictionary;
}

DictionaryRef contextDictionary(const BearerFacts& bearer)
{
    auto dictionary = Dictionary::make();
    const auto write = [&dictionary](std::string_view key, std::string text) {
        if (!text.empty())
            dictionary->set(key, std::move(text));
    };
    const auto counted = [](const std::optional<std::uint64_t>& number) {
        return number ? std::to_string(*number) : std::string();
    };
    write("Context ID", bearer.id);
    write("APN", bearer.apn);
    write("Type", bearer.type);
    write("Interface", bearer.interface);
    write("Address", bearer.address);
    write("IPv6 Address", bearer.ipv6Address);
    write("Gateway", bearer.gateway);
    write("DNS", joined(bearer.dns));
    write("State", bearer.state);
    write("Bytes Received", counted(bearer.bytesReceived));
    write("Bytes Sent", counted(bearer.bytesSent));
    return dictionary;
}

/// A record of a list; its length has 16 bits, so the last elements go if it would be longer.
Bytes listRecord(std::uint32_t code, std::vector<DictionaryRef> elements, Moment time)
{
    for (;;) {
        auto list = List::make();
        for (const DictionaryRef& element : elements)
            list->append(element);
        Bytes record = propertyListRecord(code, list, time);
        if (record.size() <= MaxRecordSize || elements.empty())
            return record;
        elements.pop_back();
    }
}

} // namespace

Bytes modemSimRecord(const std::optional<SimFacts>& sim, Moment time)
{
    const SimFacts known = sim.value_or(SimFacts());
    return propertyListRecord(0xFF0000,
        Dictionary::make({
            {"kSimFile_ICCID", orDash(known.iccid)},
            {"kSimFile_MSISDN", orDash(joined(known.ownNumbers))},
            {"kSimFile_AHPLMN", orDash(networkName(known.operatorId))},
            {"kSimFile_PNN", orDash(known.operatorName)},
        }),
        time);
}

Bytes modemCellsRecord(const std::vector<CellFacts>& cells, const SignalFacts& signal, Moment time)
{
    std::vector<DictionaryRef> values;
    for (std::size_t place = 0; place < std::min(cells.size(), MaxModemElements); ++place)
        values.push_back(cellDictionary(cells[place], signal));
    return listRecord(0xFF0001, std::move(values), time);
}

Bytes modemContextsRecord(const std::vector<BearerFacts>& bearers, Moment time)
{
    std::vector<DictionaryRef> values;
    for (std::size_t place = 0; place < std::min(bearers.size(), MaxModemElements); ++place)
        values.push_back(contextDictionary(bearers[place]));
    return listRecord(0xFF0002, std::move(values), time);
}

} // namespace spectrel
