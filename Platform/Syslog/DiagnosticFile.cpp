#include "Platform/Syslog/DiagnosticFile.h"

#include <utility>

namespace spectrel {

namespace {
constexpr int DebugPriority = 7; // LOG_DEBUG
}

Result<std::unique_ptr<DiagnosticFile>> DiagnosticFile::create(const std::string& path)
{
    auto file = FileLog::create(path, FileLog::Writing::EachLine);
    if (!file)
        return file.failure();
    return std::unique_ptr<DiagnosticFile>(new DiagnosticFile(*std::move(file)));
}

DiagnosticFile::DiagnosticFile(std::unique_ptr<FileLog> file)
    : _file(std::move(file))
{
}

void DiagnosticFile::write(std::string_view line)
{
    _file->write(DebugPriority, line);
}

} // namespace spectrel
