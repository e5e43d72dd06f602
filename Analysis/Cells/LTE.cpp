#include "Analysis/Cells/CellTable.h"

namespace spectrel {

namespace {

using enum Meaning;

constexpr std::string_view Info = "/Serving Cell Info";
constexpr std::string_view Idle = "/Serving Cell Measurements";
constexpr std::string_view IdleNeighbours = "/Neighbor Measurements";
constexpr std::string_view Candidates = "/Reselection Candidates";
constexpr std::string_view Connected = "/Connected mode LTE Intra-frequency Measurement";

constexpr auto LTE = RadioTechnology::LTE;

constexpr auto Leaves = std::to_array<LeafRow>({
    {Info, "Physical Cell ID", Id, LTE},
    {Info, "Download Frequency", Channel, LTE},
    {Info, "UARFCN", Channel, LTE}, // of the cell information; the record above takes it away
    {Info, "Upload Frequency", UplinkChannel, LTE},
    {Info, "Download Bandwidth", BandwidthMHz, LTE},
    {Info, "Cell Identity", Meaning::Cell, LTE},
    {Info, "Tracking Area Code", Area, LTE},
    {Info, "Freq Band Indicator", BandIndicator, LTE},
    {Candidates, "Serving EARFCN", Channel, LTE},
    {Candidates, "Serving Cell ID", Id, LTE},

    {.container = Idle, .key = "E-ARFCN", .meaning = Channel, .technology = LTE, .mode = Mode::Idle},
    {.container = Idle, .key = "Physical Cell ID", .meaning = Id, .technology = LTE, .mode = Mode::Idle},
    {Idle, "Measured RSRP", Meaning::Level, LTE, Reading::Number, Level::RSRP, Mode::Idle},
    {Idle, "Average RSRP", Meaning::Level, LTE, Reading::Number, Level::RSRP, Mode::Idle, 1},
    {Idle, "Measured RSRQ", Meaning::Level, LTE, Reading::Number, Level::RSRQ, Mode::Idle},
    {Idle, "Average RSRQ", Meaning::Level, LTE, Reading::Number, Level::RSRQ, Mode::Idle, 1},
    {Idle, "Measured RSSI", Meaning::Level, LTE, Reading::Number, Level::RSSI, Mode::Idle},
    {Idle, "Srxlev", Meaning::Level, LTE, Reading::Number, Level::Srxlev, Mode::Idle},

    {.container = Connected, .key = "E-ARFCN", .meaning = Channel, .technology = LTE, .mode = Mode::Connected},
    {.container = Connected,
        .key = "Serving Physical Cell ID",
        .meaning = Id,
        .technology = LTE,
        .mode = Mode::Connected},
    {Connected, "Serving Filtered RSRP", Meaning::Level, LTE, Reading::Number, Level::RSRP, Mode::Connected},
    {Connected, "Serving Filtered RSRQ", Meaning::Level, LTE, Reading::Number, Level::RSRQ, Mode::Connected},
});

constexpr auto IdleEntry = std::to_array<EntryField>({
    {"Physical Cell ID", Id},
    {"Measured RSRP", Meaning::Level, Reading::Number, Level::RSRP},
    {"Average RSRP", Meaning::Level, Reading::Number, Level::RSRP, 1},
    {"Measured RSRQ", Meaning::Level, Reading::Number, Level::RSRQ},
    {"Average RSRQ", Meaning::Level, Reading::Number, Level::RSRQ, 1},
    {"Measured RSSI", Meaning::Level, Reading::Number, Level::RSSI},
    {"Srxlev", Meaning::Level, Reading::Number, Level::Srxlev},
});

constexpr auto MeasuredEntry = std::to_array<EntryField>({
    {"Physical Cell ID", Id},
    {"Filtered RSRP", Meaning::Level, Reading::Number, Level::RSRP},
    {"Filtered RSRQ", Meaning::Level, Reading::Number, Level::RSRQ},
});

constexpr auto DetectedEntry = std::to_array<EntryField>({{"Physical Cell ID", Id}});

constexpr auto Lists = std::to_array<ListRow>({
    {.container = "/Neighbor Cells List",
        .role = ListRole::Neighbours,
        .technology = LTE,
        .fields = IdleEntry,
        .mode = Mode::Idle,
        .channelContainer = IdleNeighbours,
        .channelKey = "E-ARFCN"},
    {.container = "/Measured Neighbor Cells",
        .role = ListRole::Neighbours,
        .technology = LTE,
        .fields = MeasuredEntry,
        .mode = Mode::Connected,
        .channelContainer = Connected,
        .channelKey = "E-ARFCN"},
    {.container = "/Detected Cells",
        .role = ListRole::Neighbours,
        .technology = LTE,
        .fields = DetectedEntry,
        .mode = Mode::Connected,
        .channelContainer = Connected,
        .channelKey = "E-ARFCN"},
});

} // namespace

const CellTable& lteCells()
{
    static constexpr CellTable table {.generator = "LTELogGenerator",
        .leaves = Leaves,
        .lists = Lists,
        .contexts = {"/PDP Context Info", "APN", "State", "Bytes Received", "Bytes Sent"}};
    return table;
}

} // namespace spectrel
