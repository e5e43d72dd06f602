#include "Telephony/ServiceLine.h"

#include "Platform/ErrorOutput.h"

namespace spectrel {

void printServiceLine(const std::string& line)
{
    writeErrorLine("spectrel-telephonyd", line);
}

} // namespace spectrel
