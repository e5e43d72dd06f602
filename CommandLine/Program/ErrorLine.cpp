#include "CommandLine/Program/ErrorLine.h"

#include "Platform/ErrorOutput.h"

namespace spectrel {

void report(std::string_view line)
{
    writeErrorLine("spectrel", line);
}

} // namespace spectrel
