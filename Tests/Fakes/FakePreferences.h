#pragma once

#include "Platform/Preferences.h"

#include <string>
#include <string_view>

namespace spectrel {

/// Writes down what was asked of it, one line each.
class FakePreferences final : public Preferences {
public:
    void setBoolean(std::string_view domain, std::string_view key, bool value) override
    {
        calls += "set " + std::string(domain) + " " + std::string(key) + (value ? " true\n" : " false\n");
    }
    bool synchronize(std::string_view domain) override
    {
        calls += "synchronize " + std::string(domain) + "\n";
        return true;
    }
    void postChanged(std::string_view domain, std::string_view key) override
    {
        calls += "changed " + std::string(domain) + " " + std::string(key) + "\n";
    }

    std::string calls;
};

} // namespace spectrel
