#include "CommandLine/Output/ReportFile.h"

#include "Analysis/Report/ReportPage.h"

#include <cstdio>
#include <filesystem>
#include <fstream>
#include <system_error>
#include <unistd.h>

namespace spectrel {

namespace {

Outcome writeStandardOutput(std::string_view page)
{
    if (std::fwrite(page.data(), 1, page.size(), stdout) != page.size() || std::fflush(stdout) != 0)
        return Failure {"standard output: cannot be written"};
    return Done {};
}

/// Whether there is nothing at the path, or a report or an empty file.
bool mayBeWritten(const std::string& path)
{
    std::error_code error;
    const auto status = std::filesystem::status(path, error);
    if (!std::filesystem::exists(status))
        return true;
    if (!std::filesystem::is_regular_file(status))
        return false;
    std::ifstream file(path, std::ios::binary);
    std::string beginning(ReportBeginning.size(), '\0');
    file.read(beginning.data(), static_cast<std::streamsize>(beginning.size()));
    return file.gcount() == 0 || beginning == ReportBeginning;
}

} // namespace

Outcome writeReportFile(const std::string& path, std::string_view page)
{
    if (path == "-")
        return writeStandardOutput(page);
    if (!mayBeWritten(path))
        return Failure {path + ": is there already and is no report; it is not overwritten"};
    const std::string hidden = path + ".part" + std::to_string(::getpid());
    std::FILE* file = std::fopen(hidden.c_str(), "wbx");
    if (!file)
        return Failure::ofSystem().of(path);
    const bool isWritten = std::fwrite(page.data(), 1, page.size(), file) == page.size();
    const bool isClosed = std::fclose(file) == 0;
    if (isWritten && isClosed && std::rename(hidden.c_str(), path.c_str()) == 0)
        return Done {};
    const Failure failure = Failure::ofSystem().of(path);
    std::remove(hidden.c_str());
    return failure;
}

} // namespace spectrel
