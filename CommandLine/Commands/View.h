#pragma once

#include "Platform/Context.h"
#include "Records/Recording.h"

#include <optional>
#include <string>

namespace spectrel {

struct Arguments;

/// What `spectrel view` was asked for.
struct ViewOptions {
    std::string file;
    std::optional<Technology> technology; // where the file does not say
};

/// Browses a recording or a snapshot in the screens that the arguments and the surroundings ask for. No session is
/// started, nothing is saved and no preference is written. Answers the program's exit status.
int view(const Arguments& arguments, const Context& context);

} // namespace spectrel
