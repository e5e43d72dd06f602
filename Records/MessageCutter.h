#pragma once

#include "Records/RecordView.h"
#include "Values/Bytes.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace spectrel {

/// What the bytes to be cut are.
enum class MessageSequence : std::uint8_t {
    /// Messages as received, back to back.
    Whole,
    /// The same, but the first byte of some messages is missing: at the start of each former buffer.
    Beheaded,
};

/// Where the bytes to be cut end.
enum class SequenceEnd : std::uint8_t {
    Whole, // with a message
    Anywhere, // within one, perhaps: more bytes are to come
};

/// Cuts log messages that lie back to back.
///
/// An item starts with its own length (12 to 65535, the header included). Received bytes
/// that were no proper message (too short, or of an unknown type) lie between the others and tell no length of their
/// own: what stands before the next place from where the messages go on is such a piece. Of all ways to cut, the one
/// that leaves the fewest such pieces and explains the most messages is taken, looking ahead over a window; time is
/// linear in the number of bytes, memory constant.
class MessageCutter {
public:
    struct Cut {
        std::size_t start = 0;
        std::size_t length = 0;
        std::optional<std::uint8_t> missingByte; // stood before the cut when the message was received
        bool isRefused = false; // no proper message: what lies between two
    };

    MessageCutter(ByteView bytes, MessageSequence sequence, SequenceEnd end = SequenceEnd::Whole)
        : _bytes(bytes)
        , _sequence(sequence)
        , _end(end)
    {
    }

    /// False at the end, where the bytes are damaged, and where they end within a message.
    bool next(Cut& cut);
    /// After `next` has answered false with bytes left: whether they are the start of a message whose rest is to come.
    bool endsWithin() const
    {
        return goesOn(_place) && bestOf(_place) == 0;
    }
    /// Goes on behind the damage at which `next` has stopped, where the best way starts. False when none leads on that
    /// explains three messages without their first byte, or one as it stands.
    bool skipDamage(Cut& cut);
    /// Where the next message starts.
    std::size_t place() const
    {
        return _place;
    }
    /// Why there is none although bytes are left.
    std::string complaint() const;

private:
    struct Candidate {
        std::size_t length = 0; // 0: none
        int score = 0;
        std::optional<std::uint8_t> missingByte;
    };

    bool isItem(std::size_t place) const;
    bool isKnownType(std::size_t place) const;
    bool isStartOfItem(std::size_t place) const;
    bool goesOn(std::size_t place) const;
    Candidate message(std::size_t place) const;
    template <typename Visitor> void visitCandidates(std::size_t place, Visitor visit) const;
    std::int32_t bestOf(std::size_t place) const;
    Candidate bestCandidate(std::size_t place, std::int32_t& score) const;
    void plan();
    bool isRefusedMessage(std::size_t end) const;
    std::optional<std::size_t> endOfPiece() const;

    RecordView _bytes;
    MessageSequence _sequence;
    SequenceEnd _end;
    std::size_t _place = 0;
    std::size_t _planned = 0; // the plan's first place
    std::size_t _replanAt = 0; // where the plan looks too little ahead
    std::vector<std::int32_t> _best; // the score of the best way on from each planned place
};

} // namespace spectrel
