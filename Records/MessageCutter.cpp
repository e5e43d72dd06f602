#include "Records/MessageCutter.h"

#include "Records/Frame.h"

#include <algorithm>
#include <limits>

namespace spectrel {

namespace {

constexpr std::size_t BeheadedWrapper = WrapperSize - 1; // its first byte is missing
constexpr std::size_t SmallestExtraFree = 0x0010; // codes below belong to the extra stream

/// Places looked at together; a plan serves its first half. Much longer than the longest item.
constexpr std::size_t Window = 512 * 1024;

// What a step is worth. A message between others explains most; one without its first byte is rare, and the shorter the
// evidence the less it counts. A way that breaks must explain a dozen more messages than one that does not; going on
// behind the break takes better evidence than one length that happens to fit, without which the rest is damage.
constexpr int MessageScore = 8;
constexpr int BeheadedScore = 1;
constexpr int BeheadedWrapperScore = 2;
constexpr int UnknownTypeScore = 0;
constexpr int SkipScore = -106; // pays where the way behind is worth more than 6: one message as it stands
constexpr int DamageScore = -100;
constexpr int OpenScore = 0; // the bytes end within a message
constexpr std::int32_t NoWay = std::numeric_limits<std::int32_t>::min() / 2;

} // namespace

bool MessageCutter::isItem(std::size_t place) const
{
    return place + ItemHeaderSize <= _bytes.size() && itemLength(_bytes, place) >= ItemHeaderSize
        && itemLength(_bytes, place) <= _bytes.size() - place;
}

bool MessageCutter::isKnownType(std::size_t place) const
{
    return isRecordType(_bytes.u8(place));
}

/// A whole message, wrapper and all.
MessageCutter::Candidate MessageCutter::message(std::size_t place) const
{
    const std::size_t type = recordPlace(_bytes, place);
    const std::size_t item = type + RecordTypeSize;
    if (!isItem(item))
        return {};
    return {item + itemLength(_bytes, item) - place, isKnownType(type) ? MessageScore : UnknownTypeScore, {}};
}

/// Whether an item may start at the place whose rest is to come.
bool MessageCutter::isStartOfItem(std::size_t place) const
{
    return place + 2 > _bytes.size()
        || (itemLength(_bytes, place) >= ItemHeaderSize && itemLength(_bytes, place) > _bytes.size() - place);
}

/// Whether a message may start at the place whose rest is to come.
bool MessageCutter::goesOn(std::size_t place) const
{
    if (_end == SequenceEnd::Whole || place >= _bytes.size())
        return false;
    const std::size_t type = recordPlace(_bytes, place);
    if (type >= _bytes.size() || (isKnownType(type) && isStartOfItem(type + RecordTypeSize)))
        return true;
    return _sequence == MessageSequence::Beheaded
        && (isStartOfItem(place)
            || (isKnownType(place + BeheadedWrapper) && isStartOfItem(place + BeheadedWrapper + RecordTypeSize)));
}

/// Calls `visit` with each message that may start at the place.
template <typename Visitor> void MessageCutter::visitCandidates(std::size_t place, Visitor visit) const
{
    if (const Candidate whole = message(place); whole.length != 0)
        visit(whole);
    if (_sequence == MessageSequence::Whole)
        return;
    if (isItem(place)) { // its type byte is missing: the code gives it
        const bool isExtra = itemCode(_bytes, place) < SmallestExtraFree;
        visit({itemLength(_bytes, place), BeheadedScore, isExtra ? ExtraRecord : OrdinaryRecord});
    }
    const std::size_t item = place + BeheadedWrapper + RecordTypeSize;
    if (isKnownType(place + BeheadedWrapper) && isItem(item))
        visit({item + itemLength(_bytes, item) - place, BeheadedWrapperScore, WrapperMark});
}

/// The score of the best way on; beyond the plan nothing is known yet.
std::int32_t MessageCutter::bestOf(std::size_t place) const
{
    return place - _planned < _best.size() ? _best[place - _planned] : 0;
}

MessageCutter::Candidate MessageCutter::bestCandidate(std::size_t place, std::int32_t& score) const
{
    Candidate best;
    score = NoWay;
    visitCandidates(place, [&](const Candidate& candidate) {
        const std::int32_t reached = candidate.score + bestOf(place + candidate.length);
        if (reached > score) {
            score = reached;
            best = candidate;
        }
    });
    return best;
}

/// From the window's end backwards, so that each place knows the best way on from all places behind it.
void MessageCutter::plan()
{
    const std::size_t count = std::min(Window, _bytes.size() - _place);
    _planned = _place;
    _replanAt = _place + count == _bytes.size() ? _bytes.size() : _place + Window / 2;
    _best.assign(count, 0);
    std::int32_t bestBehind = NoWay; // of the places where a skip may end
    for (std::size_t i = count; i > 0; --i) {
        const std::size_t place = _planned + i - 1;
        std::int32_t score = 0;
        bestCandidate(place, score);
        const bool isSure = message(place).score == MessageScore; // is never skipped
        const int atWorst = goesOn(place) ? OpenScore : DamageScore;
        _best[i - 1] = isSure ? score : std::max({score, bestBehind + SkipScore, atWorst});
        bestBehind = std::max(bestBehind, score);
    }
}

/// The nearest place from which the planned way goes on after the skip that starts here; none where there is no way.
std::optional<std::size_t> MessageCutter::endOfPiece() const
{
    for (std::size_t place = _place + 1; place < _planned + _best.size(); ++place) {
        std::int32_t score = 0;
        bestCandidate(place, score);
        if (score + SkipScore == bestOf(_place))
            return place;
    }
    return std::nullopt;
}

/// Whether the bytes from here to there can be a message that was received but not taken: too short, or of no known
/// type.
bool MessageCutter::isRefusedMessage(std::size_t end) const
{
    const std::size_t record = recordPlace(_bytes, _place);
    return record + RecordHeaderSize > end || !isKnownType(record);
}

bool MessageCutter::next(Cut& cut)
{
    if (_place >= _bytes.size())
        return false;
    if (_place >= _replanAt)
        plan();
    std::int32_t score = 0;
    const Candidate candidate = bestCandidate(_place, score);
    if (candidate.length != 0 && score == bestOf(_place)) {
        cut = {_place, candidate.length, candidate.missingByte, false};
    } else {
        const auto end = endOfPiece();
        if (!end || !isRefusedMessage(*end))
            return false;
        cut = {_place, *end - _place, {}, true};
    }
    _place += cut.length;
    return true;
}

bool MessageCutter::skipDamage(Cut& cut)
{
    constexpr std::int32_t LeastEvidence = 3 * BeheadedScore;
    std::optional<std::size_t> best;
    std::int32_t bestScore = NoWay;
    for (std::size_t place = _place + 1; place < _planned + _best.size(); ++place) {
        std::int32_t score = 0;
        if (bestCandidate(place, score).length != 0 && score > bestScore) {
            best = place;
            bestScore = score;
        }
    }
    if (!best || bestScore < LeastEvidence)
        return false;
    cut = {_place, *best - _place, {}, true};
    _place = *best;
    return true;
}

std::string MessageCutter::complaint() const
{
    const std::size_t left = _bytes.size() - _place;
    std::size_t item = _place;
    if (_bytes.u8(_place) == WrapperMark)
        item += WrapperSize + RecordTypeSize;
    else if (_sequence == MessageSequence::Whole || isKnownType(_place))
        item += RecordTypeSize;
    if (item + ItemHeaderSize > _bytes.size())
        return std::to_string(left) + " bytes are left, too few for a message";
    const std::size_t length = itemLength(_bytes, item);
    if (length < ItemHeaderSize)
        return "the item has a length of " + std::to_string(length) + ", the least is "
            + std::to_string(ItemHeaderSize);
    if (length > _bytes.size() - item)
        return "the item has a length of " + std::to_string(length) + ", " + std::to_string(_bytes.size() - item)
            + " bytes are left";
    return "the item has a length of " + std::to_string(length) + ", where no message follows";
}

} // namespace spectrel
