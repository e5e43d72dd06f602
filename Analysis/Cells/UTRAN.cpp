#include "Analysis/Cells/CellTable.h"

namespace spectrel {

namespace {

using enum Meaning;

constexpr std::string_view Info = "/Serving Cell Info";
constexpr auto UMTS = RadioTechnology::UMTS;

constexpr auto Leaves = std::to_array<LeafRow>({
    {Info, "Cell ID", Meaning::Cell, UMTS},
    {Info, "Local Area Code", Area, UMTS},
    {Info, "Downlink UARFCN", Channel, UMTS},
    {Info, "Uplink UARFCN", UplinkChannel, UMTS},
    {Info, "Freq Band Indicator", BandIndicator, UMTS},
    {Info, "Cell Scrambling Code", Id, UMTS},
});

constexpr auto Entry = std::to_array<EntryField>({
    {"UARFCN", Channel},
    {"Cell ID", Id}, // the cell parameter identity
    {"Filter RSCP", Meaning::Level, Reading::FilteredRSCP, Level::RSCP},
    {"Status", SetName},
});

constexpr auto GSMEntry = std::to_array<EntryField>({
    {"Cell ID", Meaning::Cell},
    {"ARFCN", Channel},
    {"Band Indicator", GSMBandIndicator},
    {"BSIC Valid", BSICIsValid},
    {"NCC", NetworkColour},
    {"BCC", StationColour},
    {"RSSI", Meaning::Level, Reading::Number, Level::RSSI},
});

constexpr auto Lists = std::to_array<ListRow>({
    {.container = "/Neighbor Cell List",
        .role = ListRole::BySetName,
        .technology = UMTS,
        .fields = Entry,
        .serving = ServingHint::NamedActive},
    {.container = "/GSM Neighbor Cell List",
        .role = ListRole::Neighbours,
        .technology = RadioTechnology::GSM,
        .fields = GSMEntry},
});

constexpr auto States = std::to_array<ConnectionRow::Text>({
    {"Disconnected", Connection::Idle},
    {"Connecting", Connection::Idle},
    {"Cell Fach", Connection::Connected},
    {"Cell DCH", Connection::Connected},
    {"Cell PCH", Connection::Connected},
    {"Cell URA PCH", Connection::Connected},
});

constexpr auto Connections = std::to_array<ConnectionRow>({{"/RRC Info", "State", UMTS, States}});

/// Out of service the radio resource control has no mode, and the cell allows emergency calls only.
constexpr auto NoService = std::to_array<NoServiceRow>({
    {"/RRC Info", "State", "Unknown RRC Mode", UMTS},
    {Info, "Allowed Access", "Emergency Calls Only", UMTS},
});

} // namespace

const CellTable& utranCells()
{
    static constexpr CellTable table {.generator = "UTRANLogGenerator",
        .leaves = Leaves,
        .lists = Lists,
        .connections = Connections,
        .noService = NoService,
        .contexts = {"/PDP Context Info", "APN", "State", "Bytes Received", "Bytes Sent"},
        .umtsNumbering = ChannelNumbering::UTRATDD};
    return table;
}

} // namespace spectrel
