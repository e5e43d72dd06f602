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
Result<std::unique_ptr<RecordingReader>> openWhole(Bytes bytes)
{
    if (bytes.empty())
        return Failure {"the file is empty"};
    if (looksLikePropertyList(bytes)) {
        if (const auto list = parsePropertyList(bytes))
            return openSnapshot(*list);
        return Failure {"a property list that does not parse"};
    }
    if (looksLikeDLF(bytes))
        return openDLF(std::move(bytes));
    return Failure {"neither a capture nor a snapshot nor a DLF file"};
}

} // namespace

Result<std::unique_ptr<RecordingReader>> openRecording(const std::string& path)
{
    auto file = RecordingFile::open(path);
    if (!file)
        return file.failure();
    if (startsCapture(file->peek()))
        return openCapture(*std::move(file));
    auto bytes = file->readAll(PropertyListLimits::SerialisedBytes);
    if (!bytes)
        return bytes.failure();
    return openWhole(*std::move(bytes));
}

} // namespace spectrel
