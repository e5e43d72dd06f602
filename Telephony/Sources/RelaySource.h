#pragma once

#include "Platform/Lifetime.h"
#include "Platform/RunLoop.h"
#include "Platform/StreamInput.h"
#include "Records/Recording.h"
#include "Records/RecordingStream.h"
#include "Telephony/LogSource.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace spectrel {

/// Relays a live stream of capture or DLF bytes that another program writes.
///
/// All channels hear the same messages, each from its start command on. The stream is read while somebody takes what it
/// holds: a lone slow client, or all of them, slow the writer down and lose nothing. One that lags behind the others
/// loses its oldest messages once its queue is full. While nobody listens the writer waits.
class RelaySource final : public LogSource, private StreamInput::Listener {
public:
    /// What the stream's end decides on a message is decided when nothing has come for so long.
    static constexpr std::chrono::milliseconds SettlingTime {100};

    /// `technology`: where the stream does not name it. `onFailure` is called, from the queue, when the only stream
    /// that the input will ever carry cannot be used; the reason has been printed.
    RelaySource(RunLoop& runLoop, std::unique_ptr<StreamInput> input, std::optional<Technology> technology,
        std::function<void()> onFailure);
    ~RelaySource() override;

    Technology technology() const override
    {
        return _technology.value_or(Technology::LTE);
    }
    /// The stream's first bytes name the technology.
    bool isReady() const override
    {
        return _technology.has_value();
    }
    std::unique_ptr<LogStream> start(MessageSink& sink) override;
    void setBasebandHandler(std::function<void()> handler) override
    {
        _basebandHandler = std::move(handler);
    }
    std::string status() const override;

private:
    class Stream;

    void writerCame() override;
    void bytesCame(ByteView bytes) override;
    void writerEnded(const std::string& reason) override;

    void pump();
    bool isWanted() const;
    bool take(StreamStep step, const RecordedMessage& message);
    void begin();
    void refuse();
    void finishWriter();
    void settleSoon();
    void remove(Stream& stream);

    RunLoop& _runLoop;
    std::unique_ptr<StreamInput> _input;
    std::optional<Technology> _givenTechnology;
    std::function<void()> _onFailure;
    std::function<void()> _basebandHandler;
    Lifetime _lifetime;

    std::optional<Technology> _technology; // of the latest stream
    std::unique_ptr<RecordingStream> _stream; // of the current writer, until all it wrote is relayed
    std::optional<std::string> _ending; // the writer has ended, and why; what it wrote is still being relayed
    bool _isSettling = false; // a job is queued
    bool _isPumping = false;
    bool _isChanging = false; // the channels of the former technology are about to end
    std::vector<Stream*> _streams;
    std::uint64_t _messages = 0;
    std::uint64_t _skippedBytes = 0;
    std::uint64_t _skippedPlaces = 0;
};

} // namespace spectrel
