#pragma once

#include <string>

namespace spectrel {

/// What the program says of itself.
struct AboutText {
    std::string name;
    std::string version;
    std::string summary; // one line

    static AboutText text();
};

} // namespace spectrel
