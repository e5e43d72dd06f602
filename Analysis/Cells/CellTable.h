#pragma once

#include "Analysis/Bands/Bands.h"
#include "Analysis/CellReport.h"
#include "Analysis/Cells/Reading.h"

#include <array>
#include <cstdint>
#include <optional>
#include <span>
#include <string_view>

/// What the paths of a technology's display mean, as tables.
namespace spectrel {

/// What a leaf says of a cell.
enum class Meaning : std::uint8_t {
    Area,
    Cell,
    Id,
    Channel,
    UplinkChannel,
    BandIndicator, // the number of the band
    BandwidthMHz,
    Level, // which one, the row names
    CountryCode, // digits or a plain number
    NetworkCode,
    PLMN, // "001-01"
    OperatorName,
    SetName, // of a list's entry: which cell set it belongs to
    BSICIsValid, // of a list's entry: "0" when its colour codes were not read
    NetworkColour, // of a list's entry: NCC and BCC apart
    StationColour,
    GSMBandIndicator, // 0: the numbers 512 to 810 are those of DCS 1800, 1: of PCS 1900
};

/// Which measurements a value belongs to; those of one mode say nothing once the other one's have come.
enum class Mode : std::uint8_t { Any, Idle, Connected };

/// One leaf that speaks of a serving cell.
struct LeafRow {
    std::string_view container; // path of the container, names as shown
    std::string_view key;
    Meaning meaning;
    std::optional<RadioTechnology> technology; // whose serving cell; none: of whichever serves
    Reading reading = Reading::Number;
    Level level = Level::RSRP; // where the meaning is a level
    Mode mode = Mode::Any;
    std::uint8_t rank = 0; // of several values in one record the lowest rank counts: measured 0, average 1
    bool isOnlyIdle = false; // while connected the leaf holds something else
};

/// One field of a list's entries.
struct EntryField {
    std::string_view key; // in the entry; empty where the entry itself is the leaf
    Meaning meaning;
    Reading reading = Reading::Number;
    Level level = Level::RSRP;
    std::uint8_t rank = 0;
};

/// Whose cells a list has.
enum class ListRole : std::uint8_t {
    Active,
    Neighbours,
    BySetName, // "ASET" is active, everything else a neighbour
};

/// How entries stand in a list's container.
enum class ListShape : std::uint8_t {
    Dictionaries, // a list of dictionaries
    Pilots, // a dictionary from PN offset to strength
};

/// What a list says of the serving cell.
enum class ServingHint : std::uint8_t {
    None,
    Levels, // the entry that is the serving cell has its levels
    OnlyEntry, // and a single entry is the serving cell
    NamedActive, // and the entry whose set is active is the serving cell, where it is the only one
    ReferencePilot, // and the entry marked as reference pilot is the serving cell
};

/// One list of cells.
struct ListRow {
    std::string_view container;
    ListRole role;
    RadioTechnology technology;
    std::span<const EntryField> fields;
    ListShape shape = ListShape::Dictionaries;
    ServingHint serving = ServingHint::None;
    Mode mode = Mode::Any;
    /// Where the channel of all entries stands, when not in themselves; `SameChannel`: on the serving cell's.
    std::string_view channelContainer {};
    std::string_view channelKey {};
    /// A list that is right only while the one of this path was left empty by the record that filled it.
    std::string_view onlyWithout {};
};
inline constexpr std::string_view SameChannel = "(serving)";

/// A leaf that says whether the phone has a connection.
struct ConnectionRow {
    struct Text {
        std::string_view text;
        Connection connection;
    };
    std::string_view container;
    std::string_view key;
    std::optional<RadioTechnology> technology; // counts while a cell of this technology serves; none: always
    std::span<const Text> texts; // any other text leaves it unknown
};

/// A leaf that is part of what is shown of the registration.
struct RegistrationRow {
    std::string_view container;
    std::string_view key;
    std::string_view unremarkable {}; // a text that is left out
};

/// A leaf whose text says that there is no serving cell.
struct NoServiceRow {
    std::string_view container;
    std::string_view key;
    std::string_view text;
    RadioTechnology technology; // EV-DO apart from the others
};

/// Where the contexts stand.
struct ContextRow {
    std::string_view container; // the list
    std::string_view name; // keys in an entry
    std::string_view state;
    std::string_view received;
    std::string_view sent;
    std::string_view stateContainer {}; // where one state holds for all
};

/// Everything of one technology.
struct CellTable {
    std::string_view generator; // the class name of the generator whose display this is
    std::span<const LeafRow> leaves;
    std::span<const ListRow> lists {};
    std::span<const ConnectionRow> connections {};
    std::span<const RegistrationRow> registration {};
    std::span<const NoServiceRow> noService {};
    ContextRow contexts {};
    ChannelNumbering umtsNumbering = ChannelNumbering::UTRAFDD;
};

const CellTable& lteCells();
const CellTable& utranCells();
const CellTable& gsmumtsCells();
const CellTable& cdmaCells();
const CellTable& ifxCells();

/// The table of the display that the generator of this class makes; null for none.
const CellTable* cellTableOf(std::string_view generator);

} // namespace spectrel
