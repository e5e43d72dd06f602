#include "Records/Recording.h"

#include "Records/Capture/CaptureReader.h"
#include "Records/DLF/DLFReader.h"
#include "Records/RecordingFile.h"
#include "Records/SnapshotFile/SnapshotReader.h"
#include "Values/PropertyList/PropertyList.h"

#include <algorithm>

namespace spectrel {

namespace {

bool looksLikePropertyList(ByteView bytes)
{
    std::string_view text(reinterpret_cast<const char*>(bytes.data()), bytes.size());
    if (text.starts_with("bplist") || text.starts_with("\xFE\xFF")
        || text.starts_with(std::string_view("\xFF\xFE<\0", 4)))
        return true;
    if (text.starts_with("\xEF\xBB\xBF"))
        text.remove_prefix(3);
    text.remove_prefix(std::min(text.find_first_not_of(" \t\r\n"), text.size()));
    return text.starts_with("<?") || text.starts_with("<!") || text.starts_with("<plist");
}

/// Snapshots and DLF files are read as a whole.
std::unique_ptr<RecordingReader> openWhole(Bytes bytes, std::string& reason)
{
    if (looksLikePropertyList(bytes)) {
        const auto list = parsePropertyList(bytes);
        if (list)
            return openSnapshot(*list, reason);
        reason = "a property list that does not parse";
        return nullptr;
    }
    if (looksLikeDLF(bytes))
        return openDLF(std::move(bytes));
    reason = "neither a capture nor a snapshot nor a DLF file";
    return nullptr;
}

} // namespace

std::unique_ptr<RecordingReader> openRecording(const std::string& path, std::string& reason)
{
    auto file = RecordingFile::open(path, reason);
    if (!file)
        return nullptr;
    if (startsCapture(file->peek()))
        return openCapture(std::move(*file), reason);
    auto bytes = file->readAll(PropertyListLimits::SerialisedBytes, reason);
    if (!bytes)
        return nullptr;
    if (bytes->empty()) {
        reason = "the file is empty";
        return nullptr;
    }
    return openWhole(std::move(*bytes), reason);
}

} // namespace spectrel
