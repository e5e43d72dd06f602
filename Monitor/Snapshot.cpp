#include "Monitor/Snapshot.h"

#include "Values/Dictionary.h"
#include "Values/OwnFile.h"
#include "Values/PropertyList/PropertyList.h"

#include <filesystem>

namespace spectrel {

DictionaryRef makeSnapshot(Moment openedAt, ListRef saveContents, const std::optional<std::string>& description)
{
    auto snapshot = Dictionary::make({{"Timestamp", defaultDateForm(openedAt)}});
    // The first absent value ends the dictionary.
    if (!saveContents)
        return snapshot;
    snapshot->set("Data", saveContents);
    if (description)
        snapshot->set("Description", *description);
    return snapshot;
}

std::string snapshotPath(const std::string& directory, Moment savedAt)
{
    const auto seconds = std::chrono::floor<std::chrono::seconds>(savedAt).time_since_epoch().count();
    return directory + "/SpectrelSnapshot-" + std::to_string(seconds) + ".spectrel";
}

bool writeSnapshot(const DictionaryRef& snapshot, const std::string& path, std::string& reason)
{
    const auto made = makeOwnFolders(std::filesystem::path(path).parent_path().string());
    if (!made) {
        reason = made.failure().text;
        return false;
    }
    const auto written = writePropertyListToFile(snapshot, path);
    if (!written)
        reason = written.failure().text;
    return bool(written);
}

} // namespace spectrel
