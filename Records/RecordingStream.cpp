#include "Records/RecordingStream.h"

#include "Records/Capture/CaptureReader.h"
#include "Records/Capture/CaptureStream.h"
#include "Records/DLF/DLFReader.h"
#include "Records/DLF/DLFStream.h"
#include "Records/StreamCutter.h"

#include <algorithm>
#include <utility>

namespace spectrel {

namespace {

constexpr std::size_t FirstBytes = 4; // tell the kind
constexpr std::uint64_t LongestRun = 1 << 20; // damage that goes on is reported piece by piece

bool startsPcapng(ByteView bytes)
{
    return bytes[0] == 0x0A && bytes[1] == 0x0D && bytes[2] == 0x0D && bytes[3] == 0x0A;
}

class CutStream final : public RecordingStream {
public:
    explicit CutStream(std::optional<Technology> technology)
        : _fallback(technology)
    {
    }
    void append(ByteView bytes) override
    {
        _buffer.isSettled = false;
        _buffer.append(bytes);
    }
    void settle() override
    {
        _buffer.isSettled = true;
    }
    void finish() override
    {
        _buffer.isFinished = true;
    }
    StreamStep next(RecordedMessage& message) override;
    std::optional<Technology> technology() const override
    {
        return _technology;
    }
    const SkippedBytes& skipped() const override
    {
        return _skipped;
    }
    const std::string& reason() const override
    {
        return _reason;
    }

private:
    bool chooseCutter();
    StreamStep refuse(std::string reason);
    StreamStep stepFor(StreamCutter::Found found);
    bool addToRun(std::uint64_t offset, const StreamCutter::Piece& damage);

    std::optional<Technology> _fallback;
    std::optional<Technology> _technology;
    StreamBuffer _buffer;
    std::unique_ptr<StreamCutter> _cutter; // once the first bytes have told the kind
    SkippedBytes _run; // damage taken and not reported yet
    StreamCutter::Found _behindRun = StreamCutter::Found::Nothing; // found, to be reported after the run
    RecordedMessage _message;
    SkippedBytes _skipped;
    std::string _reason;
};

/// False while too few bytes have come, and when the stream is refused.
bool CutStream::chooseCutter()
{
    const ByteView bytes = _buffer.bytes();
    if (bytes.size() < FirstBytes) {
        if (_buffer.isFinished && !bytes.empty())
            refuse("it ended after " + std::to_string(bytes.size()) + " bytes");
    } else if (startsPcapng(bytes)) {
        refuse("it is pcapng; only classic pcap and DLF are relayed");
    } else if (startsCapture(bytes)) {
        _cutter = std::make_unique<CaptureStream>(_fallback);
    } else if (_fallback) {
        _cutter = std::make_unique<DLFStream>(*_fallback);
    } else if (startsWithVersionReport(bytes)) {
        refuse("it is DLF, which does not tell its technology; name it with --technology");
    } else {
        refuse("it starts neither as a capture nor as DLF (DLF items alone need --technology)");
    }
    return _cutter != nullptr;
}

StreamStep CutStream::refuse(std::string reason)
{
    _reason = std::move(reason);
    _cutter.reset();
    return StreamStep::Refused;
}

StreamStep CutStream::next(RecordedMessage& message)
{
    if (!_reason.empty())
        return StreamStep::Refused;
    if (!_cutter && !chooseCutter())
        return _reason.empty() ? StreamStep::Waiting : StreamStep::Refused;
    while (_behindRun == StreamCutter::Found::Nothing) {
        StreamCutter::Piece damage;
        const std::uint64_t offset = _buffer.offset();
        const auto found = _cutter->next(_buffer, _message, damage);
        if (found == StreamCutter::Found::Damage) {
            if (!addToRun(offset, damage))
                continue;
        } else {
            _behindRun = found;
        }
        const bool isOver = _buffer.isFinished && found == StreamCutter::Found::Nothing;
        if (_run.length > 0 && (found != StreamCutter::Found::Nothing || isOver)) {
            _skipped = std::exchange(_run, {});
            return StreamStep::Skipped;
        }
        if (found == StreamCutter::Found::Nothing)
            return StreamStep::Waiting;
    }
    message = _message;
    return stepFor(std::exchange(_behindRun, StreamCutter::Found::Nothing));
}

/// Pieces of damage without a message between them are one; true when it has become long enough to be reported.
bool CutStream::addToRun(std::uint64_t offset, const StreamCutter::Piece& damage)
{
    if (_run.length == 0)
        _run = {offset, 0, damage.reason};
    _run.length += damage.length;
    return _run.length >= LongestRun;
}

StreamStep CutStream::stepFor(StreamCutter::Found found)
{
    if (found == StreamCutter::Found::Message)
        return StreamStep::Message;
    if (!_cutter->technology())
        return refuse("its link type tells no technology; name it with --technology");
    _technology = _cutter->technology();
    return StreamStep::Begin;
}

} // namespace

std::unique_ptr<RecordingStream> makeRecordingStream(std::optional<Technology> technology)
{
    return std::make_unique<CutStream>(technology);
}

} // namespace spectrel
