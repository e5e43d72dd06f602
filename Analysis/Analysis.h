#pragma once

#include "Analysis/CellReport.h"
#include "Monitor/DisplayState.h"

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

namespace spectrel {

class Analysis;
class OperatorNames;

/// What a message has stored, also with an equal value, or removed.
struct AnalysedChanges {
    bool serving = false; // an identity or level of the serving cell, or which cell it is
    bool surroundings = false; // of active cells or neighbours
    bool connection = false;
    bool registration = false;
    bool contexts = false;

    bool any() const
    {
        return serving || surroundings || connection || registration || contexts;
    }
};

/// Hears what the display means.
class AnalysisListener {
public:
    virtual ~AnalysisListener() = default;
    /// After every message, in the order of the messages; the journal's changes are still there. `analysis.serving()`
    /// costs nothing, `analysis.report()` is put together when it is asked for.
    virtual void messageAnalysed(const AppliedMessage& message, const Journal& journal, const Analysis& analysis,
        const AnalysedChanges& changes) = 0;
    /// At a refresh tick, and once more after the last message of recordings.
    virtual void refreshed(const CellReport& report, const Analysis& analysis) = 0;
};

/// What the display of any technology means: the serving cell, active cells, neighbours, the connection, registration
/// and contexts.
///
/// Reads the display and the journal of its changes and nothing below, and so is the same live, on recordings and on
/// snapshots. What the paths mean stands in one table a technology (`Analysis/Cells/`). A message costs what the
/// journal noted of it; nothing is read again that did not change.
class Analysis final : public JournalReader {
public:
    /// Listens to the display's journal from now on. Both are there for as long as this is; the names may be null.
    explicit Analysis(DisplayState& display, OperatorNames* operators = nullptr);
    ~Analysis() override;
    Analysis(const Analysis&) = delete;
    Analysis& operator=(const Analysis&) = delete;

    /// The listener outlives this, or is removed.
    void addListener(AnalysisListener& listener);
    void removeListener(AnalysisListener& listener);

    void messageApplied(const AppliedMessage& message, const Journal& journal) override;
    /// A refresh tick: the listeners hear of the report as it stands.
    void refresh(Moment time);

    /// The serving cell as of the last message; null while none is known. Stays where it is until the next message.
    const Cell* serving() const;
    /// Whether the display says that no cell serves.
    bool isOutOfService() const;
    /// Everything, as of the last message, with its time.
    const CellReport& report() const;
    /// A path in the display tree; empty for no origin.
    const std::string& pathOf(const Origin& origin) const;

private:
    class State;
    std::unique_ptr<State> _state;
    std::vector<AnalysisListener*> _listeners;
};

} // namespace spectrel
