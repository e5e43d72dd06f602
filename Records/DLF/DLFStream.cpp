#include "Records/DLF/DLFStream.h"

#include "Records/DLF/DLFReader.h"

#include <algorithm>
#include <utility>

namespace spectrel {

StreamCutter::Found DLFStream::next(StreamBuffer& buffer, RecordedMessage& message, Piece& damage)
{
    if (!std::exchange(_hasBegun, true))
        return Found::Begin;
    for (;;) {
        if (_cuts.empty())
            plan(buffer);
        if (_cuts.empty())
            return Found::Nothing;
        const MessageCutter::Cut cut = _cuts.front();
        _cuts.pop_front();
        if (takeVersionReport(buffer, cut))
            continue;
        const ByteView bytes = buffer.bytes().first(cut.length);
        buffer.drop(cut.length);
        if (cut.isRefused) {
            const bool isEnd = buffer.isFinished && buffer.bytes().empty();
            damage = {cut.length, isEnd ? "the stream ended within an item" : "no item starts there"};
            return Found::Damage;
        }
        message.time = _time;
        message.body = bytes;
        if (cut.missingByte) {
            _restored.assign(1, *cut.missingByte);
            _restored.insert(_restored.end(), bytes.begin(), bytes.end());
            message.body = _restored;
        }
        return Found::Message;
    }
}

/// A version report may stand wherever another file begins.
bool DLFStream::takeVersionReport(StreamBuffer& buffer, const MessageCutter::Cut& cut)
{
    const ByteView bytes = buffer.bytes().first(cut.length);
    if (cut.isRefused || !cut.missingByte || !startsWithVersionReport(bytes))
        return false;
    _time = timeOfVersionReport(bytes);
    buffer.drop(cut.length);
    return true;
}

void DLFStream::plan(const StreamBuffer& buffer)
{
    const ByteView bytes = buffer.bytes();
    const bool isWhole = bytes.size() >= Window;
    if (bytes.empty() || (!isWhole && !buffer.isFinished && (!buffer.isSettled || bytes.size() == _looked)))
        return;
    _looked = bytes.size();
    const bool isLast = buffer.isFinished && bytes.size() <= Window;
    MessageCutter cutter(bytes.first(std::min(bytes.size(), Window)), MessageSequence::Beheaded,
        isLast ? SequenceEnd::Whole : SequenceEnd::Anywhere);
    const std::size_t end = isWhole && !isLast ? Window / 2 : bytes.size();
    MessageCutter::Cut cut;
    while (cutter.place() < end) {
        if (cutter.next(cut))
            _cuts.push_back(cut);
        else if (cutter.endsWithin() && !isWhole)
            return;
        else if (cutter.skipDamage(cut))
            _cuts.push_back(cut);
        else
            return giveUp(buffer, cutter.place(), end);
    }
}

/// No way leads on from there within what can be seen.
void DLFStream::giveUp(const StreamBuffer& buffer, std::size_t place, std::size_t end)
{
    if (buffer.isFinished || buffer.bytes().size() >= Window)
        _cuts.push_back({place, end - place, {}, true});
}

} // namespace spectrel
