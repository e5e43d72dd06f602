#include "Analysis/DisplayReading.h"

#include "Analysis/OperatorNames.h"

#include <algorithm>
#include <chrono>
#include <utility>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

/// Network and area that differ from those of the serving cell belong to the next one when it comes within this time.
constexpr auto EarlyTime = 2s;

bool isIdentity(Meaning meaning)
{
    return meaning == Meaning::Id || meaning == Meaning::Cell || meaning == Meaning::Channel;
}

bool isOfNetwork(Meaning meaning)
{
    return meaning == Meaning::CountryCode || meaning == Meaning::NetworkCode || meaning == Meaning::PLMN
        || meaning == Meaning::OperatorName;
}

/// The one cell of the list that the hint says is the serving one; null when there is no such, or several.
const Cell* servingOf(const std::vector<ListedCell>& cells, ServingHint hint)
{
    const Cell* serving = nullptr;
    for (const ListedCell& listed : cells) {
        const bool isMeant = hint == ServingHint::OnlyEntry || (hint == ServingHint::NamedActive && listed.isActive)
            || (hint == ServingHint::ReferencePilot && listed.isReference);
        if (!isMeant)
            continue;
        if (serving)
            return nullptr;
        serving = &listed.cell;
    }
    return serving;
}

} // namespace

DisplayReading::DisplayReading(const CellTable& table, PathTable& paths, OperatorNames* operators)
    : _table(table)
    , _paths(paths)
    , _operators(operators)
    , _contextList(DisplayPlaces::None)
    , _main(table.umtsNumbering)
    , _data(table.umtsNumbering)
    , _contexts(table.contexts)
{
    for (const LeafRow& row : table.leaves)
        watch(row.container, row.key).row = &row;
    for (const ConnectionRow& row : table.connections)
        watch(row.container, row.key).isConnection = true;
    for (const RegistrationRow& row : table.registration)
        watch(row.container, row.key).isRegistration = true;
    for (const NoServiceRow& row : table.noService)
        watch(row.container, row.key).isNoService = true;
    for (const ListRow& row : table.lists) {
        _places.watchList(row.container);
        _lists.emplace_back(row, table.umtsNumbering);
        if (!row.channelKey.empty())
            watch(row.channelContainer, row.channelKey);
    }
    if (!table.contexts.container.empty())
        _contextList = _places.watchList(table.contexts.container);
}

DisplayReading::Leaf& DisplayReading::watch(std::string_view container, std::string_view key)
{
    const auto number = static_cast<std::size_t>(_places.watchLeaf(container, key));
    if (number == _leaves.size())
        _leaves.emplace_back().origin.path = _paths.numberOf(_places.leafPath(static_cast<int>(number)));
    return _leaves[number];
}

const DisplayReading::Leaf& DisplayReading::leafAt(std::string_view container, std::string_view key)
{
    return watch(container, key);
}

AnalysedChanges DisplayReading::apply(const AppliedMessage& message, const Journal& journal, const Value& display)
{
    _step = {message.number, message.time};
    _changes = {};
    _touchedLeaves.clear();
    _touchedLists.clear();
    _areContextsTouched = false;
    noteChanges(journal);
    if (!_touchedLeaves.empty() || !_touchedLists.empty()) {
        applyStates();
        applyLeaves();
        applyLists(display);
        _main.finish();
        _data.finish();
    }
    if (_areContextsTouched) {
        _contexts.update(display, _step.message, _step.time, _paths);
        _changes.contexts = true;
    }
    return _changes;
}

void DisplayReading::noteChanges(const Journal& journal)
{
    for (const Journal::Change& change : journal.changes()) {
        const auto [leaf, list] = _places.find(change, journal.keyOf(change));
        if (leaf != DisplayPlaces::None)
            noteLeaf(leaf, change, journal);
        else if (list != DisplayPlaces::None)
            noteList(list);
    }
}

void DisplayReading::noteLeaf(int number, const Journal::Change& change, const Journal& journal)
{
    Leaf& leaf = _leaves[static_cast<std::size_t>(number)];
    if (std::exchange(leaf.touched, _step.message + 1) != _step.message + 1)
        _touchedLeaves.push_back(&leaf);
    const bool isNew = !leaf.origin.message && leaf.origin.time == Moment();
    leaf.origin.message = _step.message;
    leaf.origin.time = _step.time;
    if (change.kind == Journal::Kind::StoredAgain && !isNew)
        return;
    leaf.text.clear();
    leaf.number = std::nullopt;
    const std::string_view text = journal.valueOf(change);
    if (change.kind == Journal::Kind::Removed || saysNothing(text))
        return;
    leaf.text = text;
    if (leaf.row)
        leaf.number = readNumber(leaf.row->reading, text);
}

void DisplayReading::noteList(int number)
{
    if (number == _contextList) {
        _areContextsTouched = true;
        return;
    }
    CellList& list = _lists[static_cast<std::size_t>(number)];
    if (!_touchedLists.empty() && _touchedLists.back() == &list)
        return;
    list.touch(_step.message, _step.time);
    if (std::ranges::find(_touchedLists, &list) == _touchedLists.end())
        _touchedLists.push_back(&list);
}

/// Levels of one mode go when measurements of the other come.
void DisplayReading::applyMode(Mode mode, const Origin& origin)
{
    if (mode == Mode::Any)
        return;
    _connection = mode == Mode::Idle ? Connection::Idle : Connection::Connected;
    _connectionOrigin = origin;
    _changes.connection = true;
    if (std::exchange(_mode, mode) == mode)
        return;
    _modeSince = _step.message;
    _main.forgetLevels();
}

void DisplayReading::applyStates()
{
    for (const Leaf* leaf : _touchedLeaves) {
        _changes.connection |= leaf->isConnection;
        _changes.registration |= leaf->isRegistration;
        if (leaf->row && !leaf->text.empty())
            applyMode(leaf->row->mode, leaf->origin);
    }
    for (const CellList* list : _touchedLists) {
        if (list->row().mode != Mode::Any)
            applyMode(list->row().mode, {_paths.numberOf(list->row().container), _step.message, _step.time});
    }
    updateService();
    if (_changes.registration)
        updateRegistration();
}

void DisplayReading::updateConnection()
{
    if (_table.connections.empty())
        return;
    const auto before = std::exchange(_connection, std::nullopt);
    for (const ConnectionRow& row : _table.connections) {
        if (row.technology && *row.technology != _main.cell().technology)
            continue;
        const Leaf& leaf = leafAt(row.container, row.key);
        const auto known = std::ranges::find(row.texts, leaf.text, &ConnectionRow::Text::text);
        if (known == row.texts.end() || _connection == Connection::Connected)
            continue;
        if (_connection && known->connection == Connection::Idle)
            continue;
        _connection = known->connection;
        _connectionOrigin = leaf.origin;
    }
    _changes.connection |= _connection != before;
    if (_connection == Connection::Connected && before != _connection) {
        for (const LeafRow& row : _table.leaves) {
            if (row.isOnlyIdle)
                _main.forgetLevel(row.level);
        }
    }
}

void DisplayReading::updateRegistration()
{
    _registration.clear();
    for (const RegistrationRow& row : _table.registration) {
        const Leaf& leaf = leafAt(row.container, row.key);
        if (leaf.text.empty() || leaf.text == row.unremarkable)
            continue;
        if (_registration.empty())
            _registrationOrigin = leaf.origin;
        else
            _registration += ", ";
        _registration += leaf.text;
    }
}

void DisplayReading::updateService()
{
    const bool isTouched = std::ranges::any_of(_touchedLeaves, [](const Leaf* leaf) { return leaf->isNoService; });
    if (!isTouched)
        return;
    bool isOut = false;
    bool isDataOut = false;
    for (const NoServiceRow& row : _table.noService) {
        if (leafAt(row.container, row.key).text == row.text)
            (row.technology == RadioTechnology::EVDO ? isDataOut : isOut) = true;
    }
    const bool wasOut = std::exchange(_isOutOfService, isOut);
    const bool wasDataOut = std::exchange(_isDataOutOfService, isDataOut);
    if (isOut && !wasOut)
        _main.begin(_main.cell().technology, _step);
    if (isDataOut && !wasDataOut)
        _data.begin(RadioTechnology::EVDO, _step);
    _changes.serving |= isOut != wasOut;
    _changes.surroundings |= isDataOut != wasDataOut;
}

void DisplayReading::applyLeaves()
{
    _toldMain.clear();
    _toldData.clear();
    const auto technology = mainTechnology();
    for (const Leaf* leaf : _touchedLeaves) {
        if (!leaf->row)
            continue;
        if (leaf->text.empty()) {
            trackOf(leaf->row->technology.value_or(RadioTechnology::LTE)).forgetFrom(leaf->origin.path);
            continue;
        }
        collect(*leaf, technology, _toldMain);
        collect(*leaf, RadioTechnology::EVDO, _toldData);
    }
    if (technology) {
        _main.useTechnology(*technology, _step);
        updateConnection();
        applyTold(_main, *technology, _toldMain);
    } else if (_changes.connection) {
        updateConnection();
    }
    if (!_toldData.empty()) {
        _data.useTechnology(RadioTechnology::EVDO, _step);
        applyTold(_data, RadioTechnology::EVDO, _toldData);
    }
    applyShared(technology.has_value());
}

/// Whose serving cell the message speaks of; where it speaks of two, of the one that serves already.
std::optional<RadioTechnology> DisplayReading::mainTechnology() const
{
    std::optional<RadioTechnology> told;
    for (const Leaf* leaf : _touchedLeaves) {
        if (!leaf->row || !leaf->number || !leaf->row->technology || *leaf->row->technology == RadioTechnology::EVDO)
            continue;
        if (_main.isKnown() && *leaf->row->technology == _main.cell().technology)
            return _main.cell().technology;
        if (!told)
            told = leaf->row->technology;
    }
    return told;
}

void DisplayReading::collect(const Leaf& leaf, std::optional<RadioTechnology> technology, std::vector<Told>& told) const
{
    if (!technology || leaf.row->technology != technology || !leaf.number)
        return;
    told.push_back({&leaf, {leaf.row->meaning, leaf.row->level, *leaf.number, leaf.origin}});
}

void DisplayReading::applyTold(ServingTrack& track, RadioTechnology technology, const std::vector<Told>& told)
{
    if (std::ranges::any_of(told, [&](const Told& one) { return track.contradicts(one.value); }))
        track.begin(technology, _step);
    bool isStored = false;
    for (const auto& [leaf, value] : told) {
        if (leaf->row->isOnlyIdle && _connection == Connection::Connected)
            continue;
        isStored |= track.store(value, leaf->row->rank);
    }
    (technology == RadioTechnology::EVDO ? _changes.surroundings : _changes.serving) |= isStored;
}

/// Network and area of whichever cell serves. A record that holds them alone, and others than those known, may be of
/// the next cell.
void DisplayReading::applyShared(bool isMainTold)
{
    const bool isNamed = std::ranges::any_of(_toldMain, [](const Told& one) { return isIdentity(one.value.meaning); });
    const auto isShared = [](const Leaf* leaf) {
        return leaf->row && !leaf->text.empty() && (!leaf->row->technology || isOfNetwork(leaf->row->meaning));
    };
    if (isNamed && !_early.empty()) {
        if (_main.cell().sinceMessage == _step.message && _step.time - _earlySince.time <= EarlyTime)
            _main.beginAt(_earlySince);
        for (const Leaf* leaf : std::exchange(_early, {}))
            applyNetwork(*leaf);
    }
    for (const Leaf* leaf : _touchedLeaves) {
        if (!isShared(leaf))
            continue;
        const bool isOther = leaf->row->meaning == Meaning::Area && leaf->number && _main.cell().area
            && identityOf(RadioTechnology::GSM, Meaning::Area, *leaf->number) != _main.cell().area;
        if (!isMainTold && _main.isKnown() && (isOther || (!_early.empty() && _earlySince.message == _step.message))) {
            if (_early.empty())
                _earlySince = _step;
            _early.push_back(leaf);
        } else {
            applyNetwork(*leaf);
        }
    }
}

void DisplayReading::applyNetwork(const Leaf& leaf)
{
    const LeafRow& row = *leaf.row;
    std::string network;
    switch (row.meaning) {
    case Meaning::Area:
        if (leaf.number)
            _changes.serving |= _main.store({row.meaning, row.level, *leaf.number, leaf.origin}, row.rank);
        return;
    case Meaning::OperatorName:
        _main.storeOperator(leaf.text, leaf.origin);
        return;
    case Meaning::PLMN:
        network = isNetworkCode(leaf.text) ? leaf.text : std::string();
        break;
    default: {
        // The country comes with the network code, except from records that lack one of them.
        const auto textOf = [&](Meaning meaning) -> std::string_view {
            const auto found = std::ranges::find(_table.leaves, meaning, &LeafRow::meaning);
            return found == _table.leaves.end() ? std::string_view()
                                                : std::string_view(leafAt(found->container, found->key).text);
        };
        if (row.meaning == Meaning::CountryCode)
            return; // read with the network code
        network = _network.read(textOf(Meaning::CountryCode), textOf(Meaning::NetworkCode));
    }
    }
    if (network.empty())
        return _main.forgetNetwork();
    _main.storeNetwork(network, leaf.origin);
    if (_operators && std::exchange(_operatorOf, network) != network)
        _operatorName = _operators->nameOf(network);
    if (_main.cell().operatorName.empty() && !_operatorName.empty())
        _main.storeOperator(_operatorName, leaf.origin);
    _changes.serving = true;
}

void DisplayReading::applyLists(const Value& display)
{
    const bool isIdentityNew = _main.cell().sinceMessage == _step.message
        || std::ranges::any_of(_toldMain, [](const Told& one) { return isIdentity(one.value.meaning); });
    bool isHinted = false;
    for (CellList* list : _touchedLists) {
        _changes.surroundings = true;
        if (list->row().serving != ServingHint::None)
            forgetLevelsOf(*list);
        const ListRow& row = list->row();
        if (!row.onlyWithout.empty()) {
            const Value* const other = valueAt(display, row.onlyWithout);
            list->setUnusable(other && other->list() && other->list()->count() > 0);
        }
        isHinted |= row.serving != ServingHint::None;
        if (row.serving != ServingHint::None && row.serving != ServingHint::Levels)
            applyHint(*list, display);
    }
    if (isHinted || isIdentityNew)
        applyLevels(_main, display);
    if (isHinted || !_toldData.empty())
        applyLevels(_data, display);
}

/// The list no longer holds what the serving cell's levels were taken from.
void DisplayReading::forgetLevelsOf(const CellList& list)
{
    ServingTrack& track = trackOf(list.row().technology);
    for (std::size_t level = 0; level < LevelCount; ++level) {
        const Origin& origin = track.cell().origin(cellKeyOf(static_cast<Level>(level)));
        const std::string& path = _paths.pathOf(origin.path);
        if (path.size() > list.row().container.size() && path.starts_with(list.row().container)
            && path[list.row().container.size()] == '/')
            track.forgetLevel(static_cast<Level>(level));
    }
}

void DisplayReading::applyHint(CellList& list, const Value& display)
{
    const Cell* const serving = servingOf(cellsOf(list, display), list.row().serving);
    if (!serving)
        return;
    ServingTrack& track = trackOf(list.row().technology);
    track.useTechnology(list.row().technology, _step);
    std::array<ReadValue, 2> values {{
        {Meaning::Id, {}, static_cast<double>(*serving->id), serving->origin(CellKey::Id)},
        {Meaning::Channel, {}, serving->channel ? static_cast<double>(*serving->channel) : -1,
            serving->origin(CellKey::Channel)},
    }};
    if (std::ranges::any_of(values, [&](const ReadValue& value) { return track.contradicts(value); }))
        track.begin(list.row().technology, _step);
    for (const ReadValue& value : values)
        track.store(value, 0);
    (&track == &_data ? _changes.surroundings : _changes.serving) = true;
    updateConnection();
}

/// The serving cell's levels where they stand in lists that were stored since it serves.
void DisplayReading::applyLevels(ServingTrack& track, const Value& display)
{
    if (!track.cell().id)
        return;
    for (CellList& list : _lists) {
        const ListRow& row = list.row();
        if (row.serving == ServingHint::None || row.technology != track.cell().technology || !list.isStored()
            || list.message() < track.cell().sinceMessage)
            continue;
        for (const ListedCell& listed : cellsOf(list, display)) {
            if (!isSameCell(listed.cell, track.cell()))
                continue;
            for (std::size_t level = 0; level < LevelCount; ++level) {
                const auto which = static_cast<Level>(level);
                if (const auto& value = listed.cell.level(which)) {
                    const bool isStored =
                        track.store({Meaning::Level, which, *value, listed.cell.origin(cellKeyOf(which))}, 0);
                    (&track == &_data ? _changes.surroundings : _changes.serving) |= isStored;
                }
            }
            break;
        }
    }
}

bool DisplayReading::isCurrent(const CellList& list) const
{
    const ListRow& row = list.row();
    if (!list.isStored())
        return false;
    if (row.mode != Mode::Any && (row.mode != _mode || list.message() < _modeSince))
        return false;
    const Cell* const cell = row.technology == RadioTechnology::EVDO ? dataSector() : serving();
    return !cell || list.message() >= cell->sinceMessage;
}

const std::vector<ListedCell>& DisplayReading::cellsOf(CellList& list, const Value& display)
{
    const ListRow& row = list.row();
    if (row.channelKey.empty())
        return list.cells(display, _paths, nullptr);
    const Leaf& leaf = leafAt(row.channelContainer, row.channelKey);
    const auto number = leaf.number ? leaf.number : readNumber(Reading::Number, leaf.text);
    const ReadValue channel {Meaning::Channel, {}, number.value_or(-1), leaf.origin};
    return list.cells(display, _paths, &channel);
}

void DisplayReading::fillIn(CellReport& report) const
{
    report.connection = _connection;
    report.connectionOrigin = _connectionOrigin;
    report.registration = _registration;
    report.registrationOrigin = _registrationOrigin;
    report.contexts = _contexts.contexts();
}

} // namespace spectrel
