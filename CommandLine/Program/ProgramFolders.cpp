#include "CommandLine/Program/ProgramFolders.h"

#include "CommandLine/Program/ErrorLine.h"
#include "Monitor/Session.h"
#include "Platform/Places.h"
#include "Platform/Sockets/SocketMessagePorts.h"

#include <filesystem>
#include <system_error>

namespace spectrel::Surroundings {

std::optional<std::string> templates(const std::optional<std::string>& named)
{
    const std::string folder = named.value_or(Places::resourcesDirectory());
    std::error_code error;
    if (std::filesystem::is_directory(folder, error))
        return folder;
    report(folder + ": " + (error ? error.message() : "not a folder of display templates"));
    return std::nullopt;
}

bool preparePorts(std::string_view portPrefix)
{
    std::string reason;
    const std::string name = std::string(portPrefix) + std::string(Session::PortSuffix);
    if (SocketMessagePorts::prepareDirectory(Places::portDirectory(), name, reason))
        return true;
    report("the message ports' folder cannot be had: " + reason);
    return false;
}

} // namespace spectrel::Surroundings
