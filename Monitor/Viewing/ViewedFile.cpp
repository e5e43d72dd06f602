#include "Monitor/Viewing/ViewedFile.h"

#include "Monitor/Viewing/RecordingModel.h"
#include "Monitor/Viewing/SnapshotModel.h"
#include "Values/Dictionary.h"

#include <filesystem>
#include <system_error>
#include <utility>

namespace spectrel {

std::unique_ptr<ViewedFile> ViewedFile::open(
    const std::string& path, std::optional<Technology> technology, const Clock& deviceClock, std::string& reason)
{
    std::error_code error;
    const auto status = std::filesystem::status(path, error);
    if (std::filesystem::exists(status) && !std::filesystem::is_regular_file(status)
        && !std::filesystem::is_directory(status)) {
        reason = "not a plain file: it could not be read again for going back";
        return nullptr;
    }
    auto opened = openRecording(path);
    if (!opened) {
        reason = opened.failure().text;
        return nullptr;
    }
    auto reader = *std::move(opened);
    std::unique_ptr<ViewedFile> file(new ViewedFile(deviceClock));
    if ((file->_snapshot = reader->snapshot())) {
        const std::string* made = (*file->_snapshot)["Timestamp"].string();
        Moment moment {};
        if (made && parseDefaultDateForm(*made, moment))
            file->_clock.set(moment);
        return file;
    }
    auto track = RecordingTrack::open(path, std::move(reader), technology);
    if (!track) {
        reason = track.failure().text;
        return nullptr;
    }
    file->_recording = std::move(*track);
    file->_damage = file->_recording->damage();
    return file;
}

std::unique_ptr<MonitorModel> ViewedFile::makeModel(RunLoop& runLoop, GeneratorFactory makeGenerator,
    SpectrelModelObserver& observer, Report report, const Context& context)
{
    if (_snapshot)
        return std::make_unique<SnapshotModel>(runLoop, observer, *_snapshot);
    return std::make_unique<RecordingModel>(runLoop, std::move(makeGenerator), observer, _clock,
        std::move(*std::exchange(_recording, std::nullopt)), std::move(report), context);
}

} // namespace spectrel
