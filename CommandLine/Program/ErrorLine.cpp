#include "CommandLine/Program/ErrorLine.h"

#include <cstdio>

namespace spectrel {

void report(std::string_view line)
{
    std::fprintf(stderr, "spectrel: %.*s\n", static_cast<int>(line.size()), line.data());
}

} // namespace spectrel
