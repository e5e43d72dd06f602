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
    const std::string name = std::string(portPrefix) + std::string(Session::PortSuffix);
    const auto prepared = SocketMessagePorts::prepareDirectory(Places::portDirectory(), name);
    if (!prepared)
        report(prepared.failure().of("the message ports' folder cannot be had").text);
    return bool(prepared);
}

} // namespace spectrel::Surroundings
