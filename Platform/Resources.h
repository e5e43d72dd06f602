#pragma once

#include "Values/Value.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// The data files shipped with the program: display templates.
class Resources {
public:
    virtual ~Resources() = default;
    /// The property list NAME.plist; none when it is missing or does not parse.
    virtual std::optional<Value> propertyList(std::string_view name) const = 0;
    /// Full paths of all resources of type "plist", sorted by name.
    virtual std::vector<std::string> propertyListPaths() const = 0;

    /// An empty set.
    static const Resources& none();
};

/// Resources in one folder of the file system.
class DirectoryResources final : public Resources {
public:
    explicit DirectoryResources(std::string directory);
    std::optional<Value> propertyList(std::string_view name) const override;
    std::vector<std::string> propertyListPaths() const override;

private:
    std::string _directory;
};

} // namespace spectrel
