#include "Telephony/Encoders/GSMUMTSPropertyLists.h"

#include "Records/TelephonyConstants.h"
#include "Telephony/Encoders/PropertyListRecords.h"
#include "Telephony/Reports/GSMUMTSCellInformation.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <cmath>

namespace spectrel {

namespace {

constexpr std::int64_t NotMeasured = 32767;

Value whole(double value)
{
    return Value::integer(std::lround(value));
}

DictionaryRef cellDictionary(std::string_view technology, std::string_view type)
{
    auto dictionary = Dictionary::make();
    dictionary->set(kRKCellMonitorCellRadioAccessTechnology, technology);
    dictionary->set(kRKCellMonitorCellType, type);
    return dictionary;
}

void setPlace(Dictionary& dictionary, std::uint16_t locationArea, std::uint32_t identity)
{
    dictionary.set(kRKCellMonitorMCC, Value::integer(1));
    dictionary.set(kRKCellMonitorMNC, Value::integer(1));
    dictionary.set(kRKCellMonitorLAC, Value::integer(locationArea));
    dictionary.set(kRKCellMonitorCellId, Value::integer(identity));
}

DictionaryRef servingUMTSCell(const UMTSCell& cell)
{
    auto dictionary = cellDictionary(kRKCellMonitorRadioAccessTechnologyUMTS, kRKCellMonitorCellTypeServing);
    setPlace(*dictionary, cell.locationArea, cell.identity);
    dictionary->set(kRKCellMonitorUARFCN, Value::integer(cell.downlinkChannel));
    dictionary->set(kRKCellMonitorSCN, Value::integer(cell.scramblingCode));
    dictionary->set(kRKCellMonitorRSCP, whole(cell.rscp));
    dictionary->set(kRKCellMonitorECN0, whole(cell.ecno));
    return dictionary;
}

DictionaryRef servingGSMCell(const GSMCell& cell)
{
    auto dictionary = cellDictionary(kRKCellMonitorRadioAccessTechnologyGSM, kRKCellMonitorCellTypeServing);
    setPlace(*dictionary, cell.locationArea, cell.identity);
    dictionary->set(kRKCellMonitorARFCN, Value::integer(cell.arfcn));
    dictionary->set(kRKCellMonitorRSSI, whole(cell.rssi / 2));
    return dictionary;
}

DictionaryRef umtsNeighbour(const RankedUMTSCell& cell)
{
    auto dictionary = cellDictionary(kRKCellMonitorRadioAccessTechnologyUMTS, kRKCellMonitorCellTypeNeighbor);
    dictionary->set(kRKCellMonitorUARFCN, Value::integer(cell.downlinkChannel));
    dictionary->set(kRKCellMonitorSCN, Value::integer(cell.scramblingCode));
    dictionary->set(kRKCellMonitorRSCP, cell.isMeasured ? whole(cell.rscp) : Value::integer(NotMeasured));
    dictionary->set(kRKCellMonitorECN0, cell.isMeasured ? whole(cell.ecno) : Value::integer(NotMeasured));
    return dictionary;
}

/// Levels of GSM neighbours count in steps of 2 dB.
DictionaryRef gsmNeighbour(const GSMCell& cell, bool isMeasured)
{
    auto dictionary = cellDictionary(kRKCellMonitorRadioAccessTechnologyGSM, kRKCellMonitorCellTypeNeighbor);
    dictionary->set(kRKCellMonitorARFCN, Value::integer(cell.arfcn));
    dictionary->set(kRKCellMonitorRSSI, isMeasured ? whole(cell.rssi / 2) : Value::integer(NotMeasured));
    return dictionary;
}

} // namespace

Bytes gsmumtsSIMFilesRecord(const Place& location, const Place& routing, Moment time)
{
    return simFilesRecord(time, {location.locationArea, routing.locationArea, routing.routingArea, "UTRAN preferred"});
}

Bytes gsmumtsCellInformationRecord(const GSMUMTSCellInformation& information, Moment time)
{
    auto cells = List::make();
    if (information.servingUMTS)
        cells->append(servingUMTSCell(*information.servingUMTS));
    if (information.servingGSM)
        cells->append(servingGSMCell(*information.servingGSM));
    for (const RankedUMTSCell& cell : information.umtsNeighbours)
        cells->append(umtsNeighbour(cell));
    for (const GSMCell* cell : information.gsmNeighbours)
        cells->append(gsmNeighbour(*cell, information.measuresGSM));
    return propertyListRecord(0xFF0001, cells, time);
}

Bytes packetContextsRecord(const std::optional<PacketTransfer>& session, Moment time)
{
    if (!session)
        return propertyListRecord(0xFF0002, List::make(), time);
    return packetContextRecord(session->bytesReceived, session->bytesSent, time);
}

} // namespace spectrel
