#pragma once

#include <string_view>

namespace spectrel {

/// The platform's diagnostic log: what sections tell their developers, apart from the failures and traces of the system
/// log. Nobody listens until one is installed, and nothing is formatted for nobody.
class DiagnosticLog {
public:
    virtual ~DiagnosticLog() = default;
    /// `line` comes without its newline.
    virtual void write(std::string_view line) = 0;

    /// Null: nobody listens. The log must outlive its installation.
    static void install(DiagnosticLog* log)
    {
        _installed = log;
    }
    static DiagnosticLog* installed()
    {
        return _installed;
    }

private:
    inline static DiagnosticLog* _installed = nullptr;
};

} // namespace spectrel
