#pragma once

#include "Analysis/OperatorNames.h"

#include <functional>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

namespace spectrel {

/// Operators' names from the list of mobile broadband providers, where the system has it installed. The file is read
/// when a name is asked for first.
class ProviderNames final : public OperatorNames {
public:
    /// The list's usual place.
    static constexpr const char* InstalledFile = "/usr/share/mobile-broadband-provider-info/serviceproviders.xml";

    explicit ProviderNames(std::string file = InstalledFile)
        : _file(std::move(file))
    {
    }
    std::string nameOf(std::string_view plmn) override;

private:
    void read();

    std::string _file;
    std::optional<std::map<std::string, std::string, std::less<>>> _names; // by network
};

} // namespace spectrel
