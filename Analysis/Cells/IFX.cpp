#include "Analysis/Cells/CellTable.h"

namespace spectrel {

namespace {

using enum Meaning;

constexpr auto GSM = RadioTechnology::GSM;

constexpr auto Leaves = std::to_array<LeafRow>({
    {"/Registration/Network", "PLMN", PLMN, GSM},
    {"/Registration/Network", "Name", OperatorName, GSM},
    {"/Registration/Area", "LAC", Area, GSM},
    {"/Serving Cell", "Cell Identity", Meaning::Cell, GSM},
    {"/Serving Cell", "BSIC", Id, GSM, Reading::ColourCodes},
    {"/Serving Cell/Carrier", "ARFCN", Channel, GSM},
    {"/Serving Cell/Level", "RxLev", Meaning::Level, GSM, Reading::RXLEVWithoutUnit, Level::RSSI},
    {"/Serving Cell/Level", "C1", Meaning::Level, GSM, Reading::Number, Level::C1},
});

constexpr auto Entry = std::to_array<EntryField>({
    {"ARFCN", Channel},
    {"BSIC", Id, Reading::ColourCodes},
    {"RxLev", Meaning::Level, Reading::RXLEVWithoutUnit, Level::RSSI},
    {"C1", Meaning::Level, Reading::Number, Level::C1},
});

constexpr auto Lists = std::to_array<ListRow>({
    {.container = "/Neighbour Cells", .role = ListRole::Neighbours, .technology = GSM, .fields = Entry},
});

constexpr auto CallStates = std::to_array<ConnectionRow::Text>({
    {"No call", Connection::Idle},
    {"Active", Connection::Connected},
});

constexpr auto Connections = std::to_array<ConnectionRow>({{"/Call", "State", std::nullopt, CallStates}});

constexpr auto Registration = std::to_array<RegistrationRow>({{"/Registration", "State"}});

} // namespace

const CellTable& ifxCells()
{
    static constexpr CellTable table {.generator = "GSMLogGenerator",
        .leaves = Leaves,
        .lists = Lists,
        .connections = Connections,
        .registration = Registration,
        .contexts = {"/Packet Data/Contexts", "APN", "State", "Bytes Received", "Bytes Sent", "/Packet Data"}};
    return table;
}

} // namespace spectrel
