#include "Telephony/Encoders/IFXMessage.h"

#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyList.h"

#include <cmath>
#include <string>

namespace spectrel {

namespace {

constexpr const char* Network = "001-01"; // MCC and MNC of a test network

std::string power(double level)
{
    return std::to_string(std::lround(level)) + " dBm";
}

std::string colourCode(const IFXCell& cell)
{
    return std::to_string(cell.networkColour) + "-" + std::to_string(cell.stationColour);
}

/// Path loss criterion (3GPP TS 45.008, 6.4): level above the cell's minimum.
std::string criterion(const IFXCell& cell)
{
    constexpr long RxLevAccessMin = -104;
    return std::to_string(std::lround(cell.level) - RxLevAccessMin);
}

Value registration(const IFXReport& report)
{
    return Dictionary::make({
        {"State", report.isInService ? "Registered, home" : "No service"},
        {"Network", Dictionary::make({{"PLMN", Network}, {"Name", "Test Network"}})},
        {"Area",
            Dictionary::make({
                {"LAC", std::to_string(report.serving.locationArea)},
                {"RAC", std::to_string(report.serving.routingArea)},
            })},
        {"Forbidden", List::make({"PLMN", "001-02", "001-03"})},
    });
}

/// Calls hop over some channels; the list is empty but for its heading otherwise.
Value carrier(const IFXReport& report)
{
    const std::string channel = std::to_string(report.serving.channel);
    auto hopping = List::make({"ARFCN"});
    if (report.isTalking) {
        for (const std::string& hop : {channel, std::to_string(report.serving.channel + 6), std::string("118")})
            hopping->append(hop);
    }
    return Dictionary::make({{"ARFCN", channel}, {"Hopping", hopping}});
}

Value servingCell(const IFXReport& report)
{
    const IFXCell& cell = report.serving;
    return Dictionary::make({
        {"Cell Identity", std::to_string(cell.identity)},
        {"BSIC", colourCode(cell)},
        {"Carrier", carrier(report)},
        {"Level",
            Dictionary::make({
                {"RxLev", power(cell.level)},
                {"RxQual", std::to_string(report.quality)},
                {"C1", criterion(cell)},
            })},
        {"Timing Advance", Dictionary::make({{"Steps", std::to_string(report.timingAdvance)}})},
        {"Cells Visited", std::to_string(report.cellsVisited)},
    });
}

Value neighbourCells(const IFXReport& report)
{
    auto list = List::make({"Neighbours, strongest first"});
    for (const IFXCell& cell : report.neighbours) {
        list->append(Dictionary::make({
            {"ARFCN", std::to_string(cell.channel)},
            {"BSIC", colourCode(cell)},
            {"RxLev", power(cell.level)},
            {"C1", criterion(cell)},
        }));
    }
    return list;
}

/// Every value is wrapped once or twice, as this baseband does it where a value might have company.
Value call(const IFXReport& report)
{
    const bool isTalking = report.isTalking;
    return Dictionary::make({
        {"State", isTalking ? "Active" : "No call"},
        {"Duration", Dictionary::make({{"Seconds", std::to_string(report.talkingFor.count())}})},
        {"Channel", Dictionary::make({{"Type", isTalking ? "TCH/F" : "None"}})},
        {"Codec", Dictionary::make({{"Speech", Dictionary::make({{"Mode", isTalking ? "AMR 12.2" : "None"}})}})},
    });
}

Value packetData(const IFXReport& report)
{
    const auto context = Dictionary::make({
        {"APN", "internet.test"},
        {"Address", "192.0.2.33"},
        {"Bytes Received", std::to_string(report.bytesReceived)},
        {"Bytes Sent", std::to_string(report.bytesSent)},
        {"Quality", List::make({"Class, delay", "Background", "4"})},
    });
    return Dictionary::make({
        {"State", report.isTalking ? "Suspended" : "Attached"},
        {"Contexts", List::make({"PDP contexts", context})},
    });
}

} // namespace

Value ifxState(const IFXReport& report)
{
    return Dictionary::make({
        {"Registration", registration(report)},
        {"Serving Cell", servingCell(report)},
        {"Neighbour Cells", neighbourCells(report)},
        {"Call", call(report)},
        {"Packet Data", packetData(report)},
        {"SIM", Dictionary::make({{"State", Dictionary::make({{"Card", "Ready"}})}})},
    });
}

Bytes ifxMessage(const IFXReport& report, Moment)
{
    const std::string text = serialisePropertyList(ifxState(report)).value_or(std::string());
    return {text.begin(), text.end()};
}

} // namespace spectrel
