#pragma once

#include "Platform/Context.h"

#include <optional>
#include <string>

namespace spectrel {

/// What `spectrel mark` was asked for.
struct MarkOptions {
    std::string note;
    std::optional<std::string> recording; // otherwise the one that is being recorded
};

/// Writes a bookmark of this moment beside a recording. Answers the program's exit status.
int mark(const MarkOptions& options, const Context& context);

} // namespace spectrel
