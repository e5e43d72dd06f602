#include "Platform/Syslog/DiagnosticFile.h"

#include <utility>

namespace spectrel {

namespace {
constexpr int DebugPriority = 7; // LOG_DEBUG
}

std::unique_ptr<DiagnosticFile> DiagnosticFile::create(const std::string& path, std::string& reason)
{
    auto file = FileLog::create(path, FileLog::Writing::EachLine, reason);
    return file ? std::unique_ptr<DiagnosticFile>(new DiagnosticFile(std::move(file))) : nullptr;
}

DiagnosticFile::DiagnosticFile(std::unique_ptr<FileLog> file)
    : _file(std::move(file))
{
    install(this);
}

DiagnosticFile::~DiagnosticFile()
{
    install(nullptr);
}

void DiagnosticFile::write(std::string_view line)
{
    _file->write(DebugPriority, line);
}

} // namespace spectrel
