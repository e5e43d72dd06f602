#include "Tests/Fakes/SourceFolder.h"

namespace spectrel {

std::string sourcePath(const std::string& relativePath)
{
    return SPECTREL_SOURCE_DIR "/" + relativePath;
}

} // namespace spectrel
