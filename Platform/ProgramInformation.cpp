#include "Platform/ProgramInformation.h"

namespace spectrel {

std::optional<std::string> programVersion()
{
    return SPECTREL_VERSION;
}

} // namespace spectrel
