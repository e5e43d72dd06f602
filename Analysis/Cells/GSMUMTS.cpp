#include "Analysis/Cells/CellTable.h"

namespace spectrel {

namespace {

using enum Meaning;

constexpr std::string_view Network = "/Network/Serving PLMN";
constexpr std::string_view RRC = "/UMTS/UMTS RR Info";
constexpr std::string_view UMTSSetList = "/UMTS/UMTS Set";
constexpr std::string_view GSMServing = "/GSM/GSM Serving Cell";

constexpr auto UMTS = RadioTechnology::UMTS;
constexpr auto GSM = RadioTechnology::GSM;

constexpr auto Leaves = std::to_array<LeafRow>({
    {Network, "Mobile Country Code", CountryCode, std::nullopt},
    {Network, "Mobile Network Code", NetworkCode, std::nullopt},
    {Network, "Location Area Code", Area, std::nullopt},

    {RRC, "Cell ID", Meaning::Cell, UMTS},
    {RRC, "Downlink Frequency", Channel, UMTS},
    {RRC, "UARFCN", Channel, UMTS}, // of the cell information; the serving cell's record takes it away
    {RRC, "Uplink Frequency", UplinkChannel, UMTS},
    {RRC, "Scrambling Code", Id, UMTS},

    {GSMServing, "Cell ID", Meaning::Cell, GSM},
    {GSMServing, "ARFCN", Channel, GSM},
    {GSMServing, "BSIC", Id, GSM},
    {GSMServing, "RSSI", Meaning::Level, GSM, Reading::RXLEV, Level::RSSI}, // shown with a unit, yet an RXLEV
    // With a channel of its own the phone reports the reception quality in the place of the criteria.
    {GSMServing, "C1 Value", Meaning::Level, GSM, Reading::Signed16, Level::C1, Mode::Any, 0, true},
    {GSMServing, "C2 Value", Meaning::Level, GSM, Reading::Signed16, Level::C2, Mode::Any, 0, true},
});

constexpr auto ActiveEntry = std::to_array<EntryField>({
    {"Scrambling Code", Id},
    {"RSCP", Meaning::Level, Reading::Number, Level::RSCP}, // in dBm whatever unit is shown
    {"Energy Per Chip", Meaning::Level, Reading::Number, Level::EcNo},
});

constexpr auto RankedEntry = std::to_array<EntryField>({
    {"Scrambling Code", Id},
    {"Downlink Frequency", Channel}, // of the ranking
    {"UARFCN", Channel}, // of the cell information
    {"RSCP", Meaning::Level, Reading::Number, Level::RSCP},
    {"Rank Cell RSCP", Meaning::Level, Reading::Number, Level::RSCP, 1},
    {"Energy Per Chip", Meaning::Level, Reading::Number, Level::EcNo},
});

constexpr auto RankedGSMEntry = std::to_array<EntryField>({
    {"ARFCN", Channel},
    {"BSIC", Id},
    {"RSSI", Meaning::Level, Reading::Number, Level::RSSI},
});

/// Measured neighbours have levels without a unit, those of the cell information dBm.
constexpr auto GSMEntry = std::to_array<EntryField>({
    {"ARFCN", Channel},
    {"BSIC", Id},
    {"RSSI", Meaning::Level, Reading::RXLEVWithoutUnit, Level::RSSI},
    {"C1 Value", Meaning::Level, Reading::Number, Level::C1},
});

constexpr auto Lists = std::to_array<ListRow>({
    {.container = "/UMTS/Active Set",
        .role = ListRole::Active,
        .technology = UMTS,
        .fields = ActiveEntry,
        .serving = ServingHint::OnlyEntry,
        .channelContainer = SameChannel},
    {.container = UMTSSetList,
        .role = ListRole::Neighbours,
        .technology = UMTS,
        .fields = RankedEntry,
        .serving = ServingHint::Levels},
    {.container = "/GSM/Neighboring Cells", .role = ListRole::Neighbours, .technology = GSM, .fields = GSMEntry},
    // Where UMTS cells were ranked as well, their bytes stand in this list.
    {.container = "/GSM/GSM Set",
        .role = ListRole::Neighbours,
        .technology = GSM,
        .fields = RankedGSMEntry,
        .onlyWithout = UMTSSetList},
});

/// The connected mode of 3GPP TS 25.331, 7.1.
constexpr auto RRCStates = std::to_array<ConnectionRow::Text>({
    {"Disconnected", Connection::Idle},
    {"Connecting", Connection::Idle},
    {"CELL_FACH", Connection::Connected},
    {"CELL_DCH", Connection::Connected},
    {"CELL_PCH", Connection::Connected},
    {"URA_PCH", Connection::Connected},
});

constexpr auto RRStates = std::to_array<ConnectionRow::Text>({
    {"RR_IDLE", Connection::Idle},
    {"RR_GOING_ACTIVE", Connection::Idle},
    {"RR_CELL_SELECTION", Connection::Idle},
    {"RR_CELL_RESELECTION", Connection::Idle},
    {"RR_CONNECTION_PENDING", Connection::Idle},
    {"RR_CHOOSE_CELL", Connection::Idle},
    {"RR_W2G_INTERRAT_RESELECTION_PROGRESS", Connection::Idle},
    {"RR_G2W_INTERRAT_RESELECTION_PROGRESS", Connection::Idle},
    {"RR_DATA_TRANSFER", Connection::Connected},
    {"RR_CONNECTION_RELEASE", Connection::Connected},
    {"RR_CELL_REEST", Connection::Connected},
    {"RR_W2G_INTERRAT_HANDOVER_ PROGRESS", Connection::Connected},
    {"RR_G2W_INTERRAT_HANDOVER_ PROGRESS", Connection::Connected},
    {"RR_W2G_INTERRAT_CC_ORDER_ PROGRESS", Connection::Connected},
});

constexpr auto Connections = std::to_array<ConnectionRow>({
    {RRC, "RRC State", UMTS, RRCStates},
    {"/GSM/GSM RR Info", "RR State", GSM, RRStates},
});

constexpr auto Registration = std::to_array<RegistrationRow>({
    {Network, "Service Type"},
    {"/Network/Process CS", "LU Reject Cause", "UPDATED"},
    {"/Network/Process PS", "Attach Reject Cause", "GMM_GU1_UPDATED"},
});

constexpr auto NoService = std::to_array<NoServiceRow>({
    {Network, "Service Type", "NO_SERVICE", UMTS},
});

} // namespace

const CellTable& gsmumtsCells()
{
    static constexpr CellTable table {.generator = "ZPH_GSMLogGenerator",
        .leaves = Leaves,
        .lists = Lists,
        .connections = Connections,
        .registration = Registration,
        .noService = NoService,
        .contexts = {"/PDP Context Info", "APN", "State", "Bytes Received", "Bytes Sent"}};
    return table;
}

} // namespace spectrel
