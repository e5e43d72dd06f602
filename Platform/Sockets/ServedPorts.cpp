#include "Platform/Sockets/ServedPorts.h"

#include <algorithm>
#include <filesystem>
#include <system_error>

namespace spectrel {

namespace fs = std::filesystem;

std::vector<std::string> servedPorts(const std::string& directory, std::string_view prefix, std::string_view ending)
{
    std::vector<std::string> names;
    std::error_code error;
    for (fs::directory_iterator each(directory, error); !error && each != fs::directory_iterator();
         each.increment(error)) {
        const std::string name = each->path().filename().string();
        std::error_code unknown;
        if (name.starts_with(prefix) && name.ends_with(ending) && each->is_socket(unknown))
            names.push_back(name);
    }
    std::ranges::sort(names);
    return names;
}

} // namespace spectrel
