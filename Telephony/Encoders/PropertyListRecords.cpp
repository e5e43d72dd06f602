#include "Telephony/Encoders/PropertyListRecords.h"

#include "Records/TelephonyConstants.h"
#include "Telephony/Encoders/RecordWriter.h"
#include "Telephony/Reports/LTECell.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyList.h"

#include <cstdio>
#include <string>

namespace spectrel {

namespace {

DictionaryRef cellDictionary(const LTECell& cell, std::string_view type)
{
    auto dictionary = Dictionary::make();
    dictionary->set(kRKCellMonitorCellRadioAccessTechnology, kRKCellMonitorRadioAccessTechnologyLTE);
    dictionary->set(kRKCellMonitorCellType, type);
    dictionary->set(kRKCellMonitorMCC, Value::integer(1));
    dictionary->set(kRKCellMonitorMNC, Value::integer(1));
    dictionary->set(kRKCellMonitorTAC, Value::integer(cell.trackingArea));
    dictionary->set(kRKCellMonitorCellId, Value::integer(cell.identity));
    dictionary->set(kRKCellMonitorPID, Value::integer(cell.physicalCellId));
    dictionary->set(kRKCellMonitorBandInfo, Value::integer(cell.band));
    dictionary->set(kRKCellMonitorUARFCN, Value::integer(cell.downlinkChannel));
    return dictionary;
}

/// A test network's area: MCC 001, MNC 01, its location area, and what follows.
std::string areaText(unsigned locationArea, unsigned last)
{
    char text[32];
    std::snprintf(text, sizeof text, "00F110 %04X %02X", locationArea, last);
    return text;
}

} // namespace

Bytes propertyListRecord(std::uint32_t code, const Value& payload, Moment time)
{
    const std::string text = serialisePropertyList(payload).value_or(std::string());
    return RecordWriter(code, time).bytes({reinterpret_cast<const std::uint8_t*>(text.data()), text.size()}).take();
}

Bytes simFilesRecord(Moment time, const SIMFiles& files)
{
    return propertyListRecord(0xFF0000,
        Dictionary::make({
            {"kSimFile_ICCID", "8900101000000000017"},
            {"kSimFile_MSISDN", "+10015550100"},
            {"kSimFile_MBDN", "+10015550199"},
            {"kSimFile_HPPLMN", "60 min"},
            {"kSimFile_LOCI", areaText(files.locationArea, 0xFE)},
            {"kSimFile_PSLOCI", areaText(files.packetLocationArea, files.routingArea)},
            {"kSimFile_ACC", "0001"},
            {"kSimFile_AD", "80 00 00 02"},
            {"kSimFile_FPLMN", "001-02, 001-03"},
            {"kSimFile_AHPLMN", "001-01"},
            {"kSimFile_RATMODE", files.ratMode},
            {"kSimFile_PNN", "Test Network"},
            {"kSimFile_OPL", "001-01 0000-FFFE"},
            {"kSimFile_OPLMNAcT", "001-01 E-UTRAN, 001-01 UTRAN, 001-01 GSM"},
        }),
        time);
}

Bytes lteCellInformationRecord(const LTECell& serving, std::span<const LTECell* const> neighbours, Moment time)
{
    auto cells = List::make({cellDictionary(serving, kRKCellMonitorCellTypeServing)});
    for (const LTECell* neighbour : neighbours)
        cells->append(cellDictionary(*neighbour, kRKCellMonitorCellTypeNeighbor));
    return propertyListRecord(0xFF0001, cells, time);
}

Bytes packetContextRecord(std::uint64_t bytesReceived, std::uint64_t bytesSent, Moment time)
{
    return propertyListRecord(0xFF0002,
        List::make({Dictionary::make({
            {"Context ID", "5"},
            {"APN", "internet.test"},
            {"Type", "IPv4"},
            {"Address", "192.0.2.17"},
            {"NSAPI", "5"},
            {"Traffic Class", "Interactive"},
            {"State", "Active"},
            {"Bytes Received", std::to_string(bytesReceived)},
            {"Bytes Sent", std::to_string(bytesSent)},
        })}),
        time);
}

Bytes contextsRecord(std::uint64_t bytesReceived, std::uint64_t bytesSent, Moment time)
{
    return propertyListRecord(0xFF0002,
        List::make({
            Dictionary::make({
                {"Context ID", "5"},
                {"APN", "internet.test"},
                {"Type", "IPv4v6"},
                {"Address", "192.0.2.17"},
                {"IPv6 Address", "2001:db8:1::17"},
                {"QCI", "9"},
                {"State", "Active"},
                {"Bytes Received", std::to_string(bytesReceived)},
                {"Bytes Sent", std::to_string(bytesSent)},
            }),
            Dictionary::make({
                {"Context ID", "6"},
                {"APN", "ims.test"},
                {"Type", "IPv6"},
                {"IPv6 Address", "2001:db8:2::17"},
                {"QCI", "5"},
                {"State", "Active"},
                {"Bytes Received", std::to_string(bytesReceived / 4096)},
                {"Bytes Sent", std::to_string(bytesSent / 1024)},
            }),
        }),
        time);
}

} // namespace spectrel
