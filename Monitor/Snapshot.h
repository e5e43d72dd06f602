#pragma once

#include "Platform/Clock.h"
#include "Values/List.h"

#include <optional>
#include <string>

namespace spectrel {

/// The snapshot dictionary: "Timestamp", "Data" and, when there is a text, "Description", in this order.
DictionaryRef makeSnapshot(Moment openedAt, ListRef saveContents, const std::optional<std::string>& description);

/// "DIRECTORY/SpectrelSnapshot-SECONDS.spectrel", SECONDS being whole seconds since 1970.
std::string snapshotPath(const std::string& directory, Moment savedAt);

/// Writes the snapshot as an XML property list, mode 0600, creating the directory at need (mode 0700). A file of the
/// same second is overwritten where it is this user's own and no link. On failure false, with `reason` telling why.
bool writeSnapshot(const DictionaryRef& snapshot, const std::string& path, std::string& reason);

} // namespace spectrel
