#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string_view>
#include <vector>

namespace spectrel {

/// A cell by the names that displays give it.
struct CellName {
    std::string_view technology; // of the radio: "gsm", "umts", "lte", "cdma" or "evdo"
    std::uint32_t channel = 0; // of the downlink
    std::uint32_t id = 0; // PCI, scrambling code or cell parameter, BSIC (NCC * 8 + BCC), PN offset
    std::optional<std::uint32_t> cell; // its identity; an EV-DO sector is known by its pilot alone
    friend bool operator==(const CellName&, const CellName&) = default;
};

enum class MoveKind : std::uint8_t {
    Reselection, // the phone's own choice, in idle mode and on shared channels
    Handover, // in a connection
    Redirection, // a connection ends with the order to go there
    ServiceLost, // the old cell was lost, and after a time without service another one was found
};

/// Which of its rules made an idle phone reselect (3GPP TS 36.304, 5.2.4; 25.304, 5.2.6; 45.008, 6.6).
enum class ReselectionRule : std::uint8_t {
    None, // no reselection
    HigherPriority,
    EqualPriority, // among equals, by rank, C2 or pilot strength
    LowerPriority,
    NotSuitable, // the old cell had fallen below what cell selection asks for
};

struct MoveCause {
    MoveKind kind = MoveKind::Reselection;
    ReselectionRule rule = ReselectionRule::None;
    friend bool operator==(const MoveCause&, const MoveCause&) = default;
};

constexpr MoveCause byReselection(ReselectionRule rule)
{
    return {MoveKind::Reselection, rule};
}
constexpr MoveCause ByHandover {MoveKind::Handover, ReselectionRule::None};
constexpr MoveCause ByRedirection {MoveKind::Redirection, ReselectionRule::None};
constexpr MoveCause AfterServiceLost {MoveKind::ServiceLost, ReselectionRule::None};

/// From one serving cell to another.
struct Move {
    std::optional<CellName> from; // none: the first cell
    CellName to;
    std::optional<MoveCause> cause; // none: the first cell
};

/// What a simulated world has decided in its last step: it notes each move here at the moment of the decision.
class MoveLog {
public:
    /// A step begins.
    void begin()
    {
        _moves.clear();
    }
    void first(const CellName& cell)
    {
        _moves.push_back({std::nullopt, cell, std::nullopt});
    }
    void moved(const CellName& from, const CellName& to, MoveCause cause)
    {
        _moves.push_back({from, to, cause});
    }
    std::span<const Move> moves() const
    {
        return _moves;
    }

private:
    std::vector<Move> _moves;
};

} // namespace spectrel
