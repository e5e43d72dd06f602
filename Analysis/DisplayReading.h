#pragma once

#include "Analysis/Analysis.h"
#include "Analysis/CellLists.h"
#include "Analysis/ContextRates.h"
#include "Analysis/DisplayPlaces.h"
#include "Analysis/NetworkCode.h"
#include "Analysis/PathTable.h"
#include "Analysis/ServingTrack.h"

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace spectrel {

/// Follows one technology's display, message by message, as its table says.
class DisplayReading {
public:
    /// All three outlive this; the names may be null.
    DisplayReading(const CellTable& table, PathTable& paths, OperatorNames* operators);

    /// Reads what the message has changed.
    AnalysedChanges apply(const AppliedMessage& message, const Journal& journal, const Value& display);
    /// Whether this is the table it reads by.
    const CellTable& table() const
    {
        return _table;
    }

    /// The serving cell; null while none is known.
    const Cell* serving() const
    {
        return _main.isKnown() && !_isOutOfService ? &_main.cell() : nullptr;
    }
    bool isOutOfService() const
    {
        return _isOutOfService;
    }
    /// EV-DO's sector; null while none is known.
    const Cell* dataSector() const
    {
        return _data.isKnown() && !_isDataOutOfService ? &_data.cell() : nullptr;
    }
    std::vector<CellList>& lists()
    {
        return _lists;
    }
    /// Whether the list was filled while the cell and the mode were those of now.
    bool isCurrent(const CellList& list) const;
    /// The cells of a list, as last stored.
    const std::vector<ListedCell>& cellsOf(CellList& list, const Value& display);
    void fillIn(CellReport& report) const;

private:
    struct Leaf {
        const LeafRow* row = nullptr; // what it says of a cell, if anything
        bool isConnection = false;
        bool isRegistration = false;
        bool isNoService = false;
        std::string text; // empty when it says nothing
        std::optional<double> number; // by the row's reading
        Origin origin;
        std::uint64_t touched = 0; // the number of the message after, so that 0 is none
    };
    /// A message's values for one serving cell.
    struct Told {
        const Leaf* leaf;
        ReadValue value;
    };

    Leaf& watch(std::string_view container, std::string_view key);
    const Leaf& leafAt(std::string_view container, std::string_view key);
    void noteChanges(const Journal& journal);
    void noteLeaf(int number, const Journal::Change& change, const Journal& journal);
    void noteList(int number);
    void applyMode(Mode mode, const Origin& origin);
    void applyStates();
    void updateConnection();
    void updateRegistration();
    void updateService();
    void applyLeaves();
    std::optional<RadioTechnology> mainTechnology() const;
    void collect(const Leaf& leaf, std::optional<RadioTechnology> technology, std::vector<Told>& told) const;
    void applyTold(ServingTrack& track, RadioTechnology technology, const std::vector<Told>& told);
    void applyShared(bool isMainTold);
    void applyNetwork(const Leaf& leaf);
    void applyLists(const Value& display);
    void forgetLevelsOf(const CellList& list);
    void applyHint(CellList& list, const Value& display);
    void applyLevels(ServingTrack& track, const Value& display);
    ServingTrack& trackOf(RadioTechnology technology)
    {
        return technology == RadioTechnology::EVDO ? _data : _main;
    }

    const CellTable& _table;
    PathTable& _paths;
    OperatorNames* _operators;
    DisplayPlaces _places;
    std::vector<Leaf> _leaves;
    std::vector<CellList> _lists; // in the table's order, which is that of the watched lists
    int _contextList;
    ServingTrack _main;
    ServingTrack _data; // EV-DO
    ContextRates _contexts;
    NetworkCode _network;
    std::string _operatorOf; // the network whose operator's name is the next
    std::string _operatorName;

    Mode _mode = Mode::Any;
    std::uint64_t _modeSince = 0; // message
    std::optional<Connection> _connection;
    Origin _connectionOrigin;
    std::string _registration;
    Origin _registrationOrigin;
    bool _isOutOfService = false;
    bool _isDataOutOfService = false;

    // Of the message being read:
    ServingTrack::Step _step;
    AnalysedChanges _changes;
    std::vector<Leaf*> _touchedLeaves;
    std::vector<CellList*> _touchedLists;
    bool _areContextsTouched = false;
    std::vector<Told> _toldMain;
    std::vector<Told> _toldData;
    std::vector<const Leaf*> _early; // network and area told ahead of the cell that they are of
    ServingTrack::Step _earlySince;
};

} // namespace spectrel
