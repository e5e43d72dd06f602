#pragma once

#include "Platform/Resources.h"

#include <map>
#include <string>

namespace spectrel {

/// Templates within one test, by name.
class FakeResources final : public Resources {
public:
    std::optional<Value> propertyList(std::string_view name) const override
    {
        const auto found = lists.find(std::string(name));
        return found == lists.end() || found->second.isAbsent() ? std::nullopt : std::optional(found->second);
    }
    std::vector<std::string> propertyListPaths() const override
    {
        std::vector<std::string> paths;
        for (const auto& [name, list] : lists)
            paths.push_back("/resources/" + name + ".plist");
        return paths;
    }

    std::map<std::string, Value> lists; // an absent value: a file that does not parse
};

} // namespace spectrel
