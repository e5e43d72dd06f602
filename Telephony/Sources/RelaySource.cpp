#include "Telephony/Sources/RelaySource.h"

#include "Telephony/ChannelQueue.h"
#include "Telephony/ServiceLine.h"

#include <algorithm>
#include <utility>

namespace spectrel {

/// One channel's share.
class RelaySource::Stream final : public LogStream {
public:
    Stream(RelaySource& source, MessageSink& sink)
        : _source(source)
        , _queue(sink)
    {
    }
    ~Stream() override
    {
        _source.remove(*this);
    }
    void send(ByteView message)
    {
        _queue.send(message);
    }
    void resume() override
    {
        _queue.drain();
        _source.pump();
    }
    bool hasRoom() const
    {
        return _queue.waiting() == 0;
    }
    std::size_t waiting() const override
    {
        return _queue.waiting();
    }
    std::uint64_t lost() const override
    {
        return _queue.lost();
    }

private:
    RelaySource& _source;
    ChannelQueue _queue;
};

RelaySource::RelaySource(RunLoop& runLoop, std::unique_ptr<StreamInput> input, std::optional<Technology> technology,
    std::function<void()> onFailure)
    : _runLoop(runLoop)
    , _input(std::move(input))
    , _givenTechnology(technology)
    , _onFailure(std::move(onFailure))
    , _technology(technology)
{
    _input->start(*this);
}

RelaySource::~RelaySource() = default;

std::unique_ptr<LogStream> RelaySource::start(MessageSink& sink)
{
    auto stream = std::make_unique<Stream>(*this, sink);
    _streams.push_back(stream.get());
    // From the queue: the channel does not have its stream yet.
    _runLoop.async(_lifetime.guard([this] { pump(); }));
    return stream;
}

void RelaySource::remove(Stream& stream)
{
    std::erase(_streams, &stream);
}

void RelaySource::writerCame()
{
    if (_input->takesFurtherWriters())
        printServiceLine(_input->name() + ": a writer has come");
    _stream = makeRecordingStream(
        _givenTechnology, _input->isOpenToOthers() ? StreamHeader::Required : StreamHeader::Optional);
}

void RelaySource::bytesCame(ByteView bytes)
{
    if (!_stream)
        return;
    _stream->append(bytes);
    pump();
    settleSoon();
}

/// What the writer has left behind may have to wait for clients; until it is relayed no other writer is heard.
void RelaySource::writerEnded(const std::string& reason)
{
    if (!_stream)
        return;
    _ending = reason;
    _stream->finish();
    pump();
}

/// Whether somebody takes messages now. Until the technology is known the stream is read for it.
bool RelaySource::isWanted() const
{
    if (_isChanging)
        return false;
    return !_technology || std::ranges::any_of(_streams, [](const Stream* stream) { return stream->hasRoom(); });
}

/// Relays what the stream holds for as long as somebody takes it, and lets the writer go on when all is relayed.
void RelaySource::pump()
{
    if (std::exchange(_isPumping, true))
        return;
    RecordedMessage message;
    while (_stream && isWanted() && take(_stream->next(message), message)) { }
    const bool isDrained = !_stream || isWanted();
    if (isDrained && _stream && _ending)
        finishWriter();
    _input->setPaused(!isDrained);
    _isPumping = false;
}

/// False when the stream holds nothing more for now.
bool RelaySource::take(StreamStep step, const RecordedMessage& message)
{
    switch (step) {
    case StreamStep::Waiting:
        return false;
    case StreamStep::Begin:
        begin();
        return true;
    case StreamStep::Message:
        ++_messages;
        for (Stream* stream : _streams)
            stream->send(message.body);
        return true;
    case StreamStep::Skipped: {
        const SkippedBytes& skipped = _stream->skipped();
        printServiceLine(_input->name() + ": skipped " + std::to_string(skipped.length) + " bytes at byte "
            + std::to_string(skipped.offset) + " of the stream: " + skipped.reason);
        _skippedBytes += skipped.length;
        ++_skippedPlaces;
        return true;
    }
    case StreamStep::Refused:
        refuse();
        return false;
    }
    return false;
}

void RelaySource::begin()
{
    const auto before = std::exchange(_technology, _stream->technology());
    if (before != _technology || _streams.empty())
        printServiceLine(_input->name() + ": a stream of technology " + std::string(technologyName(*_technology)));
    if (!before || before == _technology || !_basebandHandler)
        return;
    _isChanging = true;
    _runLoop.async(_lifetime.guard([this] {
        _isChanging = false;
        if (_basebandHandler)
            _basebandHandler(); // ends the channels, and with them their streams
        pump();
    }));
}

void RelaySource::refuse()
{
    printServiceLine(_input->name() + ": the stream is refused: " + _stream->reason());
    _stream.reset();
    if (!_ending)
        _input->dropWriter();
    _ending.reset();
    if (!_input->takesFurtherWriters())
        _runLoop.async(_onFailure);
}

void RelaySource::finishWriter()
{
    printServiceLine(_input->name() + ": the writer has ended" + (_ending->empty() ? "" : " (" + *_ending + ")")
        + (_input->takesFurtherWriters() ? "; waiting for the next one" : "; the stream is over"));
    _stream.reset();
    _ending.reset();
    if (!_technology && !_input->takesFurtherWriters())
        _runLoop.async(_onFailure); // no channel could ever be opened
}

void RelaySource::settleSoon()
{
    if (!_stream || std::exchange(_isSettling, true))
        return;
    _runLoop.after(SettlingTime, _lifetime.guard([this] {
        _isSettling = false;
        if (!_stream)
            return;
        _stream->settle();
        pump();
    }));
}

std::string RelaySource::status() const
{
    if (_messages == 0 && !_stream)
        return _input->name() + ": no writer so far";
    std::string text = _input->name() + ": " + std::to_string(_messages) + " messages relayed";
    if (_skippedPlaces > 0)
        text += ", " + std::to_string(_skippedBytes) + " bytes skipped at " + std::to_string(_skippedPlaces)
            + (_skippedPlaces == 1 ? " place" : " places");
    return text + (_stream ? "" : ", no writer");
}

} // namespace spectrel
