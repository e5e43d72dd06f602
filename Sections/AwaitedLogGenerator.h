#pragma once

#include "LogGenerator/Template/ZPHLogGenerator2.h"

#include <memory>
#include <string>
#include <string_view>

namespace spectrel {

/// Stands where a technology is known but cannot be decoded yet: answers every operation as an uninitialised generator
/// does. This is the one place that says so.
class AwaitedLogGenerator final : public ZPHLogGenerator2 {
public:
    explicit AwaitedLogGenerator(std::string_view technology)
        : _name("AwaitedLogGenerator " + std::string(technology))
    {
    }
    std::string_view className() const override
    {
        return _name;
    }

private:
    std::string _name;
};

} // namespace spectrel
