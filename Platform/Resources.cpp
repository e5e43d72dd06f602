#include "Platform/Resources.h"

#include "Values/PropertyList/PropertyList.h"

#include <algorithm>
#include <filesystem>
#include <system_error>

namespace spectrel {

namespace {

class NoResources final : public Resources {
public:
    std::optional<Value> propertyList(std::string_view) const override
    {
        return std::nullopt;
    }
    std::vector<std::string> propertyListPaths() const override
    {
        return {};
    }
};

const NoResources noResources;

} // namespace

const Resources& Resources::none()
{
    return noResources;
}

DirectoryResources::DirectoryResources(std::string directory)
    : _directory(std::move(directory))
{
}

std::optional<Value> DirectoryResources::propertyList(std::string_view name) const
{
    return readPropertyListFile((std::filesystem::path(_directory) / (std::string(name) + ".plist")).string());
}

std::vector<std::string> DirectoryResources::propertyListPaths() const
{
    std::vector<std::string> paths;
    std::error_code error;
    for (std::filesystem::directory_iterator file(_directory, error), end; !error && file != end;
         file.increment(error)) {
        if (file->path().extension() == ".plist")
            paths.push_back(file->path().string());
    }
    std::ranges::sort(paths);
    return paths;
}

} // namespace spectrel
