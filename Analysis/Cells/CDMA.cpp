#include "Analysis/Cells/CellTable.h"

namespace spectrel {

namespace {

using enum Meaning;

constexpr std::string_view OneX = "/1x";
constexpr std::string_view System = "/1x/System";
constexpr std::string_view DataOnly = "/EV-DO";

constexpr auto CDMA = RadioTechnology::CDMA;
constexpr auto EVDO = RadioTechnology::EVDO;

constexpr auto Leaves = std::to_array<LeafRow>({
    {OneX, "Rx 0 Band Class", BandIndicator, CDMA, Reading::BracketedNumber},
    {OneX, "Rx 0 Channel", Channel, CDMA},
    {OneX, "Rx 0 Power", Meaning::Level, CDMA, Reading::Number, Level::RSSI},
    {System, "Base Station ID", Meaning::Cell, CDMA},

    {DataOnly, "Band Class", BandIndicator, EVDO, Reading::BracketedNumber},
    {DataOnly, "Channel", Channel, EVDO},
    {DataOnly, "Serving PN Offset", Id, EVDO},
    {DataOnly, "Rx AGC 0", Meaning::Level, EVDO, Reading::Number, Level::RSSI},
});

constexpr auto PilotEntry =
    std::to_array<EntryField>({{"", Meaning::Level, Reading::Pilot, Level::EcIo}}); // under its PN offset

constexpr auto Lists = std::to_array<ListRow>({
    {.container = "/1x/Active Set",
        .role = ListRole::Active,
        .technology = CDMA,
        .fields = PilotEntry,
        .shape = ListShape::Pilots,
        .serving = ServingHint::ReferencePilot,
        .channelContainer = SameChannel},
    {.container = "/EV-DO/Active Set",
        .role = ListRole::Active,
        .technology = EVDO,
        .fields = PilotEntry,
        .shape = ListShape::Pilots,
        .serving = ServingHint::Levels,
        .channelContainer = SameChannel},
});

constexpr auto OneXStates = std::to_array<ConnectionRow::Text>({
    {"Sync [4]", Connection::Idle},
    {"Paging [6]", Connection::Idle},
    {"Slotted mode sleep state [7]", Connection::Idle},
    {"Traffic [8]", Connection::Connected},
});

constexpr auto DataOnlyStates = std::to_array<ConnectionRow::Text>({
    {"Idle [3]", Connection::Idle},
    {"Access [4]", Connection::Idle},
    {"Connected [5]", Connection::Connected},
});

constexpr auto Connections = std::to_array<ConnectionRow>({
    {OneX, "State", std::nullopt, OneXStates},
    {DataOnly, "State", std::nullopt, DataOnlyStates},
});

constexpr auto Registration = std::to_array<RegistrationRow>({{System, "Roaming Indicator"}});

/// States in which the phone has no pilot yet, or none any more.
constexpr auto NoService = std::to_array<NoServiceRow>({
    {OneX, "State", "Inactive [0]", CDMA},
    {OneX, "State", "Initial state for CDMA operation [2]", CDMA},
    {OneX, "State", "Acquisition [3]", CDMA},
    {OneX, "State", "Powerup state [11]", CDMA},
    {DataOnly, "State", "Inactive [0]", EVDO},
    {DataOnly, "State", "Acquisition [1]", EVDO},
});

} // namespace

const CellTable& cdmaCells()
{
    static constexpr CellTable table {.generator = "C2KLogGenerator",
        .leaves = Leaves,
        .lists = Lists,
        .connections = Connections,
        .registration = Registration,
        .noService = NoService,
        .contexts = {}};
    return table;
}

} // namespace spectrel
