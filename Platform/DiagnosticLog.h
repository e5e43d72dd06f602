#pragma once

#include <string_view>

namespace spectrel {

/// The platform's diagnostic log: what sections tell their developers, apart from the failures and traces of the system
/// log. A null pointer to one says that nobody listens, and nothing is formatted for nobody.
class DiagnosticLog {
public:
    virtual ~DiagnosticLog() = default;
    /// `line` comes without its newline.
    virtual void write(std::string_view line) = 0;
};

} // namespace spectrel
