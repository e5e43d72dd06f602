#pragma once

#include "Monitor/MonitorModel.h"
#include "Monitor/SpectrelModel.h"
#include "Monitor/Viewing/RecordingTrack.h"
#include "Monitor/Viewing/ViewedClock.h"
#include "Platform/Clock.h"
#include "Platform/RunLoop.h"
#include "Records/Recording.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace spectrel {

/// A recording or a snapshot that the screens browse: gives SpectrelApp its model and its clock.
class ViewedFile {
public:
    using Report = std::function<void(const std::string& line)>;

    /// The content says which of the two it is. Null, with `reason` (without the file's name), when it is neither, or
    /// is no plain file: going back takes reading it again. `deviceClock` gives the time zone and outlives this.
    static std::unique_ptr<ViewedFile> open(
        const std::string& path, std::optional<Technology> technology, const Clock& deviceClock, std::string& reason);

    /// Once. `report` gets a line for each message that would have ended the running application.
    std::unique_ptr<MonitorModel> makeModel(RunLoop& runLoop, GeneratorFactory makeGenerator,
        SpectrelModelObserver& observer, Report report, const Context& context);
    /// Stands at the moment shown.
    const Clock& clock() const
    {
        return _clock;
    }
    /// What of the file cannot be shown, and why; empty when it is whole.
    const std::string& damage() const
    {
        return _damage;
    }

private:
    explicit ViewedFile(const Clock& deviceClock)
        : _clock(deviceClock)
    {
    }

    ViewedClock _clock;
    std::optional<RecordingTrack> _recording; // one of the two
    DictionaryRef _snapshot;
    std::string _damage;
};

} // namespace spectrel
