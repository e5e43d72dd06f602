#pragma once

#include <string_view>

namespace spectrel {

/// Preferences of any application of the user, by the application's domain.
class Preferences {
public:
    virtual ~Preferences() = default;
    virtual void setBoolean(std::string_view domain, std::string_view key, bool value) = 0;
    /// Saves the domain at once; false when it could not be saved.
    virtual bool synchronize(std::string_view domain) = 0;
    /// Tells the domain's application that the key has changed, so that it reads it again.
    virtual void postChanged(std::string_view domain, std::string_view key) = 0;
};

/// Preferences that nothing is written to, for screens that only show a file.
class NoPreferences final : public Preferences {
public:
    void setBoolean(std::string_view, std::string_view, bool) override { }
    bool synchronize(std::string_view) override
    {
        return true;
    }
    void postChanged(std::string_view, std::string_view) override { }
};

} // namespace spectrel
