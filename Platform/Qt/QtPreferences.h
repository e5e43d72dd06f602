#pragma once

#include "Platform/Preferences.h"

#include <map>
#include <memory>
#include <string>

class QSettings;

namespace spectrel {

/// Preferences as ini files, `DIRECTORY/DOMAIN.conf`.
///
/// A change is announced on the session bus: path "/org/spectrel/Preferences", interface "org.spectrel.Preferences",
/// signal "Changed" with the domain and the key, two strings. Without a session bus nobody is told.
class QtPreferences final : public Preferences {
public:
    explicit QtPreferences(std::string directory);
    ~QtPreferences() override;

    /// A domain that is no plain file name is ignored here, and `synchronize` answers false for it.
    void setBoolean(std::string_view domain, std::string_view key, bool value) override;
    bool synchronize(std::string_view domain) override;
    void postChanged(std::string_view domain, std::string_view key) override;

private:
    QSettings* settings(std::string_view domain);

    std::string _directory;
    std::map<std::string, std::unique_ptr<QSettings>, std::less<>> _settings; // by domain
};

} // namespace spectrel
