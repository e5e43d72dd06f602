#pragma once

#include "Platform/DiagnosticLog.h"
#include "Platform/Syslog/FileLog.h"
#include "Values/Result.h"

#include <memory>
#include <string>

namespace spectrel {

/// The diagnostic log as a file, in the form of the system log's file: each line is of the least urgent priority
/// ("<7>TEXT") and in the file at once.
class DiagnosticFile final : public DiagnosticLog {
public:
    /// An existing file is replaced.
    static Result<std::unique_ptr<DiagnosticFile>> create(const std::string& path);

    void write(std::string_view line) override;

private:
    explicit DiagnosticFile(std::unique_ptr<FileLog> file);

    std::unique_ptr<FileLog> _file;
};

} // namespace spectrel
