#include "Platform/Places.h"

#include "Values/OwnFile.h"

#include <cerrno>
#include <cstdlib>
#include <filesystem>
#include <sys/stat.h>
#include <system_error>
#include <unistd.h>

namespace spectrel {

namespace fs = std::filesystem;

namespace {

std::string variable(const char* name)
{
    const char* value = std::getenv(name);
    return value ? value : "";
}

/// An XDG base directory; relative values are invalid and count as unset.
std::string baseDirectory(const char* name, const char* belowHome)
{
    const std::string value = variable(name);
    if (!value.empty() && value.front() == '/')
        return value;
    const std::string home = variable("HOME");
    return (home.empty() ? "/tmp/spectrel-" + std::to_string(::getuid()) : home) + "/" + belowHome;
}

} // namespace

std::string Places::portDirectory()
{
    if (const std::string chosen = variable("SPECTREL_PORT_DIR"); !chosen.empty())
        return chosen;
    if (const std::string runtime = variable("XDG_RUNTIME_DIR"); !runtime.empty() && runtime.front() == '/')
        return runtime + "/spectrel";
    const std::string temporary = variable("TMPDIR");
    return (temporary.empty() ? "/tmp" : temporary) + "/spectrel-" + std::to_string(::getuid());
}

std::string Places::devicePath(const std::string& absolutePath)
{
    std::string root = variable("SPECTREL_DEVICE_ROOT");
    while (!root.empty() && root.back() == '/')
        root.pop_back();
    return root + absolutePath;
}

std::string Places::crashLogDirectory()
{
    if (const std::string chosen = variable("SPECTREL_CRASH_LOG_DIR"); !chosen.empty())
        return chosen;
    return baseDirectory("XDG_STATE_HOME", ".local/state") + "/spectrel/CrashReporter";
}

std::string Places::diagnosticLog()
{
    return variable("SPECTREL_DIAGNOSTIC_LOG");
}

std::string Places::preferencesDirectory()
{
    return baseDirectory("XDG_CONFIG_HOME", ".config") + "/spectrel";
}

std::string Places::resourcesDirectory()
{
    std::error_code error;
    const fs::path program = fs::read_symlink("/proc/self/exe", error).parent_path();
    for (const fs::path& candidate : {program / "Resources", program.parent_path() / "Resources"}) {
        if (!error && fs::is_directory(candidate, error))
            return candidate.string();
    }
    return (program.parent_path() / "share/spectrel").string();
}

Outcome makePrivateDirectory(const std::string& path)
{
    if (auto made = makeOwnFolders(fs::path(path).parent_path().string()); !made)
        return made;
    if (::mkdir(path.c_str(), 0700) != 0 && errno != EEXIST)
        return Failure::ofSystem().of(path);
    struct stat status { };
    if (::lstat(path.c_str(), &status) != 0)
        return Failure::ofSystem().of(path);
    if (!S_ISDIR(status.st_mode) || status.st_uid != ::geteuid())
        return Failure {path + ": not a folder of this user", Failure::Code::Refused};
    if ((status.st_mode & 0777) != 0700 && ::chmod(path.c_str(), 0700) != 0)
        return Failure::ofSystem().of(path);
    return Done();
}

} // namespace spectrel
