#include "Telephony/ServiceLine.h"

#include <cstdio>

namespace spectrel {

void printServiceLine(const std::string& line)
{
    std::fprintf(stderr, "spectrel-telephonyd: %s\n", line.c_str());
}

} // namespace spectrel
