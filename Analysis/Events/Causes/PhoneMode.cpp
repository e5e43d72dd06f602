#include "Analysis/Events/Causes/PhoneMode.h"

#include "Values/Table.h"

#include <array>
#include <limits>
#include <utility>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

/// Whether the network decides where the phone goes.
enum class Mode : std::uint8_t {
    Unknown,
    Own, // the phone does: idle, or connected without a channel of its own
    Network, // it has a channel of its own
};

struct ShownMode {
    Mode mode = Mode::Unknown;
    std::vector<Evidence> evidence;
};

/// A change between the systems takes no longer; the state that announced it stands until it is done.
constexpr auto LongestChange = 10s;

constexpr std::string_view GSMDedicated = "RR_DATA_TRANSFER";

struct ChangeState {
    std::string_view state;
    CauseKind kind;
};
/// RR states between GSM and UMTS, the blanks inside them as they are shown.
constexpr std::array<ChangeState, 3> ToGSM {{
    {"RR_W2G_INTERRAT_HANDOVER_ PROGRESS", CauseKind::Handover},
    {"RR_W2G_INTERRAT_RESELECTION_PROGRESS", CauseKind::Reselection},
    {"RR_W2G_INTERRAT_CC_ORDER_ PROGRESS", CauseKind::Redirection},
}};
constexpr std::array<ChangeState, 2> ToUMTS {{
    {"RR_G2W_INTERRAT_RESELECTION_PROGRESS", CauseKind::Reselection},
    {"RR_G2W_INTERRAT_HANDOVER_ PROGRESS", CauseKind::Handover},
}};

const EvidenceSample* later(const EvidenceSample* one, const EvidenceSample* other)
{
    if (!one || !other)
        return one ? one : other;
    return one->n >= other->n ? one : other;
}

ShownMode modeWhere(const EvidenceSample* state, std::string_view key, bool isNetworks)
{
    if (!state)
        return {};
    return {isNetworks ? Mode::Network : Mode::Own, {state->evidence(key)}};
}

/// The record of idle or of connected mode, whichever came last; what the move's own message says of the new cell does
/// not count.
ShownMode lteMode(const EvidenceLog& log, std::uint64_t before)
{
    const auto* const idle = log.latestBefore(EvidenceSection::LTEServing, before);
    const auto* const connected = log.latestBefore(EvidenceSection::LTEConnected, before);
    const auto* const latest = later(idle, connected);
    return latest == idle ? modeWhere(idle, "Physical Cell ID", false)
                          : modeWhere(connected, "Serving Physical Cell ID", true);
}

/// Where the state is reported each time it changes, the one up to the move's message counts.
const EvidenceSample* promptState(
    const EvidenceLog& log, EvidenceSection section, std::string_view key, const CellMove& move)
{
    return log.latestWith(section, key, move.n);
}

/// Where it is only reported every now and then, the one shown before the move does: the move came between the two.
const EvidenceSample* regularState(const EvidenceLog& log, EvidenceSection section, const CellMove& move)
{
    const auto* const before = log.latestOlder(section, "State", move.time);
    return before ? before : log.latestWith(section, "State", move.n);
}

ShownMode umtsMode(const EvidenceLog& log, const CellMove& move)
{
    const auto* const umts = promptState(log, EvidenceSection::UMTSState, "RRC State", move);
    const auto* const utran = regularState(log, EvidenceSection::UTRANState, move);
    if (later(umts, utran) == umts)
        return modeWhere(umts, "RRC State", umts && umts->text("RRC State") == "CELL_DCH");
    return modeWhere(utran, "State", utran->text("State") == "Cell DCH");
}

/// A packet transfer is no channel of its own: the phone reselects during it.
ShownMode gsmMode(const EvidenceLog& log, const CellMove& move)
{
    const auto* const rr = promptState(log, EvidenceSection::GSMState, "RR State", move);
    const auto* const call = regularState(log, EvidenceSection::CallState, move);
    if (call && later(rr, call) == call)
        return modeWhere(call, "State", call->text("State") == "Active");
    return modeWhere(rr, "RR State", rr && rr->text("RR State") == GSMDedicated && rr->text("RR Mode") != "Data");
}

ShownMode modeOn(RadioTechnology technology, const EvidenceLog& log, const CellMove& move)
{
    switch (technology) {
    case RadioTechnology::LTE:
        return lteMode(log, move.n);
    case RadioTechnology::UMTS:
        return umtsMode(log, move);
    case RadioTechnology::GSM:
        return gsmMode(log, move);
    case RadioTechnology::CDMA: {
        const auto* const state = regularState(log, EvidenceSection::OneXState, move);
        return modeWhere(state, "State", state && state->text("State").starts_with("Traffic"));
    }
    case RadioTechnology::EVDO: {
        const auto* const state = regularState(log, EvidenceSection::EVDOState, move);
        return modeWhere(state, "State", state && state->text("State").starts_with("Connected"));
    }
    }
    return {};
}

/// The state of a change between GSM and UMTS of one baseband.
template <std::size_t Count>
MoveManner announced(const EvidenceLog& log, const CellMove& move, const std::array<ChangeState, Count>& states)
{
    const auto& samples = log.samples(EvidenceSection::GSMState);
    for (auto sample = samples.rbegin(); sample != samples.rend(); ++sample) {
        if (sample->n > move.n || sample->time < move.time - LongestChange)
            continue;
        if (const auto* state = findRow(states, std::string_view(sample->text("RR State")), &ChangeState::state))
            return {state->kind, {sample->evidence("RR State")}};
    }
    return {};
}

/// Within one system: whoever decides in the phone's mode.
MoveManner withinSystem(const EvidenceLog& log, const CellMove& move)
{
    const RadioTechnology technology = move.from->technology;
    ShownMode shown = modeOn(technology, log, move);
    switch (shown.mode) {
    case Mode::Own:
        return {CauseKind::Reselection, std::move(shown.evidence)};
    case Mode::Network:
        return {CauseKind::Handover, std::move(shown.evidence)};
    case Mode::Unknown:
        break;
    }
    return {};
}

/// Between systems whose basebands report apart: a connection that goes on was handed over, one that has to begin anew
/// was redirected.
MoveManner betweenSystems(const EvidenceLog& log, const CellMove& move)
{
    ShownMode before = modeOn(move.from->technology, log, move);
    if (before.mode == Mode::Own)
        return {CauseKind::Reselection, std::move(before.evidence)};
    CellMove settled = move;
    settled.n = std::numeric_limits<std::uint64_t>::max();
    settled.time = move.time + MoveTracker::SettlingTime;
    const ShownMode after = modeOn(move.to.technology, log, settled);
    if (before.mode == Mode::Unknown || after.mode == Mode::Unknown || after.evidence.front().time < move.time)
        return {};
    before.evidence.push_back(after.evidence.front());
    return {after.mode == Mode::Network ? CauseKind::Handover : CauseKind::Redirection, std::move(before.evidence)};
}

} // namespace

MoveManner mannerOf(const EvidenceLog& log, const CellMove& move)
{
    const RadioTechnology from = move.from->technology;
    const RadioTechnology to = move.to.technology;
    if (from == to)
        return withinSystem(log, move);
    if (from == RadioTechnology::UMTS && to == RadioTechnology::GSM) {
        if (MoveManner manner = announced(log, move, ToGSM); manner.kind != CauseKind::Unknown)
            return manner;
    }
    if (from == RadioTechnology::GSM && to == RadioTechnology::UMTS) {
        if (MoveManner manner = announced(log, move, ToUMTS); manner.kind != CauseKind::Unknown)
            return manner;
    }
    return betweenSystems(log, move);
}

} // namespace spectrel
