#pragma once

#include "Platform/Clock.h"
#include "Platform/RunLoop.h"
#include "Records/Recording.h"
#include "Telephony/LogSource.h"
#include "Telephony/Sources/ReplayPoint.h"
#include "Values/Result.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace spectrel {

/// How recordings are played.
struct ReplayOptions {
    std::vector<std::string> files; // one after the other
    double speed = 1; // times as fast as recorded; 0: as fast as the client takes them
    bool loop = false;
    std::optional<Technology> technology; // where a file does not name one
    std::optional<ReplayPoint> from {}; // messages before it are passed over
    std::optional<ReplayPoint> to {}; // and those after it
};

/// Plays recordings. Each channel hears them from their start, from its own start command on; nothing is dropped for a
/// slow client. After the end the channel stays open and silent.
///
/// Messages keep their distances. Where the time goes back, and from one file to the next over more than ten seconds,
/// it goes on at once.
class ReplaySource final : public LogSource {
public:
    /// Fails, naming the file, when one cannot be read, does not name its technology, or names another one than the
    /// first.
    static Result<std::unique_ptr<LogSource>> open(RunLoop& runLoop, const Clock& clock, ReplayOptions options);

    Technology technology() const override
    {
        return _technology;
    }
    std::unique_ptr<LogStream> start(MessageSink& sink) override;
    std::string status() const override;

private:
    class Stream;
    ReplaySource(RunLoop& runLoop, const Clock& clock, ReplayOptions options, Technology technology);

    RunLoop& _runLoop;
    const Clock& _clock;
    ReplayOptions _options;
    Technology _technology;
};

} // namespace spectrel
