#pragma once

#include "Telephony/Simulator/TechnologyPart.h"

#include <array>
#include <chrono>
#include <memory>
#include <optional>
#include <vector>

namespace spectrel {

/// One phone on one road that moves between LTE, UTRAN and GSM; its `technology` changes with it.
///
/// The technologies have priorities in this order (3GPP TS 36.304, 5.2.4.5; 25.304, 5.2.6.1.4a; 45.008, 6.6.6). Idle,
/// the phone moves up when a cell there is strong for a while, down when its serving cell has become weak and one below
/// is good enough. With a channel of its own it is redirected when the serving cell gets lost.
class JourneyBaseband final : public Baseband {
public:
    /// `first`: where it begins; LTE, UTRAN or GSM.
    JourneyBaseband(Technology first, std::uint32_t seed);

    Technology technology() const override
    {
        return active().technology();
    }
    void greet(Moment now, const Emit& emit) const override
    {
        active().greet(now, emit);
    }
    void advance(Moment now, const Emit& emit) override;
    std::span<const Move> moves() const override
    {
        return _moves;
    }

private:
    struct Choice {
        std::size_t part;
        MoveCause cause;
        std::chrono::milliseconds time; // for so long it has to hold
        friend bool operator==(const Choice&, const Choice&) = default;
    };

    TechnologyPart& active() const
    {
        return *_parts[_active];
    }
    std::optional<Choice> choice() const;
    std::optional<Choice> choiceDown() const;
    void moveTo(const Choice& choice);

    std::array<std::unique_ptr<TechnologyPart>, 3> _parts; // highest priority first
    std::size_t _active = 0;
    std::optional<Choice> _choice;
    std::chrono::milliseconds _choiceFor {0};
    std::vector<Move> _moves;
};

} // namespace spectrel
