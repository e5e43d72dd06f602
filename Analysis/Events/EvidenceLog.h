#pragma once

#include "Analysis/Events/Event.h"
#include "Monitor/DisplayState.h"
#include "Monitor/Journal.h"

#include <array>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>

namespace spectrel {

/// The parts of the display, of any technology, that speak for the cause of a move beside the cells themselves.
enum class EvidenceSection : std::uint8_t {
    LTEServing,
    LTEConnected,
    LTECarrier, // which the neighbours listed next are on
    LTENeighbours,
    LTECandidates,
    GSMState,
    GSMServing,
    GSMNeighbours,
    GSMRanking,
    UMTSState,
    UMTSActive,
    UMTSRanking,
    UTRANState,
    UTRANNeighbours,
    OneXState,
    EVDOState,
    CallState,
};
inline constexpr std::size_t EvidenceSectionCount = 17;

/// What one message stored into one section, or into one entry of a section that is a list.
struct EvidenceSample {
    static constexpr std::size_t MaxKeys = 10;

    Moment time {};
    std::uint64_t n = 0;
    EvidenceSection section = EvidenceSection::LTEServing;
    int entry = -1; // its position in the list
    std::array<std::string, MaxKeys> texts; // by the section's keys; empty where nothing was stored

    /// As shown; empty where the message stored nothing under the key.
    const std::string& text(std::string_view key) const;
    /// The number that the text begins with; none for "-", "Not Present" and other words.
    std::optional<double> number(std::string_view key) const;
    Evidence evidence(std::string_view key) const;
};

/// Keeps what the messages of the last minute stored into the sections above.
///
/// Costs a look at each run of the journal's changes in one container, and the copies of the wanted texts.
class EvidenceLog {
public:
    using Samples = std::deque<EvidenceSample>;
    static constexpr std::chrono::seconds Span {60};
    static constexpr std::size_t MaxSamples = 1000; // in a section

    void read(const AppliedMessage& message, const Journal& journal);
    /// Oldest first; the latest is kept however old it is.
    const Samples& samples(EvidenceSection section) const
    {
        return _samples[static_cast<std::size_t>(section)];
    }
    /// The latest sample before the message; null where there is none.
    const EvidenceSample* latestBefore(EvidenceSection section, std::uint64_t n) const;
    /// The latest sample with a text under the key of messages that are older than the time.
    const EvidenceSample* latestOlder(EvidenceSection section, std::string_view key, Moment time) const;
    /// The latest text under the key, before or in the message.
    const EvidenceSample* latestWith(EvidenceSection section, std::string_view key, std::uint64_t upTo) const;

private:
    struct Known {
        Journal::PlaceRef place; // so that its address stays its own
        int section = -1; // none
        int entry = -1;
    };

    const Known& lookUp(const Journal::PlaceRef& place);
    static Known classify(const Journal::PlaceRef& place);
    void forgetLeftPlaces();
    EvidenceSample& sampleOf(const Known& known, const AppliedMessage& message);

    std::unordered_map<const Journal::Place*, Known> _known;
    std::size_t _tidyAt = 256;
    std::array<Samples, EvidenceSectionCount> _samples;
};

} // namespace spectrel
